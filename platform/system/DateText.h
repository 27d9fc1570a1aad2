#pragma once

#include <string>

#include "platform/system/Clock.h"

namespace kelvo {

/// A date as the program describes it: local time with the zone's offset, "2011-03-04 09:15:02 +0100".
std::string dateDescription(Clock::TimePoint time);

}  // namespace kelvo
