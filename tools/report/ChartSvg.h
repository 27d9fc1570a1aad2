#pragma once

#include <string>
#include <vector>

#include "tools/report/Charts.h"

/// The charts as drawings of lines, for paper and for browsers that run no script.
namespace kelvo::report {

std::string chartSvg(const Chart& chart, const std::vector<Drive>& drives);
/// The states of one recording over time, a lane each.
std::string lanesSvg(const Drive& drive, Elapsed length, Axis axis);

}  // namespace kelvo::report
