#pragma once

#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>

#include <cstring>
#include <filesystem>
#include <optional>
#include <string>

#include "platform/host/UniqueFd.h"
#include "platform/values/Bytes.h"

namespace kelvo::test {

/// One datagram between ports, built byte by byte: 4 bytes magic, kind, flags, 2 reserved, id, sequence, length, data.
inline Bytes datagram(std::uint8_t kind, std::uint8_t flags, std::int32_t id, std::uint32_t sequence,
                      std::string_view data) {
    Bytes bytes = {'V', 'L', 'K', '1', kind, flags, 0, 0};
    const auto append = [&bytes](std::uint32_t number) {
        for (int shift = 0; shift < 32; shift += 8) bytes.push_back(static_cast<std::uint8_t>(number >> shift));
    };
    append(static_cast<std::uint32_t>(id));
    append(sequence);
    append(static_cast<std::uint32_t>(data.size()));
    bytes.insert(bytes.end(), data.begin(), data.end());
    return bytes;
}

inline sockaddr_un rawAddress(const std::filesystem::path& path) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    std::strncpy(address.sun_path, path.c_str(), sizeof address.sun_path - 1);
    return address;
}

/// A sender that knows only sockets; none when nobody listens.
inline UniqueFd rawConnect(const std::filesystem::path& path) {
    UniqueFd fd(::socket(AF_UNIX, SOCK_SEQPACKET | SOCK_CLOEXEC, 0));
    const int room = 1024 * 1024;
    ::setsockopt(fd.get(), SOL_SOCKET, SO_SNDBUF, &room, sizeof room);
    const sockaddr_un address = rawAddress(path);
    if (::connect(fd.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) return {};
    return fd;
}

/// A listener that knows only sockets.
inline UniqueFd rawListen(const std::filesystem::path& path) {
    UniqueFd fd(::socket(AF_UNIX, SOCK_SEQPACKET | SOCK_CLOEXEC, 0));
    const sockaddr_un address = rawAddress(path);
    if (::bind(fd.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address) != 0) return {};
    ::listen(fd.get(), 8);
    return fd;
}

inline bool rawSend(const UniqueFd& fd, const Bytes& bytes) {
    return ::send(fd.get(), bytes.data(), bytes.size(), MSG_NOSIGNAL | MSG_DONTWAIT) ==
           static_cast<ssize_t>(bytes.size());
}

/// The next datagram, waited for at most ten seconds; none at the end or when nothing came.
inline std::optional<Bytes> rawReceive(const UniqueFd& fd) {
    pollfd watched{fd.get(), POLLIN, 0};
    if (::poll(&watched, 1, 10'000) != 1) return std::nullopt;
    Bytes bytes(200'000);
    const ssize_t received = ::recv(fd.get(), bytes.data(), bytes.size(), MSG_DONTWAIT);
    if (received <= 0) return std::nullopt;
    bytes.resize(static_cast<std::size_t>(received));
    return bytes;
}

inline bool rawHasData(const UniqueFd& fd) {
    pollfd watched{fd.get(), POLLIN, 0};
    return ::poll(&watched, 1, 0) == 1;
}

}  // namespace kelvo::test
