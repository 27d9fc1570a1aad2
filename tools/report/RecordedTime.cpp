#include "tools/report/RecordedTime.h"

#include <algorithm>

namespace kelvo::report {

Elapsed RecordedTime::note(overview::Time time) {
    if (_stretches.empty()) {
        _earliest = _latest = time;
        begin(time);
        return _elapsed;
    }
    _earliest = std::min(_earliest, time);
    _latest = std::max(_latest, time);
    // Compared and not subtracted: a file may claim times so far apart that no number holds the difference.
    const bool isBack = time < _now && (_now > overview::Time::min() + kDisorder) && time < _now - kDisorder;
    const bool isPause = time > _now && (_now < overview::Time::max() - kPause) && time > _now + kPause;
    if (isBack || isPause) {
        ++_pauses;
        begin(time);
    } else if (time > _now) {
        _elapsed += time - _now;
        _now = time;
    }
    return _elapsed;
}

void RecordedTime::begin(overview::Time time) {
    _now = time;
    if (_stretches.size() < kMostStretches) _stretches.push_back({_elapsed, time});
}

}  // namespace kelvo::report
