#pragma once

#include <string>
#include <vector>

#include "model/Trends.h"

namespace kelvo {

/// The trends that may be laid over the one called `name`, in the order in which they are offered: of a serving cell's
/// level that of the best neighbor, of a neighbor's that of the serving cell; then the same quantity, the same unit,
/// and the rest. Values that no record has written for long come last among their like.
std::vector<std::string> trendCandidates(const Trends& trends, std::string_view name);

/// The last component of a trend's name: the key.
std::string_view keyOfTrend(std::string_view name);
/// What leads to it, "Measured Neighbor Cells › PCI 366, EARFCN 1300".
std::string placeOfTrend(std::string_view name);

}  // namespace kelvo
