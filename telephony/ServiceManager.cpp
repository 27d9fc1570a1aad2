#include "telephony/ServiceManager.h"

#include <fmt/format.h>
#include <sys/socket.h>
#include <systemd/sd-daemon.h>

#include <algorithm>
#include <cstring>
#include <utility>

namespace kelvo {

ServiceManager::ServiceManager(Tell tell, std::optional<std::chrono::microseconds> watchdog)
    : _tell(std::move(tell)), _watchdog(watchdog) {}

ServiceManager ServiceManager::ofEnvironment() {
    constexpr int kKeep = 0;  // what is told goes to an address that stands in the environment
    std::uint64_t interval = 0;
    const bool isWatched = ::sd_watchdog_enabled(1, &interval) > 0;
    return {[](const std::string& state) { ::sd_notify(kKeep, state.c_str()); },
            isWatched ? std::optional(std::chrono::microseconds(interval)) : std::nullopt};
}

Result<UniqueFd> ServiceManager::passedSocket(const std::filesystem::path& path) {
    const int count = ::sd_listen_fds(1);
    if (count < 0) return Failure{fmt::format("no sockets can be taken over: {}", std::strerror(-count))};
    UniqueFd found;
    for (int fd = SD_LISTEN_FDS_START; fd < SD_LISTEN_FDS_START + count; ++fd) {
        UniqueFd passed(fd);
        if (::sd_is_socket_unix(fd, SOCK_SEQPACKET, 1, path.c_str(), 0) > 0) found = std::move(passed);
    }
    if (count > 0 && !found)
        return Failure{fmt::format("the socket that was passed does not listen at {}", path.native())};
    return found;
}

void ServiceManager::tellReady(const std::string& what, MainQueue& queue) {
    std::string line = what;
    std::replace(line.begin(), line.end(), '\n', ' ');  // a line is a statement of its own
    _tell("READY=1\nSTATUS=" + line);
    if (_watchdog) _alive = queue.repeat(*_watchdog / 2, [tell = _tell] { tell("WATCHDOG=1"); });
}

void ServiceManager::tellEnding() { _tell("STOPPING=1"); }

}  // namespace kelvo
