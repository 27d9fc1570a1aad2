#pragma once

#include <string>
#include <vector>

#include "tools/report/Charts.h"

namespace kelvo::report {

/// What the page's script draws, as JSON that may stand in a script element: nothing in it ends one, and it is ASCII
/// alone. Times are whole milliseconds from the beginning, or records; they are told as differences.
std::string chartJson(const std::vector<Chart>& charts, const std::vector<Drive>& drives);

}  // namespace kelvo::report
