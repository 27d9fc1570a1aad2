#include "tools/TrendBlocks.h"

#include <fmt/format.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <optional>
#include <string_view>
#include <utility>

namespace kelvo {
namespace {

using overview::LiveOverview;

constexpr std::size_t kColumns = 40;
constexpr Trend::Time kColumn = LiveOverview::kSpan / kColumns;
constexpr std::array<std::string_view, 8> kBlocks = {"▁", "▂", "▃", "▄", "▅", "▆", "▇", "█"};
constexpr std::string_view kMark = "│";
constexpr double kLeastRange = 10;
constexpr double kStep = 5;

/// The last column ends now.
std::optional<std::size_t> columnOf(Trend::Time at, Trend::Time now) {
    const auto back = (now - at) / kColumn;
    if (back < 0 || back >= static_cast<Trend::Time::rep>(kColumns)) return std::nullopt;
    return kColumns - 1 - static_cast<std::size_t>(back);
}

std::pair<double, double> rangeOf(const LiveOverview::Line& line) {
    const auto [lowest, highest] = std::ranges::minmax(line.points, {}, &LiveOverview::Point::number);
    const double low = std::floor(lowest.number / kStep) * kStep;
    return {low, std::max(std::ceil(highest.number / kStep) * kStep, low + kLeastRange)};
}

std::string_view blockOf(double number, double low, double high) {
    const double share = std::clamp((number - low) / (high - low), 0.0, 1.0);
    return kBlocks[std::min(static_cast<std::size_t>(share * kBlocks.size()), kBlocks.size() - 1)];
}

}  // namespace

std::string trendBlocks(const LiveOverview::Line& line, const std::deque<TrendChange>& servingCells, Trend::Time now) {
    if (line.points.empty()) return {};
    const auto [low, high] = rangeOf(line);
    std::array<std::string_view, kColumns> columns;
    columns.fill(" ");
    for (const LiveOverview::Point& point : line.points) {
        if (const auto column = columnOf(point.at, now)) columns[*column] = blockOf(point.number, low, high);
    }
    for (const TrendChange& change : servingCells) {
        if (const auto column = columnOf(change.at, now)) columns[*column] = kMark;
    }
    std::string text;
    for (const std::string_view column : columns) text += column;
    return fmt::format("{}  {:.0f} to {:.0f}{}{}", text, low, high, line.unit.empty() ? "" : " ", line.unit);
}

}  // namespace kelvo
