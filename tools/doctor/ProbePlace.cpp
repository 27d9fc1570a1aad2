#include "tools/doctor/ProbePlace.h"

#include <fmt/format.h>

#include <QLocalSocket>
#include <QSerialPort>
#include <QTcpSocket>
#include <charconv>
#include <memory>

#include "platform/values/Result.h"

namespace kelvo {
namespace {

using Opened = Result<std::unique_ptr<QIODevice>>;

constexpr int kConnectMs = 2000;
constexpr std::string_view kTcp = "tcp:";
constexpr std::string_view kUnix = "unix:";

Opened openTcp(std::string_view address) {
    const std::size_t colon = address.rfind(':');
    std::uint16_t port = 0;
    if (colon != std::string_view::npos)
        std::from_chars(address.data() + colon + 1, address.data() + address.size(), port);
    if (port == 0) return Failure{fmt::format("tcp:{} is no HOST:PORT", address)};
    auto socket = std::make_unique<QTcpSocket>();
    socket->connectToHost(QString::fromUtf8(address.data(), static_cast<qsizetype>(colon)), port);
    if (!socket->waitForConnected(kConnectMs)) return Failure{socket->errorString().toStdString()};
    return std::unique_ptr<QIODevice>(std::move(socket));
}

Opened openUnix(std::string_view path) {
    auto socket = std::make_unique<QLocalSocket>();
    socket->connectToServer(QString::fromUtf8(path.data(), static_cast<qsizetype>(path.size())));
    if (!socket->waitForConnected(kConnectMs)) return Failure{socket->errorString().toStdString()};
    return std::unique_ptr<QIODevice>(std::move(socket));
}

Opened openSerial(const std::string& path) {
    auto serial = std::make_unique<QSerialPort>(QString::fromStdString(path));
    serial->setBaudRate(QSerialPort::Baud115200);
    if (!serial->open(QIODevice::ReadWrite)) return Failure{serial->errorString().toStdString()};
    serial->clear();
    return std::unique_ptr<QIODevice>(std::move(serial));
}

Opened open(const std::string& place) {
    if (place.starts_with(kTcp)) return openTcp(std::string_view(place).substr(kTcp.size()));
    if (place.starts_with(kUnix)) return openUnix(std::string_view(place).substr(kUnix.size()));
    return openSerial(place);
}

class QtPort final : public ProbedPort {
public:
    explicit QtPort(std::unique_ptr<QIODevice> device) : _device(std::move(device)) {}

    void write(ByteView bytes) override {
        _device->write(reinterpret_cast<const char*>(bytes.data()), static_cast<qint64>(bytes.size()));
    }
    Bytes read(std::chrono::nanoseconds limit) override {
        const auto ms = std::chrono::ceil<std::chrono::milliseconds>(limit).count();
        if (_device->bytesAvailable() == 0 && !_device->waitForReadyRead(static_cast<int>(ms))) _open = !hasEnded();
        const QByteArray bytes = _device->readAll();
        return Bytes(bytes.begin(), bytes.end());
    }
    bool isOpen() const override { return _open; }

private:
    // A wait may end because its time is over, or because the other end has gone.
    bool hasEnded() const {
        if (const auto* socket = qobject_cast<const QTcpSocket*>(_device.get()))
            return socket->state() != QAbstractSocket::ConnectedState;
        if (const auto* socket = qobject_cast<const QLocalSocket*>(_device.get()))
            return socket->state() != QLocalSocket::ConnectedState;
        const auto* serial = qobject_cast<const QSerialPort*>(_device.get());
        return serial->error() != QSerialPort::NoError && serial->error() != QSerialPort::TimeoutError;
    }

    const std::unique_ptr<QIODevice> _device;
    bool _open = true;
};

}  // namespace

ModemProbe probePlace(const std::string& place) {
    auto device = open(place);
    if (!device) return {.failure = "cannot be opened: " + device.error().reason};
    QtPort port(std::move(device).value());
    return probeModem(port, steadyNow);
}

}  // namespace kelvo
