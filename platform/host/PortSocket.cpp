#include "platform/host/PortSocket.h"

#include <fcntl.h>
#include <fmt/format.h>
#include <sys/file.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <optional>

namespace kelvo {
namespace {

constexpr int kBacklog = 64;
constexpr int kSendBuffer = 1024 * 1024;  // bytes; a burst waits here while the receiver draws a screen

// A socket's address holds 107 characters, fewer than a path may have; the way through the open directory always fits.
sockaddr_un addressOf(int directory, const std::string& name) {
    const std::string path = fmt::format("/proc/self/fd/{}/{}.port", directory, name);
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::memcpy(address.sun_path, path.data(), std::min(path.size(), sizeof address.sun_path - 1));
    return address;
}

UniqueFd makeSocket() {
    UniqueFd made(::socket(AF_UNIX, SOCK_SEQPACKET | SOCK_NONBLOCK | SOCK_CLOEXEC, 0));
    if (made) ::setsockopt(made.get(), SOL_SOCKET, SO_SNDBUF, &kSendBuffer, sizeof kSendBuffer);
    return made;
}

std::optional<ucred> peerOf(int fd) {
    ucred peer{};
    socklen_t size = sizeof peer;
    return ::getsockopt(fd, SOL_SOCKET, SO_PEERCRED, &peer, &size) == 0 ? std::optional(peer) : std::nullopt;
}

bool isSameFile(int fd, int directory, const std::string& name) {
    struct stat opened {};
    struct stat named {};
    return ::fstat(fd, &opened) == 0 && ::fstatat(directory, name.c_str(), &named, AT_SYMLINK_NOFOLLOW) == 0 &&
           opened.st_dev == named.st_dev && opened.st_ino == named.st_ino;
}

// A lock that another process holds is all that would block.
PortRefusal refusal(int error) { return {error == EWOULDBLOCK, std::strerror(error)}; }

}  // namespace

bool isPortName(std::string_view name) {
    const auto isAllowed = [](char c) {
        return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '.' || c == '_' ||
               c == '-';
    };
    return !name.empty() && name.size() <= kMaxPortNameLength && std::all_of(name.begin(), name.end(), isAllowed);
}

UniqueFd connectToPort(int directory, const std::string& name) {
    UniqueFd made = makeSocket();
    const sockaddr_un address = addressOf(directory, name);
    if (!made || ::connect(made.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) return {};
    return made;
}

bool isPeerOfThisUser(int fd) {
    const auto peer = peerOf(fd);
    return peer && peer->uid == ::geteuid();
}

pid_t processOfPeer(int fd) {
    const auto peer = peerOf(fd);
    return peer ? peer->pid : 0;
}

Result<PortClaim, PortRefusal> PortClaim::take(UniqueFd directory, std::string name, UniqueFd passed) {
    PortClaim claim(std::move(directory), std::move(name));
    if (const auto locked = claim.lock(); !locked) return locked.error();
    if (passed) {
        ::fcntl(passed.get(), F_SETFL, O_NONBLOCK);
        claim._listener = std::move(passed);
        claim._wasPassed = true;
        return claim;
    }
    if (connectToPort(claim._directory.get(), claim._name)) {
        claim._wasPassed = true;  // it is another's, and stays
        return PortRefusal{true, "somebody listens already"};
    }
    if (const auto listening = claim.listen(); !listening) return listening.error();
    return claim;
}

PortClaim::~PortClaim() {
    if (!_lock) return;
    if (!_wasPassed) ::unlinkat(_directory.get(), (_name + ".port").c_str(), 0);
    ::unlinkat(_directory.get(), (_name + ".lock").c_str(), 0);
}

Result<void, PortRefusal> PortClaim::lock() {
    const std::string file = _name + ".lock";
    while (true) {
        UniqueFd opened(::openat(_directory.get(), file.c_str(), O_RDWR | O_CREAT | O_NOFOLLOW | O_CLOEXEC, 0600));
        if (!opened) return refusal(errno);
        if (::flock(opened.get(), LOCK_EX | LOCK_NB) != 0) return refusal(errno);
        // The owner before may have removed the file between the opening and the locking: then the lock is on nothing.
        if (!isSameFile(opened.get(), _directory.get(), file)) continue;
        _lock = std::move(opened);
        return {};
    }
}

Result<void, PortRefusal> PortClaim::listen() {
    ::unlinkat(_directory.get(), (_name + ".port").c_str(), 0);
    _listener = makeSocket();
    const sockaddr_un address = addressOf(_directory.get(), _name);
    if (!_listener || ::bind(_listener.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0 ||
        ::listen(_listener.get(), kBacklog) != 0)
        return refusal(errno);
    return {};
}

}  // namespace kelvo
