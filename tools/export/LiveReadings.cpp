#include "tools/export/LiveReadings.h"

#include <fmt/format.h>
#include <unistd.h>

#include <QCoreApplication>
#include <array>
#include <csignal>
#include <cstring>

#include "LogGenerator/RecordLedger.h"
#include "platform/host/HostEventLoop.h"
#include "platform/host/HostMainQueue.h"
#include "platform/host/HostMessagePorts.h"
#include "platform/host/HostTelephonyClient.h"
#include "platform/host/UnixSignals.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

CaptureTime timeOfRecord(Technology technology, ByteView message) {
    constexpr std::size_t kTimestampAt = 5;
    const ByteView packet = hasCodes(technology) ? RecordLedger::packetOf(message) : ByteView();
    std::uint64_t timestamp = 0;
    if (!packet.empty()) std::memcpy(&timestamp, packet.data() + kTimestampAt, sizeof timestamp);
    return timeOf(timestamp).value_or(CaptureTime(clock().now().time_since_epoch()));
}

}  // namespace

LiveReadings::LiveReadings(const Services& services, const Choice& choice, ValueGlobs& globs, ReadingRows& rows)
    : _choice(choice),
      _globs(globs),
      _rows(rows),
      _tell(services.tell),
      _model({.queue = services.queue,
              .ports = services.ports,
              .telephony = services.telephony,
              .updateViewControllerFromModel = [] {},
              .portName = fmt::format("{}.export.{}", KelvoModel::kLogChannelPortName, getpid()),
              .connectionChanged = [this] { tellConnection(); },
              .recordShown = [this](ByteView message) { take(message); }}) {
    services.queue.post([this] { _model.restartMonitor(); });
}

ReadInput LiveReadings::end() {
    if (_readings) _readings->end();
    _rows.endInput(_read);
    return _read;
}

void LiveReadings::take(ByteView message) {
    if (!_readings) {
        _read.technology = _model.technology().value_or(Technology::LTE);
        _readings.emplace(_read.technology, _choice, _globs, _rows);
    }
    const CaptureTime time = timeOfRecord(_read.technology, message);
    _read.records = _model.recordCount();
    if (!_read.first) _read.first = time;
    _read.last = time;
    _readings->take({.time = time,
                     .technology = _read.technology,
                     .code = codeOf(_read.technology, message),
                     .record = _read.records},
                    _model.display());
}

void LiveReadings::tellConnection() {
    const Connection connection = _model.connection();
    const std::string text = connectionText(connection);
    const bool goesOn = connection.isSilent() && _isSilent;  // how long it has been so far is told on screens
    if (!text.empty() && text != _told && !goesOn) _tell(text);
    _isSilent = connection.isSilent();
    _told = text;
}

void readLive(const Choice& choice, ValueGlobs& globs, ReadingRows& rows) {
    std::string name = "kelvoctl";
    std::array<char*, 2> arguments{name.data(), nullptr};
    int count = 1;
    const QCoreApplication application(count, arguments.data());
    Environment silent = Environment::current();
    silent.log = nullptr;
    const Environment::Scope scope(silent);
    const UnixSignals unixSignals({SIGINT, SIGTERM, SIGHUP}, [](int) { QCoreApplication::quit(); });
    HostMainQueue queue;
    HostMessagePorts ports;
    HostTelephonyClient telephony(ports);
    const auto tell = [](const std::string& why) { fmt::print(stderr, "kelvoctl: {}\n", why); };
    LiveReadings live({queue, ports, telephony, tell}, choice, globs, rows);
    HostEventLoop::run(QCoreApplication::exec);
    live.end();
}

}  // namespace kelvo
