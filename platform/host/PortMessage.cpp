#include "platform/host/PortMessage.h"

#include <poll.h>
#include <sys/socket.h>
#include <sys/uio.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <utility>

#include "platform/system/MessagePorts.h"

namespace kelvo {
namespace {

constexpr std::size_t kOnePiece = 1024;  // bytes; a record is some hundred long

bool isRetryable(int error) { return error == EAGAIN || error == EWOULDBLOCK || error == ENOBUFS || error == ENOMEM; }

template <class Call>
PortSent outcomeOf(Call send) {
    ssize_t sent;
    do sent = send();
    while (sent < 0 && errno == EINTR);
    if (sent >= 0) return PortSent::Sent;
    return isRetryable(errno) ? PortSent::WouldBlock : PortSent::Gone;
}

// The system takes one piece a tenth faster than two.
PortSent sendInOnePiece(int fd, const PortHeader& header, ByteView data) {
    std::array<std::uint8_t, kOnePiece> whole;
    std::memcpy(whole.data(), &header, sizeof header);
    std::ranges::copy(data, whole.data() + sizeof header);
    const std::size_t size = sizeof header + data.size();
    return outcomeOf([&] { return ::send(fd, whole.data(), size, MSG_DONTWAIT | MSG_NOSIGNAL); });
}

}  // namespace

PortSent sendPortMessage(int fd, PortHeader header, ByteView data) {
    header.length = static_cast<std::uint32_t>(data.size());
    if (sizeof header + data.size() <= kOnePiece) return sendInOnePiece(fd, header, data);
    iovec parts[] = {{&header, sizeof header}, {const_cast<std::uint8_t*>(data.data()), data.size()}};
    msghdr message{};
    message.msg_iov = parts;
    message.msg_iovlen = 2;
    return outcomeOf([&] { return ::sendmsg(fd, &message, MSG_DONTWAIT | MSG_NOSIGNAL); });
}

bool waitForPort(int fd, short events, std::chrono::steady_clock::time_point deadline) {
    using namespace std::chrono;
    while (true) {
        const auto left = std::max(nanoseconds(0), duration_cast<nanoseconds>(deadline - steady_clock::now()));
        const timespec limit{static_cast<time_t>(left.count() / 1'000'000'000), left.count() % 1'000'000'000};
        pollfd watched{fd, events, 0};
        const int ready = ::ppoll(&watched, 1, &limit, nullptr);
        if (ready > 0) return true;
        if (ready == 0 || errno != EINTR) return false;
    }
}

bool isPeerThere(int fd) {
    pollfd watched{fd, 0, 0};
    return ::poll(&watched, 1, 0) == 0;
}

PortReader::Outcome PortReader::read(int fd) {
    _buffer.resize(sizeof(PortHeader) + kMaxMessageSize);
    while (true) {
        // MSG_TRUNC: the length that was sent, whether or not it fits.
        const ssize_t received = ::recv(fd, _buffer.data(), _buffer.size(), MSG_DONTWAIT | MSG_TRUNC);
        // A peer that left with our messages unread is told once; what it sent before can still be read.
        if (received < 0 && (errno == EINTR || errno == ECONNRESET)) continue;
        if (received < 0) return isRetryable(errno) ? Outcome::Nothing : Outcome::Closed;
        if (received == 0 && !isPeerThere(fd)) return Outcome::Closed;
        return check(static_cast<std::size_t>(received));
    }
}

PortReader::Outcome PortReader::check(std::size_t received) {
    if (received > _buffer.size()) return refuse("it is too long");
    const auto datagram = parsePortDatagram(ByteView(_buffer).first(received));
    if (!datagram) return refuse(datagram.error().reason);
    _datagram = *datagram;
    return Outcome::Message;
}

PortReader::Outcome PortReader::refuse(std::string problem) {
    _datagram = {};
    _problem = std::move(problem);
    return Outcome::Garbage;
}

}  // namespace kelvo
