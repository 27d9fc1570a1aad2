#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/system/MessagePorts.h"
#include "platform/telephony/Technology.h"
#include "telephony/ClientQueue.h"
#include "telephony/RecordFilter.h"

namespace kelvo {

/// One client of the service: takes its commands on a port of its own and delivers the records it asked for to the
/// client's local port, as messages of id 0. A client that stops reading loses its oldest records; one log line counts
/// them when it catches up or leaves. Main queue only.
class LogChannel {
public:
    /// Who keeps the channel.
    class Owner {
    public:
        virtual ~Owner() = default;
        /// What the client is told, for the life of its channel; none: it is not known yet, and is being found out.
        virtual std::optional<Technology> technologyForChannel() = 0;
        virtual void channelStreams(LogChannel& channel) = 0;     ///< the client asked for its stream
        virtual void channelWants(LogChannel& channel) = 0;       ///< it streams, and what it wants may be new
        virtual void channelIsHungry(LogChannel& channel) = 0;    ///< the client has caught up
        virtual void channelLostClient(LogChannel& channel) = 0;  ///< to be destroyed, at once or later
    };

    /// A channel for the client whose local port is called `clientName` and reached by `client`.
    LogChannel(std::optional<Technology> technology, std::string clientName, std::unique_ptr<RemotePort> client,
               Owner& owner, ClientQueue::Limits limits);
    ~LogChannel();
    LogChannel(const LogChannel&) = delete;
    LogChannel& operator=(const LogChannel&) = delete;

    /// Makes the channel's port; false when there is none.
    bool open(MessagePorts& ports, const std::string& name);

    const std::string& clientName() const { return _clientName; }
    bool hasClient() const { return _client->isValid(); }
    bool isHungry() const { return _streaming && _queue.empty(); }
    /// Delivers a record; false when the client did not ask for it.
    bool take(ByteView record);

    bool isStreaming() const { return _streaming; }
    const RecordFilter& filter() const { return _filter; }
    std::size_t delivered() const { return _delivered; }        ///< records that are on their way to the client
    std::size_t waiting() const { return _queue.size(); }       ///< records that the client must make room for first
    std::size_t dropped() const { return _queue.lostInAll(); }  ///< records that it was too slow for

private:
    Bytes handle(std::int32_t id, ByteView message);
    Bytes refuse(const std::string& reason);
    Bytes answerTechnology();
    void settleTechnology();
    void flush();
    bool send(ByteView record);
    void tellLost();

    std::optional<Technology> _technology;  // none: the client has not been told yet
    const std::string _clientName;
    const std::unique_ptr<RemotePort> _client;
    Owner& _owner;
    std::unique_ptr<LocalPort> _port;
    RecordFilter _filter;
    ClientQueue _queue;
    bool _streaming = false;
    std::size_t _delivered = 0;
};

}  // namespace kelvo
