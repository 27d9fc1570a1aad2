#include "telephony/ModemSource.h"

#include <algorithm>
#include <utility>

#include "platform/system/Environment.h"
#include "telephony/PortStatus.h"
#include "telephony/adaptation/StandIns.h"
#include "telephony/wire/Timestamp.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using std::chrono::nanoseconds;

constexpr nanoseconds kGrace = 6s;  // longer than a client waits before it tries again
constexpr nanoseconds kFirstPause = 100ms;
constexpr nanoseconds kLongestPause = 1s;

/// What newer modems send in place of `codes`.
RecordFilter::Codes insteadOf(const RecordFilter::Codes& codes) {
    RecordFilter::Codes instead;
    for (const LogCode code : adaptation::codesWithStandIns()) {
        if (!codes.test(code)) continue;
        for (const LogCode standIn : adaptation::standInsFor(code)) instead.set(standIn);
    }
    return instead;
}

}  // namespace

ModemSource::ModemSource(std::unique_ptr<ModemLines> lines, wire::Session::Options options, MainQueue& queue,
                         SteadyTime now)
    : _lines(std::move(lines)),
      _queue(queue),
      _now(now),
      _session(*this, std::move(now), options),
      _pause(kFirstPause) {}

void ModemSource::findTechnology() {
    needAWhile();
    openLine();
}

void ModemSource::clientsWant(const ClientsWishes& wishes) {
    const bool streamed = std::exchange(_streaming, wishes.streaming);
    _session.want(wishes.ordinary, insteadOf(wishes.ordinary));
    if (_streaming) {
        openLine();
    } else if (streamed) {
        needAWhile();
    }
    settle();
}

void ModemSource::end(std::function<void()> done) {
    _ending = true;
    _done = std::move(done);
    _lines->watch({});
    if (!_talking) return finish();
    settle();
}

DictionaryRef ModemSource::portStatus() const {
    return kelvo::portStatus(_session, _meter, _line ? _line->name() : "");
}

void ModemSource::sendToModem(ByteView bytes) { _line->send(bytes); }

ModemSource::Taken ModemSource::takeRecord(ByteView packet, std::uint64_t timestamp) {
    if (_sink == nullptr) return Taken::ForNobody;
    const adaptation::Adapted adapted = _adapter.adapt(packet);
    const bool refused = adapted.outcome == adaptation::Adapted::Outcome::Refused;
    if (refused && adapted.refusal == adaptation::Refusal::NotOurs) return Taken::ForNobody;
    const auto time = wire::timeOf(timestamp);
    const CapturePacket taken{time ? *time : CaptureTime(clock().now().time_since_epoch()), adapted.packet};
    if (!refused && !hand(*_sink, taken)) return Taken::ForNobody;
    if (const auto first = _meter.count(adapted)) logLine(Level::Warning, "%s: %s", description(), *first);
    return refused ? Taken::Refused : Taken::Delivered;
}

void ModemSource::lineOpened() {
    _talking = true;
    _session.begin(_line->name());
    settle();
}

void ModemSource::lineGave(std::span<std::uint8_t> bytes) {
    recordFrames(bytes);
    _session.receive(bytes);
    settle();
}

void ModemSource::lineClosed(const std::string& reason) {
    const bool talked = std::exchange(_talking, false);
    _session.lose();
    dropLine();
    if (_ending) return finish();
    if (!isNeeded()) return release();
    if (talked) {
        tell("the modem has gone: " + reason);
    } else if (_trouble.empty() || reason != kNobodyIsThere) {
        tell("it cannot be opened: " + reason);
    }
    retry();
}

// As if the last client had left now.
void ModemSource::needAWhile() {
    _neededUntil = _now() + kGrace;
    _queue.postAfter(kGrace, _lifetime.whileAlive([this] { settle(); }));
}

void ModemSource::openLine() {
    if (_line || _waiting || _ending) return;
    auto line = _lines->next(*this, std::exchange(_ranBefore, false));
    if (!line) {
        if (_trouble.empty()) tell("it cannot be opened: " + line.error().reason);  // one that has gone is not there
        return retry();
    }
    _line = std::move(line).value();
    _line->open();
}

// The line may be what calls: it goes with the queue's next task.
void ModemSource::dropLine() {
    if (!_line) return;
    _line->mute();
    _queue.post([gone = std::shared_ptr<ModemLine>(std::move(_line))] {});
}

void ModemSource::retry() {
    _waiting = true;
    const auto again = _lifetime.whileAlive([this] {
        if (!std::exchange(_waiting, false)) return;
        _lines->watch({});
        isNeeded() ? openLine() : release();
    });
    _lines->watch(again);
    _queue.postAfter(_pause, again);
    _pause = std::min(2 * _pause, kLongestPause);
}

// Whatever is due, after anything has happened.
void ModemSource::settle() {
    if (!_talking) return;
    _session.tick();
    if (_session.state() == State::Running) {
        _ranBefore = true;
        _pause = kFirstPause;
        if (!std::exchange(_trouble, {}).empty()) logLine(Level::Notice, "%s: the modem is back", _line->name());
    }
    if (!isNeeded()) _session.end();
    _line->mayGather(_session.state() == State::Running && !_session.isAsking());
    if (_session.state() == State::Closed) return hangUp();
    arm();
}

// The session is over, and the modem silenced.
void ModemSource::hangUp() {
    _talking = false;
    dropLine();
    if (_ending) return finish();
    if (!isNeeded()) return release();
    if (!_session.failure().empty()) tell(_session.failure());
    retry();
}

void ModemSource::release() {
    _session.forgetTechnology();
    _trouble.clear();
    _pause = kFirstPause;
}

void ModemSource::arm() {
    const auto deadline = _session.deadline();
    if (!deadline || (_armed && *_armed <= *deadline)) return;
    _armed = deadline;
    _queue.postAfter(std::max(*deadline - _now(), 0ns), _lifetime.whileAlive([this, at = *deadline] {
        if (_armed == at) _armed.reset();
        settle();
    }));
}

void ModemSource::tell(const std::string& trouble) {
    if (std::exchange(_trouble, trouble) == trouble) return;
    logLine(Level::Warning, "%s: %s; trying again", description(), trouble);
}

void ModemSource::finish() {
    if (const auto done = std::exchange(_done, nullptr)) done();
}

void ModemSource::recordFrames(ByteView bytes) {
    if (!_frames) return;
    auto written = _frames->write(bytes);
    if (written) written = _frames->appear();
    if (written) return;
    logLine(Level::Error, "The recording of frames ends here: %s", written.error().reason);
    _frames.reset();
}

}  // namespace kelvo
