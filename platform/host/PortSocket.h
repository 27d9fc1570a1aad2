#pragma once

#include <sys/types.h>

#include <string>
#include <string_view>

#include "platform/host/UniqueFd.h"
#include "platform/values/Result.h"

namespace kelvo {

/// Port names are 1 to 80 characters out of letters, digits, '.', '_' and '-': nothing else becomes a file name.
inline constexpr std::size_t kMaxPortNameLength = 80;
bool isPortName(std::string_view name);

/// A connection to the port `name` in the directory `directory`; none when nobody of this user listens there. Never
/// blocks.
UniqueFd connectToPort(int directory, const std::string& name);

/// True when the process at the other end runs under this process's user.
bool isPeerOfThisUser(int fd);

/// The process at the other end; 0 when it cannot be told.
pid_t processOfPeer(int fd);

/// Why a port's name is not to be had.
struct PortRefusal {
    bool isTaken = false;  ///< a live owner has it; else the system refused
    std::string reason;
};

/// The right to a port's name, and the socket that listens under it: `<name>.port` beside `<name>.lock`, which is held
/// locked for as long as the owner lives. A lock that is free therefore marks what a dead owner left behind, unless
/// somebody listens all the same: a service manager does, until it passes the socket to the owner that it starts.
class PortClaim {
public:
    /// `passed` is a socket that listens under the name already, and stays behind: whoever has passed it keeps it too.
    static Result<PortClaim, PortRefusal> take(UniqueFd directory, std::string name, UniqueFd passed = {});
    PortClaim(PortClaim&&) = default;
    PortClaim& operator=(PortClaim&&) = delete;
    ~PortClaim();  ///< removes both files, but no socket that was passed

    int listener() const { return _listener.get(); }

private:
    PortClaim(UniqueFd directory, std::string name) : _directory(std::move(directory)), _name(std::move(name)) {}
    Result<void, PortRefusal> lock();
    Result<void, PortRefusal> listen();

    UniqueFd _directory;
    std::string _name;
    UniqueFd _lock;
    UniqueFd _listener;
    bool _wasPassed = false;
};

}  // namespace kelvo
