#pragma once

#include <filesystem>
#include <string>

#include "platform/host/UniqueFd.h"
#include "platform/system/MessagePorts.h"

namespace kelvo {

/// Message ports as sockets in a directory that only this user can enter. Needs a QCoreApplication.
/// Every operation that fails for another reason than a missing or a taken port writes one log line.
class HostMessagePorts final : public MessagePorts {
public:
    /// Both ends must be given the same directory; it is made when a port is first used.
    explicit HostMessagePorts(std::filesystem::path directory);
    HostMessagePorts();  ///< the user's own directory, where all programs meet

    /// The port `name` will be made of this socket, which whoever has started the program listens on already.
    void usePassedSocket(std::string name, UniqueFd listener);

    Local createLocal(std::string_view name, MessageCallback callback) override;
    std::unique_ptr<RemotePort> openRemote(std::string_view name) override;

private:
    const std::filesystem::path _directory;
    std::string _passedName;  // empty: no socket was passed
    UniqueFd _passed;
};

}  // namespace kelvo
