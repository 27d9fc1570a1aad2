#include "telephony/ReplaySource.h"

#include <algorithm>
#include <utility>

#include "platform/Environment.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using std::chrono::nanoseconds;

constexpr int kRecordsPerTurn = 256;
constexpr nanoseconds kLongPause = 60s;
constexpr double kLongestWaitNs = 1e18;  // some 30 years

}  // namespace

Result<std::unique_ptr<ReplaySource>> ReplaySource::open(const std::filesystem::path& path, Options options,
                                                         MainQueue& queue, Now now) {
    auto reader = CaptureReader::open(path);
    if (!reader) return reader.error();
    const auto technology = reader->technology();
    if (!technology) return Failure{path.string() + ": its link type is none of a modem's log (147 to 151)"};
    return std::unique_ptr<ReplaySource>(
        new ReplaySource(path, std::move(reader).value(), *technology, options, queue, std::move(now)));
}

ReplaySource::ReplaySource(std::filesystem::path path, CaptureReader reader, Technology technology, Options options,
                           MainQueue& queue, Now now)
    : _path(std::move(path)),
      _reader(std::move(reader)),
      _technology(technology),
      _options(options),
      _queue(queue),
      _now(std::move(now)) {}

void ReplaySource::start(RecordSink& sink) {
    _sink = &sink;
    _passStart = _due = _now();
    pumpAfter(0ns);
}

void ReplaySource::feed() {
    if (_sink != nullptr && !_options.speed && !_waiting) pumpAfter(0ns);
}

void ReplaySource::pumpAfter(nanoseconds delay) {
    _waiting = true;
    const auto run = [this, alive = _alive] {
        if (!*alive) return;
        _waiting = false;
        pump();
    };
    if (delay > 0ns) {
        _queue.postAfter(delay, run);
    } else {
        _queue.post(run);
    }
}

void ReplaySource::pump() {
    for (int i = 0; i < kRecordsPerTurn; ++i) {
        if (!_next && !readNext()) return;
        const nanoseconds wait = timeUntilNext();
        if (wait > 0ns) return pumpAfter(wait);
        if (!_options.speed && !_sink->isHungry()) return;  // feed() goes on
        _taken |= _sink->take(_next->bytes);
        _next.reset();
    }
    pumpAfter(0ns);  // the queue's other work has its turn
}

// False when there is nothing more to come.
bool ReplaySource::readNext() {
    while (true) {
        auto read = _reader.next();
        if (!read && !std::exchange(_toldFailure, true)) logLine(Level::Error, read.error().reason);
        if (read && *read) {
            _next = **read;
            setDueTime();
            return true;
        }
        if (_packets == 0 || !_options.loop || !beginNextPass()) return false;
    }
}

bool ReplaySource::beginNextPass() {
    auto reader = CaptureReader::open(_path);
    if (!reader) {
        logLine(Level::Error, reader.error().reason);
        return false;
    }
    _reader = std::move(reader).value();
    // At full speed only a pass that nobody wanted any record of needs a rest.
    const nanoseconds gap = _options.speed ? scaled(typicalInterval()) : _taken ? 0ns : nanoseconds(1s);
    _passStart = _due = (_options.speed ? _due : _now()) + gap;
    _packets = 0;
    _taken = false;
    return true;
}

void ReplaySource::setDueTime() {
    if (_packets++ == 0) _first = _last = _next->time;
    if (!_options.speed) return;
    const nanoseconds before = _due;
    _due = std::max(before, _passStart + scaled(_next->time - _first));
    _last = std::max(_last, _next->time);
    if (_due - before >= kLongPause)
        logLine(Level::Notice, "The capture pauses for %d seconds", (_due - before) / std::chrono::seconds(1));
}

nanoseconds ReplaySource::timeUntilNext() { return _due - _now(); }

nanoseconds ReplaySource::scaled(nanoseconds captured) const {
    const double ns = static_cast<double>(captured.count()) / _options.speed.value_or(1.0);
    return nanoseconds(static_cast<std::int64_t>(std::clamp(ns, 0.0, kLongestWaitNs)));
}

nanoseconds ReplaySource::typicalInterval() const {
    if (_packets < 2) return 1s;
    const nanoseconds mean = (_last - _first) / static_cast<std::int64_t>(_packets - 1);
    return std::clamp<nanoseconds>(mean, 10ms, 1s);
}

}  // namespace kelvo
