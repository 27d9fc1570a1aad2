#include "telephony/wire/modem/SocketPort.h"

#include <fmt/format.h>

#include <QLocalSocket>
#include <QTcpSocket>
#include <utility>

#include "platform/host/HostEventLoop.h"

namespace kelvo::modem {
namespace {

constexpr qint64 kMostUnsent = 65'536;  // bytes that wait in a socket

// Connects a signal to a method that may throw, which Qt must not see.
template <class Signal, class Callback>
void on(const QIODevice* device, Signal signal, Callback callback) {
    QObject::connect(device, signal, device, [callback] { HostEventLoop::call(callback); });
}

}  // namespace

void SocketPort::welcome(QIODevice* reader) {
    if (_reader != nullptr) return reader->deleteLater();
    _reader = reader;
    on(reader, &QIODevice::readyRead, [this, reader] {
        const QByteArray bytes = reader->readAll();
        if (onReceived)
            onReceived(bytesOf(std::string_view(bytes.constData(), static_cast<std::size_t>(bytes.size()))));
    });
    on(reader, &QIODevice::bytesWritten, [this, reader] {
        if (onRoom && reader == _reader && reader->bytesToWrite() == 0) onRoom();
    });
    on(reader, &QIODevice::aboutToClose, [this, reader] {
        if (reader == _reader) leave();
    });
    if (onRoom) onRoom();
}

void SocketPort::leave() {
    if (QIODevice* const reader = std::exchange(_reader, nullptr)) reader->deleteLater();
}

void SocketPort::unplug() {
    close();
    if (auto* const socket = qobject_cast<QTcpSocket*>(_reader)) socket->disconnectFromHost();  // what is sent arrives
    if (auto* const socket = qobject_cast<QLocalSocket*>(_reader)) socket->disconnectFromServer();
    leave();
}

std::size_t SocketPort::send(ByteView bytes) {
    if (_reader == nullptr) return 0;
    const qint64 room = std::max<qint64>(kMostUnsent - _reader->bytesToWrite(), 0);
    const qint64 sent =
        _reader->write(reinterpret_cast<const char*>(bytes.data()), std::min(room, static_cast<qint64>(bytes.size())));
    return static_cast<std::size_t>(std::max<qint64>(sent, 0));
}

TcpPort::TcpPort(std::uint16_t port) : _port(port) {
    QObject::connect(&_server, &QTcpServer::newConnection, &_server, [this] {
        while (auto* const socket = _server.nextPendingConnection()) {
            socket->setParent(nullptr);  // the server closes before what was sent last has arrived
            QObject::connect(socket, &QTcpSocket::disconnected, socket, &QIODevice::close);
            welcome(socket);
        }
    });
}

Result<void> TcpPort::plugIn() {
    if (!_server.listen(QHostAddress::LocalHost, _port))
        return Failure{fmt::format("TCP port {} cannot be had: {}", _port, _server.errorString().toStdString())};
    _port = _server.serverPort();  // where it comes back
    return {};
}

std::string TcpPort::place() const { return fmt::format("tcp:127.0.0.1:{}", _port); }

UnixPort::UnixPort(std::filesystem::path path) : _path(std::move(path)) {
    _server.setSocketOptions(QLocalServer::UserAccessOption);
    QObject::connect(&_server, &QLocalServer::newConnection, &_server, [this] {
        while (auto* const socket = _server.nextPendingConnection()) {
            socket->setParent(nullptr);
            QObject::connect(socket, &QLocalSocket::disconnected, socket, &QIODevice::close);
            welcome(socket);
        }
    });
}

Result<void> UnixPort::plugIn() {
    const QString path = QString::fromStdString(_path.string());
    std::error_code error;
    if (std::filesystem::exists(std::filesystem::symlink_status(_path, error))) {  // which listen() would replace
        QLocalSocket someone;
        if (std::filesystem::is_socket(_path, error)) someone.connectToServer(path);
        if (someone.error() != QLocalSocket::ConnectionRefusedError)
            return Failure{_path.string() + " is there and no socket that a modem has left"};
        QLocalServer::removeServer(path);
    }
    if (!_server.listen(path))
        return Failure{
            fmt::format("{} cannot be listened on: {}", _path.string(), _server.errorString().toStdString())};
    return {};
}

}  // namespace kelvo::modem
