#pragma once

#include <list>
#include <memory>
#include <string>

#include "platform/system/MessagePorts.h"
#include "telephony/LogChannel.h"
#include "telephony/RecordRates.h"
#include "telephony/RecordSource.h"

namespace kelvo {

/// The telephony service: opens log channels for clients that ask on the control port, and hands the records of its
/// source to every channel that streams. A client that vanishes is forgotten at once. Main queue only; `ports` and
/// `source` outlive it.
class TelephonyService final : private RecordSink, private LogChannel::Owner {
public:
    struct Limits {
        std::size_t channels = 16;
        std::size_t channelsPerClient = 4;  ///< that deliver to one local port
        ClientQueue::Limits queue{};        ///< of every client
    };

    TelephonyService(MessagePorts& ports, RecordSource& source, Limits limits, SteadyTime now = steadyNow);
    TelephonyService(MessagePorts& ports, RecordSource& source) : TelephonyService(ports, source, Limits()) {}

    /// Makes the control port; says why when it cannot be had.
    Result<void> open();

    std::size_t channelCount() const { return _channels.size(); }

private:
    Bytes handle(std::int32_t id, ByteView message);
    Bytes status() const;
    Bytes createLogChannel(const std::string& clientName);
    bool hasRoomFor(const std::string& clientName) const;
    void tellWishes();

    bool take(ByteView record) override;
    bool isHungry() const override;
    std::optional<Technology> technologyForChannel() override;
    void channelStreams(LogChannel& channel) override;
    void channelWants(LogChannel& channel) override;
    void channelIsHungry(LogChannel& channel) override;
    void channelLostClient(LogChannel& channel) override;

    MessagePorts& _ports;
    RecordSource& _source;
    const Limits _limits;
    RecordRates _rates;
    std::unique_ptr<LocalPort> _controlPort;
    std::list<LogChannel> _channels;
    unsigned _channelsMade = 0;
    ClientsWishes _wishes;  // as the source knows them
    bool _started = false;
};

}  // namespace kelvo
