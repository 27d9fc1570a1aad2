#include "tools/report/DriveTables.h"

#include <fmt/format.h>

#include <algorithm>
#include <functional>

#include "LogGenerator/CodeNames.h"
#include "tools/report/HtmlTable.h"
#include "tools/report/Words.h"

namespace kelvo::report {
namespace {

using Kind = HtmlTable::Kind;
using Entry = std::pair<const std::string, CellFigures>;

constexpr std::size_t kMostRows = 1000;  // in a table; a page must stay quick, and whoever wants all exports them

TableCell levelCell(const Distribution& readings, double share, const std::string& unit) {
    if (readings.isEmpty()) return {"–"};
    const double value = readings.percentile(share);
    return {withUnit(value, unit), numberText(value)};
}

TableCell countCell(std::uint64_t count) { return {grouped(count), std::to_string(count)}; }

TableCell lengthCell(Elapsed length, const Drive& drive) {
    return {lengthText(length, drive.isByRecords), std::to_string(length.count())};
}

TableCell whenCell(Elapsed at, const Drive& drive) { return {whenText(drive, at), std::to_string(at.count())}; }

TableCell shareCell(Elapsed part, Elapsed whole) {
    const double share = whole.count() > 0 ? static_cast<double>(part.count()) / static_cast<double>(whole.count()) : 0;
    return {shareText(share), fmt::format("{:.6f}", share)};
}

TableCell textCell(const std::string& text) { return {text.empty() ? "–" : text}; }

/// How a table calls a measure of its cells: by its name and with its unit in the heading, where all have the same.
struct Naming {
    std::string name;
    std::string unit;
    bool isOne = true;

