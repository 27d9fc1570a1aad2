#include "platform/host/HostRemotePort.h"

#include <poll.h>

#include <utility>

#include "platform/system/Environment.h"

namespace kelvo {
namespace {

constexpr int kMessagesPerTurn = 64;

}  // namespace

HostRemotePort::HostRemotePort(UniqueFd connection, std::string name)
    : _connection(std::move(connection)),
      _name(std::move(name)),
      _incoming(std::make_unique<FdWatcher>(_connection.get(), FdWatcher::For::Reading, [this] { readUnexpected(); })) {
}

Result<Bytes, RemotePort::Error> HostRemotePort::request(std::int32_t id, ByteView data,
                                                         std::chrono::nanoseconds sendLimit,
                                                         std::optional<std::chrono::nanoseconds> replyLimit) {
    if (data.size() > kMaxMessageSize) return Error::TooLong;
    if (!_connection) return Error::Invalid;
    PortHeader header;
    header.flags = replyLimit ? PortHeader::WantsReply : PortHeader::NoFlags;
    header.id = id;
    header.sequence = ++_sequence;
    if (const auto sent = send(header, data, sendLimit); !sent) return sent.error();
    if (!replyLimit) return Bytes{};
    return awaitReply(header.sequence, std::chrono::steady_clock::now() + *replyLimit);
}

Result<void, RemotePort::Error> HostRemotePort::send(const PortHeader& header, ByteView data,
                                                     std::chrono::nanoseconds limit) {
    Deadline deadline;  // known once the first try has failed: most messages never ask for the time
    for (bool isFirst = true;; isFirst = false) {
        const PortSent sent = sendPortMessage(_connection.get(), header, data);
        if (sent == PortSent::Sent) return {};
        if (sent == PortSent::Gone) return Error::Invalid;
        if (isFirst) deadline = std::chrono::steady_clock::now() + limit;
        if (!waitForPort(_connection.get(), POLLOUT, deadline)) return Error::SendTimedOut;
        // Ready and yet refused, when the system is short of memory: tried again until the time is up.
        if (std::chrono::steady_clock::now() > deadline) return Error::SendTimedOut;
    }
}

Result<Bytes, RemotePort::Error> HostRemotePort::awaitReply(std::uint32_t sequence, Deadline deadline) {
    while (true) {
        switch (_reader.read(_connection.get())) {
            case PortReader::Outcome::Closed: return Error::Invalid;
            case PortReader::Outcome::Garbage:
                logLine(Level::Error, "Port %s dropped a reply: %s", _name, _reader.problem());
                break;
            case PortReader::Outcome::Nothing:
                if (!waitForPort(_connection.get(), POLLIN, deadline)) return Error::ReplyTimedOut;
                break;
            case PortReader::Outcome::Message:  // an older number answers a request that was given up
                if (_reader.header().kind == PortHeader::Reply && _reader.header().sequence == sequence)
                    return Bytes(_reader.data().begin(), _reader.data().end());
        }
        if (std::chrono::steady_clock::now() > deadline) return Error::ReplyTimedOut;  // even under a flood
    }
}

// Outside a request the peer has nothing to say: what comes are late replies, and at last its end.
void HostRemotePort::readUnexpected() {
    for (int i = 0; i < kMessagesPerTurn; ++i) {
        switch (_reader.read(_connection.get())) {
            case PortReader::Outcome::Nothing: return;
            case PortReader::Outcome::Closed: return invalidate();
            case PortReader::Outcome::Garbage:
                logLine(Level::Error, "Port %s dropped a reply: %s", _name, _reader.problem());
                break;
            case PortReader::Outcome::Message: break;
        }
    }
}

void HostRemotePort::invalidate() {
    if (!_connection) return;
    _incoming.reset();
    _writable.reset();
    _connection.reset();
    const auto callback = std::exchange(_invalidationCallback, nullptr);
    if (callback) callback(*this);  // last of all: it may destroy the port
}

void HostRemotePort::setInvalidationCallback(std::function<void(RemotePort&)> callback) {
    _invalidationCallback = std::move(callback);
}

void HostRemotePort::notifyWhenWritable(std::function<void()> callback) {
    if (!_connection) return;
    _writable =
        std::make_unique<FdWatcher>(_connection.get(), FdWatcher::For::Writing, [this, call = std::move(callback)] {
            _writable.reset();
            call();
        });
}

}  // namespace kelvo
