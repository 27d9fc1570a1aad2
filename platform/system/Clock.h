#pragma once

#include <chrono>
#include <ctime>

namespace kelvo {

/// The time of day and the local time zone.
class Clock {
public:
    using TimePoint = std::chrono::system_clock::time_point;

    virtual ~Clock() = default;
    virtual TimePoint now() const = 0;
    /// `time` in the local zone; tm_gmtoff (seconds east of UTC) and tm_isdst are filled in.
    virtual std::tm local(TimePoint time) const = 0;
};

/// The machine's clock and zone.
class SystemClock final : public Clock {
public:
    TimePoint now() const override { return std::chrono::system_clock::now(); }
    std::tm local(TimePoint time) const override;
};

}  // namespace kelvo
