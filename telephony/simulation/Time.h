#pragma once

#include <chrono>

namespace kelvo::simulation {

/// When every drive begins: 2026-03-02 at 09:00:00 UTC.
inline constexpr std::chrono::sys_seconds kDriveStart{std::chrono::seconds(1'772'442'000)};
/// Time since then.
using Time = std::chrono::nanoseconds;

constexpr double seconds(Time time) { return std::chrono::duration<double>(time).count(); }
constexpr Time fromSeconds(double value) { return Time(static_cast<Time::rep>(value * 1e9)); }

}  // namespace kelvo::simulation
