#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "LogGenerator/LogGenerator.h"
#include "model/Connection.h"
#include "model/KelvoModelNode.h"
#include "model/Provenance.h"
#include "model/ShownValues.h"
#include "model/Trends.h"
#include "platform/encodings/PropertyList.h"
#include "platform/system/Lifetime.h"
#include "platform/system/MainQueue.h"
#include "platform/system/MessagePorts.h"
#include "platform/telephony/Technology.h"
#include "platform/telephony/Telephony.h"

namespace kelvo {

/// The one live monitor between the program and the baseband's log stream: owns the two ports of the log channel, picks
/// the generator by the technology the modem speaks, feeds it every message, and every two seconds tells the screens
/// when there is something new. Main queue only; a start blocks it for at most five seconds: two for the channel, two
/// for the technology, one for the start command.
class KelvoModel final : public ShownValues {
public:
    /// The name of the local port on which the service delivers to the application.
    static constexpr const char* kLogChannelPortName = "com.zorvik.BasebandStateReport.LogChannel";

    /// What the model stands on; the references outlive it.
    struct Services {
        MainQueue& queue;
        MessagePorts& ports;
        TelephonyClient& telephony;
        /// Runs on the main queue when a tick found new data.
        std::function<void()> updateViewControllerFromModel;
        /// The application's port name; another program that watches beside it brings its own.
        std::string portName = kLogChannelPortName;
        /// Runs on the main queue when the connection has come or gone, and when what `connectionText` says of it is
        /// another than before: nobody has to ask again and again.
        std::function<void()> connectionChanged = {};
        /// Runs after each message of the log channel, when its values are on the display.
        std::function<void(ByteView message)> recordShown = {};
        /// How messages are encoded.
        std::function<Result<Bytes>(const Value&)> encode = writeXmlPropertyList;
    };

    explicit KelvoModel(Services services);
    ~KelvoModel() override;
    KelvoModel(const KelvoModel&) = delete;
    KelvoModel& operator=(const KelvoModel&) = delete;

    /// Tears the ports down and starts again. Never fails: a start that does is tried again every five seconds.
    void restartMonitor();
    /// Starts unless the monitor runs already.
    void startMonitor();
    /// One tick of the refresh timer.
    void refresh();
    void refresh(const Value& ignored);

    /// True while both ports are there.
    bool isConnected() const;
    /// How far the monitor has come, and for how long nothing has.
    Connection connection() const;
    /// The root of the display tree; none while there is no generator. The first call after a tick with new data builds
    /// the tree anew, and with it adds a snapshot to the history.
    NodeRef topLevelNodes();
    /// The node at `path`, of a tree built as for `topLevelNodes`; none when the tree has no such node.
    NodeRef nodeAtPath(const std::string& path);
    /// As `nodeAtPath`, of the tree that is there; none while the next one is not built yet.
    NodeRef shownNodeAtPath(const std::string& path) const override { return _nodesByPath.find(path); }
    /// The family whose screens these are: the first that was spoken; none before.
    std::optional<Technology> technology() const override { return _technology; }
    /// What the modem speaks that was connected last; another than the screens' when it was exchanged. None before.
    std::optional<Technology> spokenTechnology() const { return _spokenTechnology; }
    /// The values of the screens as they are now, without a refresh; none before the first record.
    const Value& display() const { return (*_state)["Display"]; }
    /// How many records have come so far, over all connections.
    std::uint64_t recordCount() const { return _records.count(); }
    /// How often a connection has come: one that went and came back between two looks is another.
    std::uint64_t connectionCount() const { return _connectionCount; }
    /// How the values have gone; each rebuild of the tree is one refresh of them. Their time is that of the main queue.
    const Trends& trends() const override { return _trends; }
    Trends::Time trendTime() const override;
    /// Where a node's value comes from; none when no record has written it, or another has written in its place since
    /// the tree was built. Ages go on while no records come and when the connection is lost.
    std::optional<Provenance> provenance(const KelvoModelNode& node) const override;
    /// The stream's time now: that of the records, going on by the clock behind the last one.
    std::chrono::microseconds streamTime() const { return _records.streamTime(_services.queue.now()); }
    /// Hands one message of the log channel to the generator.
    void updateWithData(ByteView data);
    /// The contents of a snapshot file; none while there is no generator.
    ArrayRef getSaveContents();

private:
    struct Told {
        bool isConnected = false;
        std::string text = connectionText({});
        bool operator==(const Told&) const = default;
    };

    bool createPorts();
    bool openLogChannel();
    void destroyPorts();
    void configureGenerator();
    void chooseGenerator(const Value& answer);
    bool startStreaming();
    template <class... Args>
    bool failed(Connection::State obstacle, const char* format, const Args&... args);
    void tellConnection();
    void loseService();
    void rebuildNodes();
    void didReceive(std::int32_t id, ByteView data);
    void didInvalidate(const LocalPort& port);

    const Services _services;
    const DictionaryRef _state = Dictionary::make();                 // outlives every restart and every generator
    RecordLedger _records;                                           // likewise: the display's values outlive them
    std::vector<std::unique_ptr<LogGenerator>> _replacedGenerators;  // none is released before the model goes
    std::unique_ptr<LogGenerator> _logGenerator;
    std::optional<Technology> _technology;
    std::optional<Technology> _spokenTechnology;
    std::uint64_t _connectionCount = 0;
    NodeRef _nodes;
    NodesByPath _nodesByPath;  // built with _nodes and empty without
    Trends _trends;
    std::unique_ptr<LocalPort> _recvPort;
    std::unique_ptr<RemotePort> _sendPort;
    std::unique_ptr<RepeatingTimer> _displayUpdateTimer;  // its presence means that the monitor runs
    bool _updated = false;
    Connection::State _obstacle = Connection::State::NotStarted;  // why the last start failed
    bool _receiving = false;                                      // a record has come since the monitor runs
    std::chrono::nanoseconds _silentSince{0};                     // when the last one came, or the monitor began to run
    Told _told;                                                   // what the screens know of the connection
    const Lifetime _lifetime;  // tasks on the queue, and what others call back, may come after the model
};

}  // namespace kelvo
