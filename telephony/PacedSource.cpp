#include "telephony/PacedSource.h"

#include <algorithm>
#include <utility>

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using std::chrono::nanoseconds;

constexpr int kRecordsPerTurn = 256;
constexpr int kRefusedBeforeRest = 1024;
constexpr double kLongestWaitNs = 1e18;  // some 30 years

}  // namespace

PacedSource::PacedSource(std::unique_ptr<RecordStream> stream, Speed speed, MainQueue& queue, SteadyTime now)
    : _stream(std::move(stream)), _speed(speed), _queue(queue), _now(std::move(now)) {}

void PacedSource::start(RecordSink& sink) {
    _sink = &sink;
    _due = _now();
    pumpAfter(0ns);
}

void PacedSource::feed() {
    if (_sink != nullptr && !_speed && !_waiting) pumpAfter(0ns);
}

void PacedSource::pumpAfter(nanoseconds delay) {
    _waiting = true;
    const auto run = _lifetime.whileAlive([this] {
        _waiting = false;
        pump();
    });
    if (delay > 0ns) {
        _queue.postAfter(delay, run);
    } else {
        _queue.post(run);
    }
}

void PacedSource::pump() {
    for (int i = 0; i < kRecordsPerTurn; ++i) {
        if (!_next && !readNext()) return;
        const nanoseconds wait = _due - _now();
        if (wait > 0ns) return pumpAfter(wait);
        if (!_speed && !_sink->isHungry()) return;  // feed() goes on
        give();
    }
    pumpAfter(0ns);  // the queue's other work has its turn
}

// False when there is nothing more to come.
bool PacedSource::readNext() {
    _next = _stream->next();
    if (!_next) return false;
    if (_last && _speed) _due += scaled(_next->time - *_last);
    _last = _next->time;
    return true;
}

void PacedSource::give() {
    if (hand(*_sink, *_next)) {
        _refused = 0;
    } else if (++_refused == kRefusedBeforeRest) {
        _refused = 0;
        if (!_speed) _due = _now() + 1s;  // a client that wants none of it stays hungry: no reason to spin
    }
    _next.reset();
}

nanoseconds PacedSource::scaled(nanoseconds interval) const {
    const double ns = static_cast<double>(interval.count()) / _speed.value_or(1.0);
    return nanoseconds(static_cast<std::int64_t>(std::clamp(ns, 0.0, kLongestWaitNs)));
}

}  // namespace kelvo
