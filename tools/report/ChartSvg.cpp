#include "tools/report/ChartSvg.h"

#include <fmt/format.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <utility>

#include "tools/report/Words.h"

namespace kelvo::report {
namespace {

constexpr double kWidth = 760;
constexpr double kLeft = 52;
constexpr double kRight = 752;
constexpr double kTop = 12;
constexpr double kBottom = 188;
constexpr double kLaneHeight = 22;
constexpr Elapsed kLongestLine = std::chrono::seconds(30);  // without a reading; then the line breaks
constexpr std::size_t kMostFullMarks = 120;                 // more of them would hide the lines

/// From the recording to the drawing.
class Across {
public:
    explicit Across(Elapsed length) : _length(std::max(length, Elapsed(1))) {}
    double operator()(Elapsed at) const {
        return kLeft + (kRight - kLeft) * static_cast<double>(at.count()) / static_cast<double>(_length.count());
    }
    Elapsed column() const { return std::max(Elapsed(1), _length / static_cast<int>(kRight - kLeft)); }

private:
    Elapsed _length;
};

struct Heights {
    double low;
    double high;
    double step;  ///< between two lines of the grid
    double operator()(double value) const { return kBottom - (kBottom - kTop) * (value - low) / (high - low); }
};

/// 1, 2 or 5 times a power of ten.
double roundStep(double rough) {
    const double power = std::pow(10, std::floor(std::log10(rough)));
    for (const double factor : {1.0, 2.0, 5.0}) {
        if (factor * power >= rough) return factor * power;
    }
    return 10 * power;
}

Heights heightsOf(const std::vector<std::vector<Point>>& lines) {
    double low = lines.front().front().low;
    double high = low;
    for (const auto& line : lines) {
        for (const Point& point : line) {
            low = std::min(low, point.low);
            high = std::max(high, point.high);
        }
    }
    const double span = std::isfinite(high - low) ? std::max(high - low, std::max(std::abs(high) * 1e-6, 1.0)) : 1;
    const double step = roundStep(span / 4);
    return {std::floor(low / step) * step, std::max(std::ceil(high / step), std::floor(low / step) + 1) * step, step};
}

std::string pathOf(const std::vector<Point>& points, const Across& x, const Heights& y, Elapsed longest) {
    std::string path;
    const Point* last = nullptr;
    for (const Point& point : points) {
        const bool begins = last == nullptr || point.begins || point.at - last->at > longest;
        path += fmt::format("{}{:.1f} {:.1f}", begins ? "M" : "L", x(point.at), y(point.mean));
        if (begins) path += "h.1";  // a reading alone is a dot
        last = &point;
    }
    return path;
}

/// From the smallest to the largest reading of each step, as an outline a piece without interruption.
std::string bandOf(const std::vector<Point>& points, const Across& x, const Heights& y, Elapsed longest) {
    std::string band;
    std::string back;
    const auto isBreak = [&](std::size_t i) {
        return i == 0 || points[i].begins || points[i].at - points[i - 1].at > longest;
    };
    for (std::size_t i = 0; i < points.size(); ++i) {
        if (isBreak(i) && !back.empty()) band += std::exchange(back, {}) + "Z";
        band += fmt::format("{}{:.1f} {:.1f}", isBreak(i) ? "M" : "L", x(points[i].at), y(points[i].high));
        back = fmt::format("L{:.1f} {:.1f}", x(points[i].at), y(points[i].low)) + back;
    }
    return band + back + "Z";
}

std::string frame(const Heights& y) {
    std::string grid;
    for (double value = y.low; value <= y.high + y.step / 2; value += y.step) {
        grid +=
            fmt::format("<path class=\"grid\" d=\"M{} {:.1f}H{}\"/><text class=\"y\" x=\"{}\" y=\"{:.1f}\">{}</text>",
                        kLeft, y(value), kRight, kLeft - 6, y(value) + 4, numberText(value));
        if (y.high + y.step == y.high) break;  // numbers too large to tell steps apart
    }
    return grid;
}

std::string gradeLines(const Chart& chart, const Heights& y) {
    std::string lines;
    for (const LevelGrade& grade : gradesByName(chart.measure)) {
        if (grade.floor <= y.low || grade.floor >= y.high) continue;
        lines += fmt::format("<path class=\"grade\" d=\"M{} {:.1f}H{}\"/>", kLeft, y(grade.floor), kRight);
    }
    return lines;
}

/// Above the lines.
std::string gradeNames(const Chart& chart, const Heights& y) {
    std::string names;
    for (const LevelGrade& grade : gradesByName(chart.measure)) {
        if (grade.floor <= y.low || grade.floor >= y.high) continue;
        names += fmt::format("<text class=\"grade\" x=\"{}\" y=\"{:.1f}\">{}</text>", kRight - 3, y(grade.floor) - 3,
                             grade.name);
    }
    return names;
}

/// A handover is a line, a reselection a dotted one. Many, and those of several recordings, are notches at the top.
std::string marks(const std::vector<Drive>& drives, const Across& x) {
    std::string handovers;
    std::string reselections;
    for (std::size_t i = 0; i < drives.size(); ++i) {
        const bool isFull = drives.size() == 1 && drives[i].changes.size() <= kMostFullMarks;
        double drawn = -1;
        for (const CellChange& change : drives[i].changes) {
            const double place = x(change.at);
            if (place - drawn < 0.5) continue;
            drawn = place;
            const double top = kTop - 8 + 6 * static_cast<double>(i);
            auto& path = change.isHandover ? handovers : reselections;
            path += fmt::format("M{:.1f} {}V{}", place, top, isFull ? kBottom : top + 5);
        }
    }
    return fmt::format("<path class=\"handover\" d=\"{}\"/><path class=\"reselection\" d=\"{}\"/>", handovers,
                       reselections);
}

/// Steps of the horizontal axis, in seconds (or records).
Elapsed timeStep(Elapsed length) {
    using namespace std::chrono_literals;
    static constexpr std::array<std::chrono::seconds, 20> kSteps = {
        1s, 2s, 5s, 10s, 15s, 30s, 60s, 120s, 300s, 600s, 900s, 30min, 1h, 2h, 3h, 6h, 12h, 24h, 48h, 168h};
    for (const auto step : kSteps) {
        if (length / step <= 8) return step;
    }
    return std::max<Elapsed>(length / 8, 1s);
}

std::string labelAt(const Drive& drive, Elapsed at, Axis axis, bool withSeconds) {
    if (axis == Axis::Records) return grouped(static_cast<std::uint64_t>(at / std::chrono::seconds(1)) + 1);
    if (axis == Axis::Clock) return timeText(timeAt(drive, at)).substr(11, withSeconds ? 8 : 5);
    const auto seconds = at / std::chrono::seconds(1);
    return seconds >= 3600 ? fmt::format("{}:{:02}:{:02}", seconds / 3600, seconds / 60 % 60, seconds % 60)
                           : fmt::format("{}:{:02}", seconds / 60, seconds % 60);
}

std::string timeAxis(const Drive& drive, Elapsed length, Axis axis, const Across& x, double bottom) {
    const Elapsed step = timeStep(length);
    // On the clock's whole minutes, as far as the first stretch reaches.
    Elapsed from{0};
    if (axis == Axis::Clock && drive.time.stretches().size() == 1) {
        const auto past = timeAt(drive, Elapsed(0)).time_since_epoch() % step;
        from = past.count() > 0 ? step - past : Elapsed(0);
    }
    std::string labels;
    for (Elapsed at = from; at <= length; at += step) {
        labels += fmt::format(
            "<path class=\"tick\" d=\"M{0:.1f} {1}v4\"/><text class=\"x\" x=\"{0:.1f}\" y=\"{2}\">{3}</text>", x(at),
            bottom, bottom + 16, labelAt(drive, at, axis, step < std::chrono::minutes(1)));
    }
    return labels;
}

std::string open(double height, const std::string& title) {
    return fmt::format("<svg class=\"static\" viewBox=\"0 0 {} {}\" role=\"img\" aria-label=\"{}\">", kWidth, height,
                       html(title));
}

const Drive& longestOf(const std::vector<Drive>& drives) {
    return *std::ranges::max_element(drives, {}, &Drive::length);
}

}  // namespace

std::string chartSvg(const Chart& chart, const std::vector<Drive>& drives) {
    const Across x(lengthOf(drives));
    std::vector<std::vector<Point>> lines;
    for (const ChartLine& line : chart.lines) lines.push_back(line.series->points(x.column()));
    const Heights y = heightsOf(lines);
    const Axis axis = axisOf(drives);
    const Elapsed longest = axis == Axis::Records ? Elapsed::max() : std::max<Elapsed>(kLongestLine, 3 * x.column());
    std::string svg = open(kBottom + 22, chart.title) + frame(y) + gradeLines(chart, y) + marks(drives, x);
    for (std::size_t i = 0; i < lines.size(); ++i) {
        const std::size_t style = chart.lines[i].style;
        const bool hasBand = std::ranges::any_of(lines[i], [](const Point& point) { return point.low != point.high; });
        if (hasBand) svg += fmt::format("<path class=\"band b{}\" d=\"{}\"/>", style, bandOf(lines[i], x, y, longest));
        svg += fmt::format("<path class=\"line l{}\" d=\"{}\"/>", style, pathOf(lines[i], x, y, longest));
    }
    return svg + gradeNames(chart, y) + timeAxis(longestOf(drives), lengthOf(drives), axis, x, kBottom) + "</svg>";
}

std::string lanesSvg(const Drive& drive, Elapsed length, Axis axis) {
    const Across x(length);
    double top = 0;
    std::string svg;
    for (const NamedLane& lane : drive.lanes) {
        svg += fmt::format("<text class=\"lane\" x=\"0\" y=\"{}\">{}</text>", top + 11, html(lane.name));
        top += 15;
        std::vector<std::string> seen;
        double drawn = -1;
        for (const Lane::Segment& segment : lane.lane.segments()) {
            auto known = std::ranges::find(seen, segment.text);
            if (known == seen.end()) known = seen.insert(seen.end(), segment.text);
            const double from = std::max(x(segment.from), drawn);
            const double to = x(segment.to);
            if (to - from < 0.4 && &segment != &lane.lane.segments().back()) continue;
            drawn = to;
            const double wide = std::max(to - from, 0.8);
            const auto tint = (known - seen.begin()) % 6;
            svg += fmt::format("<rect class=\"t{}\" x=\"{:.1f}\" y=\"{}\" width=\"{:.1f}\" height=\"{}\"/>", tint, from,
                               top, wide, kLaneHeight - 6);
            const std::size_t room = static_cast<std::size_t>(wide / 6);
            if (!segment.isBusy && room > 2 && segment.text.size() <= room) {
                svg += fmt::format("<text class=\"seg\" x=\"{:.1f}\" y=\"{}\">{}</text>", from + 3, top + 12,
                                   html(segment.text));
            }
        }
        top += kLaneHeight;
    }
    return open(top + 22, "States over time") + svg + timeAxis(drive, length, axis, x, top) + "</svg>";
}

}  // namespace kelvo::report
