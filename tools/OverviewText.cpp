#include "tools/OverviewText.h"

#include <fmt/format.h>

#include <algorithm>
#include <vector>

#include "overview/Words.h"
#include "platform/encodings/Utf8.h"
#include "tools/TerminalText.h"
#include "tools/TrendBlocks.h"

namespace kelvo {
namespace {

using namespace overview;

constexpr std::size_t kEventsShown = 10;
constexpr std::size_t kMostCellRows = 12;  // for which room is kept

using Line = std::vector<std::string>;
using Widths = std::vector<std::size_t>;

/// Where a live overview's columns begin at the earliest, so that they stay where they are.
struct Layout {
    const LiveOverview* live = nullptr;  ///< none: of a capture
    bool hasBlocks = false;
    std::size_t cellRows = 0;
    Widths facts() const { return live != nullptr ? Widths{14} : Widths(); }
    Widths cells() const { return live != nullptr ? Widths{22, 11, 9, 10, 9} : Widths(); }
};

/// Columns as wide as their widest text, two blanks apart; two blanks before each line.
std::string table(const std::vector<Line>& lines, Widths widths) {
    for (const Line& line : lines) {
        widths.resize(std::max(widths.size(), line.size()));
        for (std::size_t i = 0; i < line.size(); ++i) widths[i] = std::max(widths[i], columnsOf(line[i]));
    }
    std::string text;
    for (const Line& line : lines) {
        std::string row = " ";
        for (std::size_t i = 0; i < line.size(); ++i) {
            row += " " + line[i] + std::string(widths[i] - columnsOf(line[i]) + 1, ' ');
        }
        row.erase(row.find_last_not_of(' ') + 1);
        text += row + "\n";
    }
    return text;
}

std::string group(std::string_view title, const std::vector<Line>& lines, const Widths& widths = {}) {
    return lines.empty() ? std::string() : fmt::format("{}\n{}", title, table(lines, widths));
}

std::vector<Line> linesOf(const std::vector<Fact>& facts) {
    std::vector<Line> lines;
    lines.reserve(facts.size());
    for (const Fact& fact : facts) lines.push_back({printable(fact.name), printable(fact.text)});
    return lines;
}

void addFigure(std::vector<Line>& lines, const std::optional<Measure>& measure, std::optional<Time> heard, Time now) {
    if (!measure) return;
    std::string text = measure->figure.text;
    if (!measure->grade.empty()) text += ", " + measure->grade;
    if (heard) text += ", " + ageText(*heard, now);
    lines.push_back({measure->name, printable(text)});
}

void addBlocks(std::vector<Line>& lines, const LiveOverview::Line& line, const Layout& layout) {
    if (!layout.hasBlocks || line.name.empty()) return;
    lines.push_back({"", trendBlocks(line, layout.live->servingCells(), layout.live->lineTime())});
}

std::string serving(const Tracker& tracker, Time now, const Layout& layout) {
    const Observation& seen = tracker.latest();
    std::string title = seen.access.empty() ? "No serving cell" : seen.access;
    if (!seen.state.empty()) title += ", " + seen.state;
    std::vector<Line> lines;
    if (!seen.cell.empty()) lines.push_back({"Cell", printable(seen.cell)});
    addFigure(lines, seen.level, tracker.levelTime(), now);
    if (layout.live != nullptr) addBlocks(lines, layout.live->level(), layout);
    addFigure(lines, seen.quality, tracker.qualityTime(), now);
    if (layout.live != nullptr) addBlocks(lines, layout.live->quality(), layout);
    if (!seen.area.empty()) lines.push_back({"Area", seen.area});
    for (Line& line : linesOf(seen.serving)) lines.push_back(std::move(line));
    return printable(title) + "\n" + table(lines, layout.facts());
}

std::string textOf(const std::optional<Measure>& measure) { return measure ? printable(measure->figure.text) : ""; }

std::string cellsAround(const Tracker& tracker, Time now, const Layout& layout) {
    std::vector<Line> lines;
    for (const TrackedCell& cell : tracker.cells()) {
        const std::string mark = cell.isLost ? "lost" : cell.heard.mark;
        lines.push_back({printable(cell.heard.identity), textOf(cell.heard.level), textOf(cell.heard.quality),
                         differenceText(cell.heard.level, tracker.latest().level), ageText(cell.lastHeard, now), mark});
    }
    lines.resize(std::max(lines.size(), layout.cellRows), {""});
    if (!lines.empty()) lines.insert(lines.begin(), {"Cell", "Level", "Quality", "To serving", "Heard", ""});
    return group("Cells around", lines, layout.cells());
}

std::string textWith(const Tracker& tracker, Time now, const Layout& layout) {
    const Observation& seen = tracker.latest();
    std::vector<Line> contexts;
    contexts.reserve(seen.contexts.size());
    for (const Context& context : seen.contexts) contexts.push_back({printable(context.name), printable(context.text)});
    std::string text = serving(tracker, now, layout);
    text += cellsAround(tracker, now, layout);
    text += group("Registration", linesOf(seen.registration), layout.facts());
    text += group("Data contexts", contexts, layout.facts());
    text += group("Rates and errors", linesOf(seen.rates), layout.facts());
    const auto& events = tracker.events();
    std::vector<Line> happened;
    for (auto event = events.rbegin(); event != events.rend() && happened.size() < kEventsShown; ++event) {
        happened.push_back({eventText(*event)});
    }
    return text + group("What happened", happened);
}

}  // namespace

std::string isoText(Time time) {
    const auto milliseconds = std::chrono::floor<std::chrono::milliseconds>(time);
    const auto day = std::chrono::floor<std::chrono::days>(milliseconds);
    const std::chrono::year_month_day date(day);
    const std::chrono::hh_mm_ss clock(milliseconds - day);
    return fmt::format("{:04}-{:02}-{:02}T{:02}:{:02}:{:02}.{:03}Z", static_cast<int>(date.year()),
                       static_cast<unsigned>(date.month()), static_cast<unsigned>(date.day()), clock.hours().count(),
                       clock.minutes().count(), clock.seconds().count(), clock.subseconds().count());
}

std::string eventText(const Event& event) {
    std::string text = fmt::format("{}  {}", isoText(event.time), nameOf(event.kind));
    const std::string what = changeText(event.from, event.to, "->");
    if (!what.empty()) text += "  " + what;
    const std::string levels = changeText(event.levelBefore, event.levelAfter, "->");
    if (!levels.empty()) text += fmt::format(" ({})", levels);
    return printable(text);
}

std::string overviewText(const Tracker& tracker, Time now) { return textWith(tracker, now, {}); }

std::vector<std::string> LiveOverviewText::lines() {
    const std::size_t rows = _live.tracker().cells().size();
    _cellRows = std::max(_cellRows, std::min(rows, kMostCellRows));
    const std::string text = textWith(_live.tracker(), _live.now(), {&_live, _hasBlocks, _cellRows});
    std::vector<std::string> lines;
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t end = std::min(text.find('\n', at), text.size());
        lines.push_back(text.substr(at, end - at));
        at = end + 1;
    }
    return lines;
}

}  // namespace kelvo