    Naming(const CellTable& table, std::string_view what, std::string CellFigures::*nameOf,
           std::string CellFigures::*unitOf) {
        for (const auto& [identity, cell] : table.cells) {
            if ((cell.*nameOf).empty()) continue;
            if (name.empty()) {
                name = cell.*nameOf;
                unit = cell.*unitOf;
            }
            isOne = isOne && name == cell.*nameOf && unit == cell.*unitOf;
        }
        if (!isOne || name.empty()) name = what;
        if (!isOne) unit.clear();
    }
    std::string title(std::string_view figure) const {
        return fmt::format("{} {}{}{}", name, figure, unit.empty() ? "" : ", ", unit);
    }
    TableCell cell(const Distribution& readings, double share, const std::string& own) const {
        return levelCell(readings, share, isOne ? std::string() : own);
    }
};

Naming levelsOf(const CellTable& table) { return {table, "Level", &CellFigures::levelName, &CellFigures::levelUnit}; }

Naming qualitiesOf(const CellTable& table) {
    return {table, "Quality", &CellFigures::qualityName, &CellFigures::qualityUnit};
}

/// The cells with most of `what` first.
template <class What>
std::vector<const Entry*> most(const CellTable& table, What what) {
    std::vector<const Entry*> cells;
    for (const Entry& cell : table.cells) cells.push_back(&cell);
    std::ranges::stable_sort(cells, std::greater<>(), [&](const Entry* cell) { return what(cell->second); });
    return cells;
}

std::string restNote(std::size_t rows, std::uint64_t beyond) {
    std::string note;
    if (rows > kMostRows) note = fmt::format("<p class=\"note\">And {} more.</p>\n", grouped(rows - kMostRows));
    if (beyond != 0) note += "<p class=\"note\">There are further cells, which are not counted one by one.</p>\n";
    return note;
}

}  // namespace

std::string levelTable(const Drive& drive) {
    HtmlTable table(
        "Levels, qualities and rates",
        {{"Value", Kind::Text}, {"Minimum"}, {"5 % below"}, {"Median"}, {"95 % below"}, {"Maximum"}, {"Readings"}});
    for (const auto* measures : {&drive.levels, &drive.rates}) {
        for (const MeasureFigures& figures : *measures) {
            if (figures.readings.isEmpty()) continue;
            std::vector<TableCell> row{{figures.name}};
            for (const double share : {0.0, 0.05, 0.5, 0.95, 1.0}) {
                row.push_back(levelCell(figures.readings, share, figures.unit));
            }
            row.push_back(countCell(figures.readings.count()));
            table.add(std::move(row));
        }
    }
    return table.text();
}

std::string servingTable(const Drive& drive) {
    const Naming levels = levelsOf(drive.serving);
    const Naming qualities = qualitiesOf(drive.serving);
    const Lane* radios = drive.lane("Radio");
    const bool isOneRadio = radios == nullptr || radios->times().size() < 2;
    HtmlTable table("Cells that served", {{"Cell", Kind::Text},
                                          {"Radio", Kind::Text},
                                          {"Network", Kind::Text},
                                          {"Band", Kind::Text},
                                          {"Area", Kind::Text},
                                          {"Time"},
                                          {"Share"},
                                          {"Times"},
                                          {levels.title("median")},
                                          {"5 % below"},
                                          {"95 % below"},
                                          {qualities.title("median")},
                                          {"Readings"},
                                          {"First"}});
    const auto cells = most(drive.serving, [](const CellFigures& cell) { return std::pair(cell.served, cell.visits); });
    for (std::size_t i = 0; i < cells.size() && i < kMostRows; ++i) {
        const CellFigures& cell = cells[i]->second;
        table.add({{cells[i]->first},
                   textCell(isOneRadio ? std::string() : cell.access),
                   textCell(cell.network),
                   textCell(cell.band),
                   textCell(cell.area),
                   lengthCell(cell.served, drive),
                   shareCell(cell.served, drive.length),
                   countCell(cell.visits),
                   levels.cell(cell.level, 0.5, cell.levelUnit),
                   levels.cell(cell.level, 0.05, cell.levelUnit),
                   levels.cell(cell.level, 0.95, cell.levelUnit),
                   qualities.cell(cell.quality, 0.5, cell.qualityUnit),
                   countCell(std::max(cell.level.count(), cell.quality.count())),
                   whenCell(cell.first, drive)});
    }
    return table.text() + restNote(cells.size(), drive.serving.beyond);
}

std::string neighborTable(const Drive& drive) {
    const Naming levels = levelsOf(drive.neighbors);
    const Naming qualities = qualitiesOf(drive.neighbors);
    HtmlTable table("Cells heard around the serving one", {{"Cell", Kind::Text},
                                                           {"Kind", Kind::Text},
                                                           {"Heard"},
                                                           {"Above serving"},
                                                           {levels.title("median")},
                                                           {"Maximum"},
                                                           {qualities.title("median")},
                                                           {"Served"},
                                                           {"First"},
                                                           {"Last"}});
    const auto cells = most(drive.neighbors, [](const CellFigures& cell) { return cell.heard; });
    for (std::size_t i = 0; i < cells.size() && i < kMostRows; ++i) {
        const CellFigures& cell = cells[i]->second;
        const auto served = drive.serving.cells.find(cells[i]->first);
        table.add({{cells[i]->first},
                   textCell(cell.mark),
                   countCell(cell.heard),
                   countCell(cell.stronger),
                   levels.cell(cell.level, 0.5, cell.levelUnit),
                   levels.cell(cell.level, 1, cell.levelUnit),
                   qualities.cell(cell.quality, 0.5, cell.qualityUnit),
                   served == drive.serving.cells.end() ? TableCell{"–"} : lengthCell(served->second.served, drive),
                   whenCell(cell.first, drive),
                   whenCell(cell.last, drive)});
    }
    return table.text() + restNote(cells.size(), drive.neighbors.beyond);
}

std::string stateTable(const Drive& drive) {
    constexpr std::size_t kMostStates = 30;  // of each kind; cells have a table of their own
    HtmlTable table("Time in each state", {{"State", Kind::Text}, {"Of", Kind::Text}, {"Time"}, {"Share"}});
    for (const NamedLane& lane : drive.lanes) {
        if (lane.name == "Serving cell") continue;
        std::vector<std::pair<Elapsed, std::string>> times;
        for (const auto& [text, time] : lane.lane.times()) times.emplace_back(time, text);
        std::ranges::stable_sort(times, std::greater<>(), &std::pair<Elapsed, std::string>::first);
        for (std::size_t i = 0; i < times.size() && i < kMostStates; ++i) {
            table.add({{times[i].second},
                       {lane.name},
                       lengthCell(times[i].first, drive),
                       shareCell(times[i].first, drive.length)});
        }
    }
    return table.text();
}

std::string eventTable(const Drive& drive) {
    HtmlTable table("What happened, in order", {{"Time", Kind::Text},
                                                {"Event", Kind::Text},
                                                {"From", Kind::Text},
                                                {"To", Kind::Text},
                                                {"Level before", Kind::Text},
                                                {"Level after", Kind::Text}});
    for (const auto& [at, event] : drive.events) {
        table.add({whenCell(at, drive),
                   {std::string(nameOf(event.kind))},
                   textCell(event.from),
                   textCell(event.to),
                   textCell(event.levelBefore),
                   textCell(event.levelAfter)});
    }
    if (drive.eventCount() <= drive.events.size()) return table.text();
    return table.text() +
           fmt::format("<p class=\"note\">The first {} of {}; <code>kelvoctl events</code> lists all.</p>\n",
                       grouped(drive.events.size()), grouped(drive.eventCount()));
}

std::string unreadPart(const Drive& drive) {
    constexpr std::size_t kMostCodes = 200;
    HtmlTable table("Records that brought nothing to the screens",
                    {{"Code", Kind::Text}, {"What it is", Kind::Text}, {"Not read"}, {"Of"}, {"Why", Kind::Text}});
    std::size_t codes = 0;
    for (const auto& [code, unread] : drive.codes) {
        if (++codes > kMostCodes) break;
        const std::string name = nameOfCode(code);
        table.add({{fmt::format("0x{:04x}", code), std::to_string(code)},
                   textCell(name),
                   countCell(unread.strange + unread.silent),
                   countCell(unread.records),
                   {unread.strange != 0 ? "no screen of this technology takes it"
                                        : "too short, of another layout, or with nothing to show"}});
    }
    std::string part;
    for (const std::string& remark : drive.remarks) part += "<p>" + html(remark) + "</p>\n";
    if (table.isEmpty() && part.empty()) return "<p>Every record was read.</p>\n";
    return part + table.text();
}

}  // namespace kelvo::report
