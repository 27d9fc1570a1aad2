#include "telephony/line/SocketLine.h"

#include <fmt/format.h>

#include <QLocalSocket>
#include <QTcpSocket>
#include <QTimer>

#include "platform/host/HostEventLoop.h"

namespace kelvo {
namespace {

constexpr int kReadsPerTurn = 16;
constexpr qint64 kReadBuffer = 1 << 20;
constexpr int kConnectLimitMs = 5'000;

std::string reasonOf(const QTcpSocket& socket) {
    switch (socket.error()) {
        case QAbstractSocket::RemoteHostClosedError: return "it hung up";
        case QAbstractSocket::ConnectionRefusedError: return kNobodyIsThere;
        default: return socket.errorString().toStdString();
    }
}

std::string reasonOf(const QLocalSocket& socket) {
    switch (socket.error()) {
        case QLocalSocket::PeerClosedError: return "it hung up";
        case QLocalSocket::ServerNotFoundError:
        case QLocalSocket::ConnectionRefusedError: return kNobodyIsThere;
        case QLocalSocket::SocketAccessError: return "Permission denied";
        default: return socket.errorString().toStdString();
    }
}

}  // namespace

std::unique_ptr<ModemLine> SocketLine::toTcp(std::string host, std::uint16_t port, Listener& listener) {
    auto* const socket = new QTcpSocket;
    std::unique_ptr<SocketLine> line(new SocketLine(socket, fmt::format("tcp:{}:{}", host, port), listener));
    line->_connect = [socket, host = QString::fromStdString(host), port] { socket->connectToHost(host, port); };
    return line;
}

std::unique_ptr<ModemLine> SocketLine::toUnix(std::string path, Listener& listener) {
    auto* const socket = new QLocalSocket;
    std::unique_ptr<SocketLine> line(new SocketLine(socket, "unix:" + path, listener));
    line->_connect = [socket, path = QString::fromStdString(path)] { socket->connectToServer(path); };
    return line;
}

template <class Socket>
SocketLine::SocketLine(Socket* socket, std::string name, Listener& listener)
    : _name(std::move(name)), _listener(listener), _socket(socket), _rest(*socket) {
    socket->setReadBufferSize(kReadBuffer);
    auto* const limit = new QTimer(socket);
    limit->setSingleShot(true);
    const auto heard = [](auto call) { HostEventLoop::call(call); };
    QObject::connect(limit, &QTimer::timeout, socket,
                     [heard, late = _lifetime.whileAlive([this] { close("no answer"); })] { heard(late); });
    QObject::connect(socket, &Socket::connected, socket, [=, this] {
        limit->stop();
        heard([this] { _listener.lineOpened(); });
    });
    QObject::connect(socket, &QIODevice::readyRead, socket, [=, this] { heard([this] { read(); }); });
    QObject::connect(socket, &Socket::disconnected, socket, [=, this] { heard([this] { close("it hung up"); }); });
    QObject::connect(socket, &Socket::errorOccurred, socket,
                     [=, this] { heard([=, this] { close(reasonOf(*socket)); }); });
    limit->start(kConnectLimitMs);
}

SocketLine::~SocketLine() {
    _socket->disconnect();
    _socket->close();
    _socket->deleteLater();
}

void SocketLine::send(ByteView frame) {
    _socket->write(reinterpret_cast<const char*>(frame.data()), static_cast<qint64>(frame.size()));
}

void SocketLine::mute() {
    _muted = true;
    _socket->disconnect();
}

void SocketLine::read() {
    std::size_t given = 0;
    for (int i = 0; i < kReadsPerTurn && !_muted && _socket->isOpen(); ++i) {
        const qint64 size = _socket->read(reinterpret_cast<char*>(_buffer.data()), static_cast<qint64>(_buffer.size()));
        if (size <= 0) return _rest.after(given);
        given += static_cast<std::size_t>(size);
        _listener.lineGave(std::span(_buffer).first(static_cast<std::size_t>(size)));
    }
    if (_muted || !_socket->isOpen()) return;
    // The queue's other work has its turn; the line may go meanwhile, before its socket does.
    QMetaObject::invokeMethod(
        _socket, [again = _lifetime.whileAlive([this] { read(); })] { HostEventLoop::call(again); },
        Qt::QueuedConnection);
}

void SocketLine::close(const std::string& reason) {
    if (_muted) return;
    read();  // what came before the end
    if (_muted) return;
    mute();
    _listener.lineClosed(reason);
}

}  // namespace kelvo
