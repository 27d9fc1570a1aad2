#pragma once

#include <chrono>
#include <optional>

#include "model/Trends.h"

namespace kelvo {

/// Which stretch of time a chart shows: 30 seconds to 30 minutes of the last half hour. It ends now, and goes on with
/// the time, until it is moved back; moved to its end again it goes on again.
class TrendView {
public:
    using Time = Trend::Time;
    static constexpr Time kShortest = std::chrono::seconds(30);
    static constexpr Time kLongest = Trends::kSpan;

    void setNow(Time now);
    Time now() const { return _now; }
    Time span() const { return _span; }
    Time to() const { return _end.value_or(_now); }
    Time from() const { return to() - _span; }
    bool isLive() const { return !_end; }

    /// `shares` of what is seen, to the past when positive: as content that follows a finger to the right.
    void moveBy(double shares);
    /// Shows `factor` times as much; what stands at `share` of the way from left to right keeps its place. A live view
    /// stays live.
    void zoomBy(double factor, double share);
    void setSpan(Time span);
    void showLatest() { _end.reset(); }

    Time timeAt(double share) const;
    double shareOf(Time time) const;

private:
    void endAt(Time end);

    Time _now{0};
    Time _span = std::chrono::minutes(5);
    std::optional<Time> _end;
};

}  // namespace kelvo
