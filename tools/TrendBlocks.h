#pragma once

#include <deque>
#include <string>

#include "model/Trend.h"
#include "overview/LiveOverview.h"

namespace kelvo {

/// The last two minutes of a line as 40 block characters, one for three seconds, and the range that they stand for:
/// "▃▃▄▅ ▅│▂▂  -105 to -90 dBm". A blank is a while without a reading, "│" where another cell began to serve. The range
/// has at least 10 units, in steps of 5, so that small changes stay small. Empty for a line without readings.
std::string trendBlocks(const overview::LiveOverview::Line& line, const std::deque<TrendChange>& servingCells,
                        Trend::Time now);

}  // namespace kelvo
