#include "platform/host/PortServer.h"

#include <sys/socket.h>

#include <algorithm>
#include <cerrno>
#include <chrono>
#include <cstring>

#include "platform/system/Environment.h"

namespace kelvo {
namespace {

constexpr std::size_t kMaxConnections = 64;
constexpr std::size_t kMessagesPerTurn = 256;         // over all connections
constexpr std::chrono::milliseconds kTimePerTurn{8};  // for one connection: half a frame of the screen
constexpr std::chrono::milliseconds kRest{1};
constexpr int kAcceptsPerTurn = 16;
constexpr std::chrono::milliseconds kAcceptPause{500};

}  // namespace

PortServer::PortServer(PortClaim claim, std::string name, MessageCallback callback)
    : _claim(std::make_unique<PortClaim>(std::move(claim))), _name(std::move(name)), _callback(std::move(callback)) {
    _acceptAgain.setSingleShot(true);
    QObject::connect(&_acceptAgain, &QTimer::timeout, &_acceptAgain, [this] { _acceptor->setEnabled(true); });
    _rest.setSingleShot(true);
    _rest.setTimerType(Qt::PreciseTimer);
    QObject::connect(&_rest, &QTimer::timeout, &_rest, [this] {
        for (auto& [fd, connection] : _connections) connection.watcher->setEnabled(true);
    });
}

void PortServer::start() {
    if (!isOpen() || _acceptor) return;
    _acceptor = std::make_unique<FdWatcher>(_claim->listener(), FdWatcher::For::Reading, [this] { accept(); });
}

void PortServer::close() {
    _acceptAgain.stop();
    _rest.stop();
    _acceptor.reset();
    _connections.clear();
    _claim.reset();
}

void PortServer::accept() {
    for (int i = 0; i < kAcceptsPerTurn; ++i) {
        UniqueFd fd(::accept4(_claim->listener(), nullptr, nullptr, SOCK_NONBLOCK | SOCK_CLOEXEC));
        if (fd) {
            _toldNoDescriptors = false;
            admit(std::move(fd));
        } else if (errno == EMFILE || errno == ENFILE || errno == ENOBUFS || errno == ENOMEM) {
            return pauseAccepting();
        } else if (errno != EINTR && errno != ECONNABORTED) {
            return;
        }
    }
}

void PortServer::admit(UniqueFd fd) {
    if (!isPeerOfThisUser(fd.get())) return logLine(Level::Error, "Port %s refused another user's process", _name);
    if (_connections.size() >= kMaxConnections) {
        if (!std::exchange(_toldFull, true)) logLine(Level::Error, "Port %s has too many senders", _name);
        return;
    }
    const int number = fd.get();
    Connection& connection = _connections[number];
    connection.fd = std::move(fd);
    connection.watcher =
        std::make_unique<FdWatcher>(number, FdWatcher::For::Reading, [this, number] { receive(number); });
}

// The sender that could not be accepted keeps the listening socket ready: without a pause this would spin.
void PortServer::pauseAccepting() {
    if (!std::exchange(_toldNoDescriptors, true))
        logLine(Level::Error, "Port %s cannot accept a sender: %s", _name, std::strerror(errno));
    _acceptor->setEnabled(false);
    _acceptAgain.start(kAcceptPause);
}

void PortServer::receive(int fd) {
    if (_delivering) return;  // a callback that runs the event loop gets no second message before it has returned
    const auto self = shared_from_this();
    _delivering = true;
    const std::size_t share = std::max<std::size_t>(1, kMessagesPerTurn / _connections.size());
    const auto end = std::chrono::steady_clock::now() + kTimePerTurn;
    std::size_t taken = 0;
    bool isDrained = false;
    while (taken < share && isOpen() && !isDrained) {
        if (receiveOne(fd)) {
            ++taken;
            if (std::chrono::steady_clock::now() > end) break;
        } else {
            isDrained = true;
        }
    }
    _delivering = false;
    if (isDrained && taken > 1) rest(fd);
}

// A reader that outruns its sender would fall asleep between any two messages, and waking it costs the sender more than
// sending. So under load the next messages wait for each other.
void PortServer::rest(int fd) {
    const auto found = _connections.find(fd);
    if (found == _connections.end()) return;
    found->second.watcher->setEnabled(false);
    if (!_rest.isActive()) _rest.start(kRest);
}

bool PortServer::receiveOne(int fd) {
    switch (_reader.read(fd)) {
        case PortReader::Outcome::Nothing: return false;
        case PortReader::Outcome::Closed:
            _connections.erase(fd);
            _toldFull = false;
            return false;
        case PortReader::Outcome::Garbage:
            logLine(Level::Error, "Port %s dropped a message: %s", _name, _reader.problem());
            return true;
        case PortReader::Outcome::Message: break;
    }
    const PortHeader header = _reader.header();
    if (header.kind != PortHeader::Message) {
        logLine(Level::Error, "Port %s dropped a message: nobody waits for a reply", _name);
        return true;
    }
    const Bytes reply = _callback(header.id, _reader.data());
    if (isOpen() && (header.flags & PortHeader::WantsReply) != 0) answer(fd, header, reply);
    return true;
}

void PortServer::answer(int fd, const PortHeader& request, ByteView reply) {
    if (reply.size() > kMaxMessageSize) return logLine(Level::Error, "Port %s dropped a reply: it is too long", _name);
    PortHeader header;
    header.kind = PortHeader::Reply;
    header.id = request.id;
    header.sequence = request.sequence;
    // A sender that does not read its replies loses them; one that has gone is noticed at the next read.
    if (sendPortMessage(fd, header, reply) == PortSent::WouldBlock && !std::exchange(_connections[fd].lostReply, true))
        logLine(Level::Error, "Port %s dropped a reply: its sender reads none", _name);
}

}  // namespace kelvo
