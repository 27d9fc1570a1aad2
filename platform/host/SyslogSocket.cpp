#include "platform/host/SyslogSocket.h"

#include <fmt/chrono.h>
#include <fmt/format.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <syslog.h>
#include <unistd.h>

#include <cstring>

namespace kelvo {

SyslogSocket::SyslogSocket(std::filesystem::path path, std::string program)
    : _path(std::move(path)), _program(std::move(program)) {
    connect();
}

bool SyslogSocket::connect() {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    const std::string& path = _path.native();
    if (path.size() >= sizeof address.sun_path) return false;
    std::memcpy(address.sun_path, path.data(), path.size());
    _socket = UniqueFd(::socket(AF_UNIX, SOCK_DGRAM | SOCK_CLOEXEC, 0));
    return _socket && ::connect(_socket.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0;
}

void SyslogSocket::send(int severity, const std::tm& time, std::string_view text) {
    const std::string line = fmt::format("<{}>{:%b %e %H:%M:%S} {}[{}]: {}", LOG_MAKEPRI(LOG_USER, severity), time,
                                         _program, ::getpid(), text);
    const auto isSent = [&] { return ::send(_socket.get(), line.data(), line.size(), MSG_NOSIGNAL) >= 0; };
    if (!isSent() && connect()) isSent();
}

}  // namespace kelvo
