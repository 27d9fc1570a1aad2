#include "tools/report/Charts.h"

#include <algorithm>

#include "tools/report/Words.h"

namespace kelvo::report {
namespace {

constexpr std::size_t kStyles = 6;
constexpr const char* kRates = "Rates and errors";

Chart& chartOf(std::vector<Chart>& charts, const std::string& title, const MeasureFigures& figures) {
    const auto known = std::ranges::find_if(
        charts, [&](const Chart& chart) { return chart.title == title && chart.unit == figures.unit; });
    return known != charts.end() ? *known : charts.emplace_back(Chart{title, figures.unit, figures.name, {}});
}

void addLine(Chart& chart, std::string name, std::size_t style, const ThinnedSeries& series) {
    if (!series.isEmpty() && style < kStyles) chart.lines.push_back({std::move(name), style, &series});
}

/// Levels before qualities; what the serving cell has before what only those around have.
std::vector<const MeasureFigures*> inOrder(const std::vector<MeasureFigures>& levels) {
    std::vector<const MeasureFigures*> ordered;
    ordered.reserve(levels.size());
    for (const MeasureFigures& figures : levels) ordered.push_back(&figures);
    std::ranges::stable_sort(ordered, {}, [](const MeasureFigures* figures) {
        return std::pair(figures->readings.isEmpty(), figures->isQuality);
    });
    return ordered;
}

}  // namespace

std::vector<Chart> chartsOf(const std::vector<Drive>& drives) {
    std::vector<Chart> charts;
    const bool isOne = drives.size() == 1;
    for (std::size_t i = 0; i < drives.size(); ++i) {
        for (const MeasureFigures* figures : inOrder(drives[i].levels)) {
            Chart& chart = chartOf(charts, (figures->isQuality ? "Quality: " : "Level: ") + figures->name, *figures);
            addLine(chart, isOne ? "serving cell" : letterOf(i), i, figures->series);
            if (isOne) addLine(chart, "best neighbor", 1, figures->bestNeighbor);
        }
    }
    for (std::size_t i = 0; i < drives.size(); ++i) {
        for (const MeasureFigures& figures : drives[i].rates) {
            Chart& chart = chartOf(charts, kRates, figures);
            addLine(chart, isOne ? figures.name : letterOf(i) + ": " + figures.name, chart.lines.size(),
                    figures.series);
        }
    }
    for (Chart& chart : charts) {  // one of its unit needs no other name
        if (chart.title == kRates && chart.lines.size() == 1) chart.title = chart.measure;
    }
    std::erase_if(charts, [](const Chart& chart) { return chart.lines.empty(); });
    return charts;
}

Axis axisOf(const std::vector<Drive>& drives) {
    if (!drives.empty() && std::ranges::all_of(drives, &Drive::isByRecords)) return Axis::Records;
    return drives.size() == 1 ? Axis::Clock : Axis::Elapsed;
}

Elapsed lengthOf(const std::vector<Drive>& drives) {
    Elapsed length{0};
    for (const Drive& drive : drives) length = std::max(length, drive.length);
    return length;
}

}  // namespace kelvo::report
