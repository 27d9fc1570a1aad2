#pragma once

#include <memory>
#include <string>

#include "platform/host/FdWatcher.h"
#include "platform/host/PortMessage.h"
#include "platform/host/UniqueFd.h"
#include "platform/system/MessagePorts.h"

namespace kelvo {

/// The sending end of a port, on a connected Unix-domain socket.
class HostRemotePort final : public RemotePort {
public:
    HostRemotePort(UniqueFd connection, std::string name);

    Result<Bytes, Error> request(std::int32_t id, ByteView data, std::chrono::nanoseconds sendLimit,
                                 std::optional<std::chrono::nanoseconds> replyLimit) override;
    bool isValid() const override { return _connection && isPeerThere(_connection.get()); }
    void invalidate() override;
    void setInvalidationCallback(std::function<void(RemotePort&)> callback) override;
    void notifyWhenWritable(std::function<void()> callback) override;

private:
    using Deadline = std::chrono::steady_clock::time_point;

    Result<void, Error> send(const PortHeader& header, ByteView data, std::chrono::nanoseconds limit);
    Result<Bytes, Error> awaitReply(std::uint32_t sequence, Deadline deadline);
    void readUnexpected();

    UniqueFd _connection;  // none once invalidated
    const std::string _name;
    std::unique_ptr<FdWatcher> _incoming;
    std::unique_ptr<FdWatcher> _writable;
    PortReader _reader;
    std::uint32_t _sequence = 0;
    std::function<void(RemotePort&)> _invalidationCallback;
};

}  // namespace kelvo
