#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"

namespace kelvo {

/// The longest message a port carries; a log record with its prefix (65,538 bytes) fits.
inline constexpr std::size_t kMaxMessageSize = std::size_t{128} * 1024;

/// The receiving end of a named port. Main queue only.
/// Ownership: owns the name; destroying the port invalidates it without calling the invalidation callback.
/// A callback may invalidate or destroy the port it is called for.
class LocalPort {
public:
    virtual ~LocalPort() = default;

    /// Called with the port once, when it becomes invalid. An empty function removes the callback.
    virtual void setInvalidationCallback(std::function<void(LocalPort&)> callback) = 0;
    /// Delivers messages on the main queue from now on; what arrived before is delivered then.
    virtual void schedule() = 0;
    /// Gives up the name, closes every connection and calls the invalidation callback. Idempotent.
    virtual void invalidate() = 0;
    virtual bool isValid() const = 0;
    virtual const std::string& name() const = 0;
};

/// Takes one message; what it returns is the reply to a sender that waits for one. `data` is borrowed for the call.
using MessageCallback = std::function<Bytes(std::int32_t id, ByteView data)>;

/// The sending end of a named port that another process listens on. Main queue only; owns its connection.
class RemotePort {
public:
    enum class Error : int {
        SendTimedOut = -1,   ///< the peer saw nothing
        ReplyTimedOut = -2,  ///< delivered: the peer may still act on it
        Invalid = -3,        ///< the peer is gone; isValid() stays false
        TooLong = -4,        ///< more than kMaxMessageSize; nothing was sent
    };

    virtual ~RemotePort() = default;

    /// Sends one message. With `replyLimit` it waits that long for the reply (which may be empty); without, it returns
    /// empty bytes once the message is on its way. Blocks the main queue for at most sendLimit plus replyLimit; a
    /// sendLimit of 0 never blocks. `data` is borrowed for the call.
    virtual Result<Bytes, Error> request(std::int32_t id, ByteView data, std::chrono::nanoseconds sendLimit,
                                         std::optional<std::chrono::nanoseconds> replyLimit) = 0;

    /// False at once when the peer has gone, and never true again: open a new port.
    virtual bool isValid() const = 0;
    /// Closes the connection and calls the invalidation callback. Idempotent.
    virtual void invalidate() = 0;
    /// Called on the main queue once, when the port becomes invalid. An empty function removes the callback.
    virtual void setInvalidationCallback(std::function<void(RemotePort&)> callback) = 0;
    /// Called on the main queue once, when a send that timed out may be tried again.
    virtual void notifyWhenWritable(std::function<void()> callback) = 0;
};

/// Makes ports. The two ends meet by name among the ports of one user.
class MessagePorts {
public:
    virtual ~MessagePorts() = default;

    struct Local {
        std::unique_ptr<LocalPort> port;  ///< none when it could not be created
        bool alreadyExisted = false;      ///< none because a live port of that name exists
        std::int64_t owner = 0;           ///< the process that has it; 0 when that cannot be told
    };
    /// Makes the port `name`. Messages wait until it is scheduled.
    virtual Local createLocal(std::string_view name, MessageCallback callback) = 0;

    /// Connects to the port `name`; none when nobody listens there. Never blocks.
    virtual std::unique_ptr<RemotePort> openRemote(std::string_view name) = 0;
};

}  // namespace kelvo
