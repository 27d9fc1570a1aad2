#pragma once

#include <chrono>
#include <cstdint>
#include <optional>

namespace kelvo {

/// Times as they are, or shifted: the first becomes the beginning of 2020 (UTC), and intervals stay. The modem's clock
/// and the computer's are shifted each by itself, so that neither tells the other's time.
class SharedTimes {
public:
    using Time = std::chrono::sys_time<std::chrono::nanoseconds>;

    explicit SharedTimes(bool shift) : _shift(shift) {}

    bool shifts() const { return _shift; }
    /// The computer's clock; nothing becomes earlier than 1970.
    Time host(Time time);
    /// A record's timestamp. A clock that is not set counts from 1980 on and tells no time: it stays; one that is
    /// neither becomes 0.
    std::uint64_t modem(std::uint64_t timestamp);

private:
    bool _shift;
    std::optional<Time> _firstHost;
    std::optional<std::uint64_t> _firstModem;
};

}  // namespace kelvo
