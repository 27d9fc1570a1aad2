#pragma once

#include <cstddef>
#include <functional>
#include <string>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"

namespace kelvo::modem {

/// Where a reader finds a played modem: a pseudo-terminal or a socket. One reader at a time. Main queue only.
class ModemPort {
public:
    virtual ~ModemPort() = default;

    /// What the port tells whoever plays the modem; set before the first plugIn(), called on the main queue.
    std::function<void(ByteView)> onReceived;
    std::function<void()> onRoom;  ///< after send() has not taken everything, or a reader has come

    /// Makes the port appear; the reason when it cannot.
    virtual Result<void> plugIn() = 0;
    /// Makes it go: its reader sees the end.
    virtual void unplug() = 0;
    /// Where it is, as the service's --port takes it.
    virtual std::string place() const = 0;
    /// Sends what there is room for, and says how much that was; nothing while nobody reads.
    virtual std::size_t send(ByteView bytes) = 0;
};

}  // namespace kelvo::modem
