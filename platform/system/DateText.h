#pragma once

#include <chrono>
#include <optional>
#include <string>

#include "platform/system/Clock.h"

namespace kelvo {

/// A date as the program describes it: local time with the zone's offset, "2011-03-04 09:15:02 +0100".
std::string dateDescription(Clock::TimePoint time);
/// The same in UTC, "2011-03-04 08:15:02 +0000".
std::string utcDateDescription(Clock::TimePoint time);
/// The date that a description begins with; none when it reads otherwise.
std::optional<std::chrono::sys_seconds> dateFromDescription(const std::string& text);

}  // namespace kelvo
