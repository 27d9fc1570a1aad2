#include "telephony/line/SerialLine.h"

#include "platform/host/HostEventLoop.h"

namespace kelvo {
namespace {

constexpr int kReadsPerTurn = 16;
constexpr qint64 kReadBuffer = 1 << 20;

}  // namespace

SerialLine::SerialLine(std::string path, Options options, Listener& listener)
    : _path(std::move(path)), _options(options), _listener(listener), _port(new QSerialPort), _rest(*_port) {
    _port->setPortName(QString::fromStdString(_path));
    _port->setBaudRate(QSerialPort::Baud115200);
    _port->setReadBufferSize(kReadBuffer);
    QObject::connect(_port, &QSerialPort::readyRead, _port, [this] { HostEventLoop::call([this] { read(); }); });
    QObject::connect(_port, &QSerialPort::errorOccurred, _port, [this](QSerialPort::SerialPortError error) {
        // What a pseudo-terminal has not (control lines) is no reason to give it up.
        if (error == QSerialPort::NoError || error == QSerialPort::UnsupportedOperationError || !_port->isOpen())
            return;
        // The system's own words for a node that has gone are those of whatever was tried last: an end is no error to
        // it.
        const bool gone = error == QSerialPort::ResourceError || error == QSerialPort::ReadError;
        const std::string reason = gone ? "it hung up" : _port->errorString().toStdString();
        HostEventLoop::call([&] { close(reason); });
    });
}

SerialLine::~SerialLine() {
    _port->disconnect();
    _port->close();
    _port->deleteLater();
}

void SerialLine::open() {
    if (!_port->open(QIODevice::ReadWrite)) return _listener.lineClosed(_port->errorString().toStdString());
    _port->setDataTerminalReady(_options.controlLines);
    _port->setRequestToSend(_options.controlLines);
    _port->clear();
    _listener.lineOpened();
}

void SerialLine::send(ByteView frame) {
    _port->write(reinterpret_cast<const char*>(frame.data()), static_cast<qint64>(frame.size()));
}

void SerialLine::mute() {
    _muted = true;
    _port->disconnect();
}

void SerialLine::read() {
    std::size_t given = 0;
    for (int i = 0; i < kReadsPerTurn && !_muted; ++i) {
        const qint64 size = _port->read(reinterpret_cast<char*>(_buffer.data()), static_cast<qint64>(_buffer.size()));
        if (size <= 0) return _rest.after(given);
        given += static_cast<std::size_t>(size);
        _listener.lineGave(std::span(_buffer).first(static_cast<std::size_t>(size)));
    }
    if (_muted) return;
    // The queue's other work has its turn; the line may go meanwhile, before its port does.
    QMetaObject::invokeMethod(
        _port, [again = _lifetime.whileAlive([this] { read(); })] { HostEventLoop::call(again); },
        Qt::QueuedConnection);
}

void SerialLine::close(const std::string& reason) {
    read();  // what came before the end
    if (_muted) return;
    mute();
    _listener.lineClosed(reason);
}

}  // namespace kelvo
