#pragma once

#include <string>
#include <vector>

#include "tools/report/Drive.h"

namespace kelvo::report {

/// What a person reads first: when and how long, in HTML. A file that the report's title names is not named again.
std::string heading(const std::vector<Drive>& drives, const std::string& title);
/// One recording in a few sentences, and its key figures.
std::string summary(const Drive& drive);

}  // namespace kelvo::report
