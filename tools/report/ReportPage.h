#pragma once

#include <string>
#include <vector>

#include "tools/report/Drive.h"

namespace kelvo::report {

struct PageTerms {
    std::string title;   ///< empty: the names of the files
    std::string shared;  ///< what has been replaced in them; empty: nothing
};

/// The whole page of one recording, or of two to six compared.
std::string reportPage(const std::vector<Drive>& drives, const PageTerms& terms);

/// How many recordings a page compares at most.
inline constexpr std::size_t kMostDrives = 6;

}  // namespace kelvo::report
