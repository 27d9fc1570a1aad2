#include "tools/OverviewText.h"

#include <fmt/format.h>

#include <algorithm>
#include <vector>

#include "overview/Words.h"
#include "platform/encodings/Utf8.h"
#include "tools/TerminalText.h"

namespace kelvo {
namespace {

using namespace overview;

constexpr std::size_t kEventsShown = 10;

using Line = std::vector<std::string>;

/// Columns as wide as their widest text, two blanks apart; two blanks before each line.
std::string table(const std::vector<Line>& lines) {
    std::vector<std::size_t> widths;
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

std::string group(std::string_view title, const std::vector<Line>& lines) {
    return lines.empty() ? std::string() : fmt::format("{}\n{}", title, table(lines));
}

std::vector<Line> linesOf(const std::vector<Fact>& facts) {
    std::vector<Line> lines;
    lines.reserve(facts.size());
    for (const Fact& fact : facts) lines.push_back({printable(fact.name), printable(fact.text)});
    return lines;
}

std::string serving(const Tracker& tracker, Time now) {
    const Observation& seen = tracker.latest();
    std::string title = seen.access.empty() ? "No serving cell" : seen.access;
    if (!seen.state.empty()) title += ", " + seen.state;
    std::vector<Line> lines;
    if (!seen.cell.empty()) lines.push_back({"Cell", printable(seen.cell)});
    for (const auto* measure : {&seen.level, &seen.quality}) {
        if (!*measure) continue;
        std::string text = (*measure)->figure.text;
        if (!(*measure)->grade.empty()) text += ", " + (*measure)->grade;
        if (measure == &seen.level && tracker.levelTime()) text += ", " + ageText(*tracker.levelTime(), now);
        lines.push_back({(*measure)->name, printable(text)});
    }
    if (!seen.area.empty()) lines.push_back({"Area", seen.area});
    for (Line& line : linesOf(seen.serving)) lines.push_back(std::move(line));
    return printable(title) + "\n" + table(lines);
}

std::string textOf(const std::optional<Measure>& measure) { return measure ? printable(measure->figure.text) : ""; }

std::string cellsAround(const Tracker& tracker, Time now) {
    std::vector<Line> lines;
    for (const TrackedCell& cell : tracker.cells()) {
        const std::string mark = cell.isLost ? "lost" : cell.heard.mark;
        lines.push_back({printable(cell.heard.identity), textOf(cell.heard.level), textOf(cell.heard.quality),
                         differenceText(cell.heard.level, tracker.latest().level), ageText(cell.lastHeard, now), mark});
    }
    if (!lines.empty()) lines.insert(lines.begin(), {"Cell", "Level", "Quality", "To serving", "Heard", ""});
    return group("Cells around", lines);
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

std::string overviewText(const Tracker& tracker, Time now) {
    const Observation& seen = tracker.latest();
    std::vector<Line> contexts;
    contexts.reserve(seen.contexts.size());
    for (const Context& context : seen.contexts) contexts.push_back({printable(context.name), printable(context.text)});
    std::string text = serving(tracker, now);
    text += cellsAround(tracker, now);
    text += group("Registration", linesOf(seen.registration));
    text += group("Data contexts", contexts);
    text += group("Rates and errors", linesOf(seen.rates));
    const auto& events = tracker.events();
    std::vector<Line> happened;
    for (auto event = events.rbegin(); event != events.rend() && happened.size() < kEventsShown; ++event) {
        happened.push_back({eventText(*event)});
    }
    return text + group("What happened", happened);
}

}  // namespace kelvo
