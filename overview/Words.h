#pragma once

#include <optional>
#include <string>

#include "overview/Event.h"
#include "overview/Observation.h"

/// The words that every screen of the overview has in common, in the window and in the terminal.
namespace kelvo::overview {

/// "3 s ago", "5 min ago". Of captures put together the times may go back; nothing is younger than now.
std::string ageText(Time then, Time now);

/// How much more a cell has than the serving one: "+3.25 dB". Empty where one of the two is missing; levels of
/// different kinds do not compare.
std::string differenceText(const std::optional<Measure>& level, const std::optional<Measure>& serving);

/// "idle -> connected", with that arrow; of what has no before, or no after, the other alone.
std::string changeText(const std::string& from, const std::string& to, std::string_view arrow);

}  // namespace kelvo::overview
