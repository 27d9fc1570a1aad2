#pragma once

#include <string>
#include <vector>

#include "tools/report/Drive.h"

namespace kelvo::report {

/// The figures of several recordings side by side, each with its difference from the first, in HTML.
std::string comparison(const std::vector<Drive>& drives);
/// Their cells side by side: how long each served, and with which level.
std::string comparedCells(const std::vector<Drive>& drives);

}  // namespace kelvo::report
