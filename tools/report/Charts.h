#pragma once

#include <string>
#include <vector>

#include "tools/report/Drive.h"

namespace kelvo::report {

/// One line of a chart.
struct ChartLine {
    std::string name;   ///< "serving cell"
    std::size_t style;  ///< which of the page's colours and dashes: 0 to 5
    const ThinnedSeries* series;
};

/// What is measured alike stands in one chart.
struct Chart {
    std::string title;    ///< "Level: RSRP"
    std::string unit;     ///< "dBm"; empty for plain numbers
    std::string measure;  ///< whose grades its background shows: "RSRP"
    std::vector<ChartLine> lines;
};

/// How the horizontal axis of all charts is labelled.
enum class Axis {
    Clock,    ///< the records' times
    Elapsed,  ///< the time since the start
    Records,  ///< the number of the record
};

/// The charts of these recordings, which outlive them: of one its levels with the best neighbor, of several their
/// levels over each other.
std::vector<Chart> chartsOf(const std::vector<Drive>& drives);
Axis axisOf(const std::vector<Drive>& drives);
/// The end of the horizontal axis.
Elapsed lengthOf(const std::vector<Drive>& drives);

}  // namespace kelvo::report
