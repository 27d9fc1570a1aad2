#include "tools/export/ChosenReadings.h"

#include <algorithm>

namespace kelvo {

namespace {

/// The number of the interval, also before 1970.
std::int64_t intervalOf(CaptureTime time, std::chrono::nanoseconds length) {
    const std::int64_t since = time.time_since_epoch().count();
    const std::int64_t number = since / length.count();
    return number * length.count() > since ? number - 1 : number;
}

bool isSame(const Value& a, const Value& b) {
    const Reading* one = a.reading();
    const Reading* other = b.reading();
    const bool isSameNumber =
        one != nullptr && other != nullptr && one->raw == other->raw && one->quantity == other->quantity;
    return isSameNumber || a == b;  // which compares the texts
}

}  // namespace

void ChosenReadings::take(const Moment& moment, std::span<const Written> readings) {
    if (readings.empty() || !wants(moment.time)) return;
    if (_choice.every) return hold(moment, readings);
    _rows.write(moment, _choice.changes ? changed(readings) : readings);
}

std::span<const Written> ChosenReadings::changed(std::span<const Written> readings) {
    _chosen.clear();
    for (const Written& reading : readings) {
        if (isSame(reading.series->last, *reading.value)) continue;
        reading.series->last = *reading.value;
        _chosen.push_back(reading);
    }
    return _chosen;
}

void ChosenReadings::hold(const Moment& moment, std::span<const Written> readings) {
    const std::int64_t interval = intervalOf(moment.time, *_choice.every);
    if (interval != _interval) endInterval();
    _interval = interval;
    for (const auto& [series, value] : readings) {
        if (series->heldAt == Series::kNotHeld) {
            series->heldAt = _held.size();
            _held.push_back({moment, series, *value});
        } else {
            _held[series->heldAt] = {moment, series, *value};
        }
    }
}

void ChosenReadings::endInterval() {
    std::ranges::stable_sort(_held, {}, [](const Held& held) { return held.moment.record; });
    for (std::size_t i = 0; i < _held.size();) {
        _chosen.clear();
        const Moment& moment = _choice.isOneMoment ? _held.back().moment : _held[i].moment;
        for (; i < _held.size() && (_choice.isOneMoment || _held[i].moment.record == moment.record); ++i) {
            _held[i].series->heldAt = Series::kNotHeld;
            _chosen.push_back({_held[i].series, &_held[i].value});
        }
        _rows.write(moment, _chosen);
    }
    _held.clear();
}

}  // namespace kelvo
