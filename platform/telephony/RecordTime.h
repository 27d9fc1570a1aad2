#pragma once

#include <chrono>
#include <cstdint>
#include <optional>

namespace kelvo {

using SystemTime = std::chrono::sys_time<std::chrono::nanoseconds>;

/// What a record's timestamp says. The upper 48 bits count 1.25 ms since 1980-01-06 00:00:00, without leap seconds, the
/// lower 16 bits 1/32 chips of 1.2288 Mchip/s. None while the modem's clock is not set: before 2010 or after 2050.
std::optional<SystemTime> timeOf(std::uint64_t timestamp);

/// The timestamp of a time from 1980-01-06 on.
std::uint64_t timestampOf(SystemTime time);

}  // namespace kelvo
