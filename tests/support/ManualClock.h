#pragma once

#include "platform/system/Clock.h"

namespace kelvo::test {

/// A clock that stands where the test puts it, in a zone of the test's choice.
class ManualClock final : public Clock {
public:
    /// `unixSeconds` since 1970-01-01 00:00 UTC, `zoneMinutes` east of UTC.
    explicit ManualClock(long long unixSeconds = 0, int zoneMinutes = 0, bool daylight = false)
        : _now(std::chrono::seconds(unixSeconds)), _zoneMinutes(zoneMinutes), _daylight(daylight) {}

    TimePoint now() const override { return _now; }
    std::tm local(TimePoint time) const override {
        const std::time_t shifted = std::chrono::system_clock::to_time_t(time) + _zoneMinutes * 60;
        std::tm broken{};
        gmtime_r(&shifted, &broken);
        broken.tm_gmtoff = _zoneMinutes * 60L;
        broken.tm_isdst = _daylight ? 1 : 0;
        return broken;
    }
    void advance(std::chrono::nanoseconds by) { _now += std::chrono::duration_cast<TimePoint::duration>(by); }

private:
    TimePoint _now;
    int _zoneMinutes;
    bool _daylight;
};

}  // namespace kelvo::test
