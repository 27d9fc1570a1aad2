#include "ui/TrendView.h"

#include <algorithm>
#include <cmath>

namespace kelvo {

namespace {

Trend::Time part(Trend::Time of, double shares) {
    return Trend::Time(static_cast<Trend::Time::rep>(std::llround(static_cast<double>(of.count()) * shares)));
}

}  // namespace

void TrendView::setNow(Time now) {
    _now = now;
    if (_end) endAt(*_end);
}

/// As near to `end` as the last half hour allows.
void TrendView::endAt(Time end) {
    if (end >= _now) return _end.reset();
    _end = std::max(end, _now - kLongest + _span);
    if (*_end >= _now) _end.reset();
}

void TrendView::moveBy(double shares) { endAt(to() - part(_span, shares)); }

void TrendView::setSpan(Time span) {
    _span = std::clamp(span, kShortest, kLongest);
    if (_end) endAt(*_end);
}

void TrendView::zoomBy(double factor, double share) {
    const Time kept = timeAt(share);
    const bool wasLive = isLive();
    setSpan(part(_span, std::clamp(factor, 0.01, 100.0)));
    if (!wasLive) endAt(kept + part(_span, 1 - share));
}

Trend::Time TrendView::timeAt(double share) const { return from() + part(_span, share); }

double TrendView::shareOf(Time time) const {
    return static_cast<double>((time - from()).count()) / static_cast<double>(_span.count());
}

}  // namespace kelvo
