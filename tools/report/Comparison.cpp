#include "tools/report/Comparison.h"

#include <fmt/format.h>

#include <algorithm>
#include <cmath>
#include <functional>
#include <optional>
#include <set>

#include "tools/report/HtmlTable.h"
#include "tools/report/Words.h"

namespace kelvo::report {
namespace {

using overview::Event;

constexpr std::size_t kMostRows = 500;

enum class Unit { Plain, Count, Seconds, Records };

struct Figure {
    std::string name;
    std::string unit;
    Unit kind = Unit::Plain;
    std::vector<std::optional<double>> values = {};  // one a recording
};

std::string valueText(double value, const Figure& figure) {
    switch (figure.kind) {
        case Unit::Count: return grouped(static_cast<std::uint64_t>(value));
        case Unit::Seconds:
            return lengthText(std::chrono::duration_cast<Elapsed>(std::chrono::duration<double>(value)), false);
        case Unit::Records: return counted(static_cast<std::uint64_t>(value), "record");
        case Unit::Plain: break;
    }
    return withUnit(value, figure.unit);
}

/// "+3.5 dB"; two levels in dBm differ in dB.
std::string differenceText(double difference, const Figure& figure) {
    Figure absolute = figure;
    if (figure.unit == "dBm") absolute.unit = "dB";
    const std::string text = valueText(std::abs(difference), absolute);
    if (text == valueText(0, absolute)) return "same";
    return (difference < 0 ? "-" : "+") + text;
}

using Measures = std::vector<MeasureFigures> Drive::*;

/// The names of all measures of that kind, in the order in which they come up.
std::vector<std::pair<std::string, std::string>> namesOf(const std::vector<Drive>& drives, Measures measures) {
    std::vector<std::pair<std::string, std::string>> names;
    for (const Drive& drive : drives) {
        for (const MeasureFigures& figures : drive.*measures) {
            const std::pair name(figures.name, figures.unit);
            if (!figures.readings.isEmpty() && std::ranges::find(names, name) == names.end()) names.push_back(name);
        }
    }
    return names;
}

const MeasureFigures* figuresOf(const Drive& drive, Measures measures,
                                const std::pair<std::string, std::string>& name) {
    for (const MeasureFigures& figures : drive.*measures) {
        if (std::pair(figures.name, figures.unit) == name && !figures.readings.isEmpty()) return &figures;
    }
    return nullptr;
}

void addMeasures(std::vector<Figure>& rows, const std::vector<Drive>& drives, Measures measures) {
    const std::pair<const char*, double> shares[] = {
        {"minimum", 0}, {"5 % are below", 0.05}, {"median", 0.5}, {"95 % are below", 0.95}, {"maximum", 1}};
    for (const auto& name : namesOf(drives, measures)) {
        for (const auto& [word, share] : shares) {
            Figure row{name.first + ", " + word, name.second};
            for (const Drive& drive : drives) {
                const MeasureFigures* figures = figuresOf(drive, measures, name);
                row.values.push_back(figures != nullptr ? std::optional(figures->readings.percentile(share))
                                                        : std::nullopt);
            }
            rows.push_back(std::move(row));
        }
    }
}

std::vector<Figure> figuresOf(const std::vector<Drive>& drives) {
    std::vector<Figure> rows;
    const auto add = [&](const std::string& name, Unit kind,
                         const std::function<std::optional<double>(const Drive&)>& of) {
        Figure row{name, {}, kind};
        for (const Drive& drive : drives) row.values.push_back(of(drive));
        rows.push_back(std::move(row));
    };
    const bool isByRecords = std::ranges::all_of(drives, &Drive::isByRecords);
    add("Length", isByRecords ? Unit::Records : Unit::Seconds, [&](const Drive& drive) -> std::optional<double> {
        if (drive.isByRecords != isByRecords) return std::nullopt;
        return std::chrono::duration<double>(drive.length).count();
    });
    add("Records", Unit::Count, [](const Drive& drive) { return static_cast<double>(drive.records); });
    addMeasures(rows, drives, &Drive::levels);
    add("Cells that served", Unit::Count,
        [](const Drive& drive) { return static_cast<double>(drive.serving.cells.size()); });
    add("Cells heard around", Unit::Count,
        [](const Drive& drive) { return static_cast<double>(drive.neighbors.cells.size()); });
    const auto addCount = [&](Event::Kind kind, const char* name, bool evenIfNone = false) {
        const auto happened = [kind](const Drive& drive) { return drive.count(kind) != 0; };
        if (!evenIfNone && std::ranges::none_of(drives, happened)) return;
        add(name, Unit::Count, [kind](const Drive& drive) { return static_cast<double>(drive.count(kind)); });
    };
    addCount(Event::Kind::Handover, "Handovers", true);
    addCount(Event::Kind::Reselection, "Reselections", true);
    addCount(Event::Kind::Access, "Changes of radio");
    addCount(Event::Kind::Area, "Changes of area");
    addCount(Event::Kind::Registration, "Changes of registration", true);
    addCount(Event::Kind::Reject, "Rejects");
    addCount(Event::Kind::ServiceLost, "Losses of service");
    addCount(Event::Kind::ContextDown, "Contexts gone down");
    addMeasures(rows, drives, &Drive::rates);
    return rows;
}

/// What is different in a sentence for each: the medians, then how often the cell changed.
std::string leadOf(const std::vector<Drive>& drives) {
    std::string lead;
    for (std::size_t i = 1; i < drives.size(); ++i) {
        std::string told;
        for (const auto& name : namesOf(drives, &Drive::levels)) {
            const MeasureFigures* before = figuresOf(drives.front(), &Drive::levels, name);
            const MeasureFigures* after = figuresOf(drives[i], &Drive::levels, name);
            if (before == nullptr || after == nullptr) continue;
            const double difference = after->readings.median() - before->readings.median();
            const std::string size = withUnit(std::abs(difference), name.second == "dBm" ? "dB" : name.second);
            told += fmt::format("{}{} is {}", told.empty() ? "" : ", ", html(name.first),
                                difference == 0
                                    ? std::string("the same")
                                    : fmt::format("<b>{} {}</b>", html(size), difference < 0 ? "lower" : "higher"));
        }
        if (told.empty()) told = "no level is told of in both";
        const auto changes = [](const Drive& drive) {
            return drive.count(Event::Kind::Handover) + drive.count(Event::Kind::Reselection);
        };
        lead += fmt::format(
            "<p class=\"lead\"><b>{}</b> against <b>A</b>, by the medians: {}. The cell changed {} in {}, {} in "
            "A.</p>\n",
            letterOf(i), told, counted(changes(drives[i]), "time"), letterOf(i),
            counted(changes(drives.front()), "time"));
    }
    return lead;
}

}  // namespace

std::string comparison(const std::vector<Drive>& drives) {
    std::vector<HtmlTable::Column> columns{{"Figure", HtmlTable::Kind::Text}};
    for (std::size_t i = 0; i < drives.size(); ++i) {
        columns.push_back({letterOf(i)});
        if (i != 0) columns.push_back({fmt::format("{} to A", letterOf(i))});
    }
    HtmlTable table("The figures side by side", columns);
    for (const Figure& figure : figuresOf(drives)) {
        std::vector<TableCell> row{{figure.name}};
        for (std::size_t i = 0; i < figure.values.size(); ++i) {
            const auto& value = figure.values[i];
            const auto& first = figure.values.front();
            row.push_back(value ? TableCell{valueText(*value, figure), numberText(*value)} : TableCell{"–"});
            if (i == 0) continue;
            row.push_back(value && first
                              ? TableCell{differenceText(*value - *first, figure), numberText(*value - *first)}
                              : TableCell{"–"});
        }
        table.add(std::move(row));
    }
    std::string lead = leadOf(drives);
    std::string names = "<ul class=\"letters\">";
    for (std::size_t i = 0; i < drives.size(); ++i) {
        names += fmt::format("<li class=\"l{}\"><b>{}</b> {}</li>", i, letterOf(i), html(drives[i].name));
    }
    return lead + names + "</ul>\n" + table.text();
}

std::string comparedCells(const std::vector<Drive>& drives) {
    std::vector<HtmlTable::Column> columns{{"Cell", HtmlTable::Kind::Text}};
    for (std::size_t i = 0; i < drives.size(); ++i) columns.push_back({fmt::format("{}: served", letterOf(i))});
    for (std::size_t i = 0; i < drives.size(); ++i) columns.push_back({fmt::format("{}: median level", letterOf(i))});
    std::vector<std::pair<Elapsed, std::string>> cells;  // longest in all first
    std::set<std::string> known;
    for (const Drive& drive : drives) {
        for (const auto& [identity, cell] : drive.serving.cells) known.insert(identity);
    }
    for (const std::string& identity : known) {
        Elapsed served{0};
        for (const Drive& drive : drives) {
            const auto cell = drive.serving.cells.find(identity);
            if (cell != drive.serving.cells.end()) served += cell->second.served;
        }
        cells.emplace_back(served, identity);
    }
    std::ranges::stable_sort(cells, std::greater<>(), &std::pair<Elapsed, std::string>::first);
    HtmlTable table("Serving cells side by side", columns);
    for (std::size_t i = 0; i < cells.size() && i < kMostRows; ++i) {
        std::vector<TableCell> row{{cells[i].second}};
        std::vector<TableCell> levels;
        for (const Drive& drive : drives) {
            const auto cell = drive.serving.cells.find(cells[i].second);
            if (cell == drive.serving.cells.end()) {
                row.push_back({"–"});
                levels.push_back({"–"});
                continue;
            }
            const CellFigures& figures = cell->second;
            row.push_back({lengthText(figures.served, drive.isByRecords), std::to_string(figures.served.count())});
            const Distribution& level = figures.level.isEmpty() ? figures.quality : figures.level;
            const std::string& unit = figures.level.isEmpty() ? figures.qualityUnit : figures.levelUnit;
            levels.push_back(level.isEmpty() ? TableCell{"–"}
                                             : TableCell{withUnit(level.median(), unit), numberText(level.median())});
        }
        row.insert(row.end(), levels.begin(), levels.end());
        table.add(std::move(row));
    }
    std::string more;
    if (cells.size() > kMostRows)
        more = fmt::format("<p class=\"note\">And {} more.</p>", grouped(cells.size() - kMostRows));
    return table.text() + more;
}

}  // namespace kelvo::report
