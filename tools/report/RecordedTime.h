#pragma once

#include <chrono>
#include <cstdint>
#include <vector>

#include "overview/Event.h"

namespace kelvo::report {

/// How far into the recording something is.
using Elapsed = std::chrono::microseconds;

/// A piece of a recording in which the records' times go on.
struct Stretch {
    Elapsed at;           ///< where it begins
    overview::Time time;  ///< which time that is
};

/// Turns the records' times into one that only goes forward: what was recorded, without the pauses. A pause is more
/// than five minutes without a record, or a time that goes back, as where captures were put together; records that
/// come a little out of order are at the same time. Both begin a new stretch at the very place where the last one
/// ended.
class RecordedTime {
public:
    static constexpr auto kPause = std::chrono::minutes(5);
    static constexpr auto kDisorder = std::chrono::seconds(2);
    static constexpr std::size_t kMostStretches =
        1000;  ///< further ones are counted, and go with the last that is kept

    /// Where a record of that time is.
    Elapsed note(overview::Time time);

    Elapsed length() const { return _elapsed; }
    const std::vector<Stretch>& stretches() const { return _stretches; }
    std::uint64_t pauses() const { return _pauses; }
    overview::Time earliest() const { return _earliest; }
    overview::Time latest() const { return _latest; }
    /// Every record has had the same time: a recording without times, or one record.
    bool isTimeless() const { return _earliest == _latest; }

private:
    void begin(overview::Time time);

    std::vector<Stretch> _stretches;
    Elapsed _elapsed{0};
    overview::Time _now{};  // as far as the stretch has come
    overview::Time _earliest{};
    overview::Time _latest{};
    std::uint64_t _pauses = 0;
};

}  // namespace kelvo::report
