#include "platform/host/PortMessage.h"

#include <poll.h>
#include <sys/socket.h>
#include <sys/uio.h>

#include <algorithm>
#include <cerrno>

#include "platform/MessagePorts.h"

namespace kelvo {
namespace {

bool isRetryable(int error) { return error == EAGAIN || error == EWOULDBLOCK || error == ENOBUFS || error == ENOMEM; }

}  // namespace

PortSent sendPortMessage(int fd, PortHeader header, ByteView data) {
    header.length = static_cast<std::uint32_t>(data.size());
    iovec parts[] = {{&header, sizeof header}, {const_cast<std::uint8_t*>(data.data()), data.size()}};
    msghdr message{};
    message.msg_iov = parts;
    message.msg_iovlen = 2;
    ssize_t sent;
    do sent = ::sendmsg(fd, &message, MSG_DONTWAIT | MSG_NOSIGNAL);
    while (sent < 0 && errno == EINTR);
    if (sent >= 0) return PortSent::Sent;
    return isRetryable(errno) ? PortSent::WouldBlock : PortSent::Gone;
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
        iovec whole{_buffer.data(), _buffer.size()};
        msghdr message{};
        message.msg_iov = &whole;
        message.msg_iovlen = 1;
        const ssize_t received = ::recvmsg(fd, &message, MSG_DONTWAIT | MSG_CMSG_CLOEXEC);
        // A peer that left with our messages unread is told once; what it sent before can still be read.
        if (received < 0 && (errno == EINTR || errno == ECONNRESET)) continue;
        if (received < 0) return isRetryable(errno) ? Outcome::Nothing : Outcome::Closed;
        if (received == 0 && !isPeerThere(fd)) return Outcome::Closed;
        return check(static_cast<std::size_t>(received), (message.msg_flags & MSG_TRUNC) != 0);
    }
}

PortReader::Outcome PortReader::check(std::size_t received, bool truncated) {
    if (truncated) return refuse("it is too long");
    const auto datagram = parsePortDatagram(ByteView(_buffer).first(received));
    if (!datagram) return refuse(datagram.error());
    _datagram = *datagram;
    return Outcome::Message;
}

PortReader::Outcome PortReader::refuse(const char* problem) {
    _datagram = {};
    _problem = problem;
    return Outcome::Garbage;
}

}  // namespace kelvo
