#include "model/TrendWords.h"

#include <fmt/format.h>

#include <algorithm>
#include <array>
#include <cmath>

namespace kelvo {

using namespace std::chrono_literals;
using Time = Trend::Time;

namespace {

std::string counted(std::int64_t count, std::string_view noun) {
    return fmt::format("{} {}{}", count, noun, count == 1 ? "" : "s");
}

template <class Unit>
std::int64_t in(Time time) {
    return std::chrono::duration_cast<Unit>(time).count();
}

/// How the readings went: a quarter of what lies between the least and the most is more than noise.
std::string_view directionOf(const TrendStatistics& of) {
    const double enough = (of.most - of.least) / 4;
    if (of.most == of.least || std::abs(of.change) < enough) return "steady";
    return of.change > 0 ? "rising" : "falling";
}

}  // namespace

std::optional<TrendStatistics> statisticsOf(const Trend& trend, Time from, Time to) {
    const auto isBefore = [](const Trend::Point& point, Time time) { return point.at < time; };
    const auto first = std::lower_bound(trend.points.begin(), trend.points.end(), from, isBefore);
    const auto last = std::lower_bound(first, trend.points.end(), to + 1ms, isBefore);
    if (first == last) return std::nullopt;
    const auto mean = [](auto begin, auto end) {
        double sum = 0;
        for (auto at = begin; at != end; ++at) sum += at->number;
        return sum / static_cast<double>(end - begin);
    };
    const auto [least, most] =
        std::minmax_element(first, last, [](const auto& a, const auto& b) { return a.number < b.number; });
    const std::ptrdiff_t third = std::max<std::ptrdiff_t>(1, (last - first) / 3);
    return TrendStatistics{least->number, mean(first, last), most->number,
                           mean(last - third, last) - mean(first, first + third)};
}

std::string numberText(double number) {
    std::string shown = fmt::format("{:.2f}", number);
    if (shown.find('.') != shown.npos) {
        shown.erase(shown.find_last_not_of('0') + 1);
        if (shown.ends_with('.')) shown.pop_back();
    }
    return shown == "-0" ? "0" : shown;
}

std::string spanText(Time span) {
    constexpr std::array<std::string_view, 13> kWords = {"no",    "one",   "two",  "three", "four",   "five",  "six",
                                                         "seven", "eight", "nine", "ten",   "eleven", "twelve"};
    const std::int64_t seconds = in<std::chrono::seconds>(span + 500ms);
    if (seconds == 60) return "minute";
    if (seconds < 120) return counted(seconds, "second");
    const std::int64_t minutes = (seconds + 30) / 60;
    return minutes <= 12 ? fmt::format("{} minutes", kWords[static_cast<std::size_t>(minutes)])
                         : fmt::format("{} minutes", minutes);
}

std::string agoText(Time age) {
    const std::int64_t seconds = in<std::chrono::seconds>(age);
    if (seconds < 120) return counted(seconds, "second");
    if (seconds < 7200) return counted(seconds / 60, "minute");
    return counted(seconds / 3600, "hour");
}

std::string ageText(Time age) { return agoText(age) + " old"; }

std::string trendSummary(const Trend& trend, Time from, Time to, Time now) {
    if (trend.points.empty()) return "No readings yet";
    const Trend::Point& last = trend.points.back();
    const std::string shown = fmt::format("{}{}{}", numberText(last.number), trend.unit.empty() ? "" : " ", trend.unit);
    const std::string when = to >= now ? fmt::format("in the last {}", spanText(to - from))
                                       : fmt::format("from {} to {} ago", spanText(now - from), spanText(now - to));
    const auto seen = statisticsOf(trend, from, to);
    if (!seen) return fmt::format("{}, no readings {}", shown, when);
    const std::string range = seen->least == seen->most
                                  ? numberText(seen->least)
                                  : fmt::format("between {} and {}", numberText(seen->least), numberText(seen->most));
    return fmt::format("{}, {} {}, {}", shown, range, when, directionOf(*seen));
}

}  // namespace kelvo
