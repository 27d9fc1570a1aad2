#include "tools/report/ReportPage.h"

#include <fmt/format.h>

#include <QCryptographicHash>
#include <QFile>
#include <algorithm>
#include <map>

#include "platform/system/Environment.h"
#include "tools/report/ChartJson.h"
#include "tools/report/ChartSvg.h"
#include "tools/report/Comparison.h"
#include "tools/report/DriveTables.h"
#include "tools/report/HtmlTable.h"
#include "tools/report/Summary.h"
#include "tools/report/Words.h"

namespace kelvo::report {
namespace {

/// A file that was built into the program, without the comment that asks a browser to fetch another one.
std::string builtIn(const char* name) {
    QFile file(QString(":/report/") + name);
    if (!file.open(QIODevice::ReadOnly)) return {};
    std::string text = file.readAll().toStdString();
    for (const char* comment : {"//# sourceMappingURL", "/*# sourceMappingURL"}) {
        if (const std::size_t place = text.rfind(comment); place != text.npos) text.erase(place);
    }
    return text;
}

std::string script() {
    std::string text = "(() => {\n'use strict';\n";
    for (const char* name : {"window.js", "charts.js", "lanes.js", "tables.js"}) text += builtIn(name);
    return text + "})();\n";
}

/// How the page's policy names the one script that has this text.
std::string nameOfScript(const std::string& text) {
    const auto hash = QCryptographicHash::hash(QByteArrayView(text.data(), static_cast<qsizetype>(text.size())),
                                               QCryptographicHash::Sha256);
    return "'sha256-" + hash.toBase64().toStdString() + "'";
}

/// `page` with each {{name}} replaced; what is put in is not looked at again.
std::string filled(const std::string& page, const std::map<std::string, std::string>& parts) {
    std::string out;
    std::size_t from = 0;
    for (;;) {
        const std::size_t begin = page.find("{{", from);
        const std::size_t end = begin == page.npos ? page.npos : page.find("}}", begin);
        out.append(page, from, begin == page.npos ? page.npos : begin - from);
        if (end == page.npos) return out;
        const auto part = parts.find(page.substr(begin + 2, end - begin - 2));
        if (part != parts.end()) out += part->second;
        from = end + 2;
    }
}

std::string section(const std::string& id, const std::string& title, const std::string& inside) {
    if (inside.empty()) return {};
    return fmt::format("<section id=\"{0}\" aria-labelledby=\"{0}-h\">\n<h2 id=\"{0}-h\">{1}</h2>\n{2}</section>\n", id,
                       title, inside);
}

/// Its key tells a line by its dashes as well as by its colour, and its value under the pointer.
std::string chartFigure(const Chart& chart, const std::vector<Drive>& drives) {
    std::string keys;
    for (const ChartLine& line : chart.lines) {
        keys += fmt::format(
            "<span class=\"key\"><svg viewBox=\"0 0 26 8\" aria-hidden=\"true\"><path class=\"line l{}\" d=\"M0 "
            "4H26\"/>"
            "</svg>{}<output></output></span>",
            line.style, html(line.name));
    }
    const std::string unit = chart.unit.empty() ? "" : ", " + html(chart.unit);
    return fmt::format(
        "<figure class=\"chart\"><figcaption><b>{0}{1}</b>{2}</figcaption>\n"
        "<div class=\"plot\" tabindex=\"0\" role=\"application\" aria-roledescription=\"chart\" aria-label=\"{0}{1}\" "
        "aria-describedby=\"keys\"><div class=\"graph\"></div></div>\n<div class=\"scroll\">{3}</div></figure>\n",
        html(chart.title), unit, keys, chartSvg(chart, drives));
}

std::string stateFigure(const Drive& drive, const std::string& name, const std::vector<Drive>& drives) {
    if (drive.lanes.empty()) return {};
    return fmt::format(
        "<figure class=\"states\"><figcaption><b>{0}</b></figcaption>\n"
        "<div class=\"plot lanes\" tabindex=\"0\" role=\"application\" aria-roledescription=\"timeline\" "
        "aria-label=\"{0}\" aria-describedby=\"keys\"></div>\n<div class=\"scroll\">{1}</div></figure>\n",
        html(name), lanesSvg(drive, lengthOf(drives), axisOf(drives)));
}

constexpr const char* kTools =
    "<div class=\"tools\" role=\"group\" aria-label=\"Zoom of all charts\">"
    "<button type=\"button\" data-do=\"in\" aria-label=\"Zoom in\">+</button>"
    "<button type=\"button\" data-do=\"out\" aria-label=\"Zoom out\">−</button>"
    "<button type=\"button\" data-do=\"earlier\" aria-label=\"Earlier\">◀</button>"
    "<button type=\"button\" data-do=\"later\" aria-label=\"Later\">▶</button>"
    "<button type=\"button\" data-do=\"all\">All</button>"
    "<p id=\"readout\" aria-live=\"polite\"></p></div>\n";

constexpr const char* kKeys =
    "<p class=\"note\" id=\"keys\">Upright lines mark handovers, dotted ones reselections; double ones pauses that are "
    "left "
    "out. Drag to zoom, drag with Shift to move, double-click for all. Keys: arrows read, with Shift faster; + and - "
    "zoom; "
    "Page Up and Page Down move; n and p go to the next and the previous change of cell; 0 shows all.</p>\n";

std::string chartPart(const std::vector<Chart>& charts, const std::vector<Drive>& drives) {
    std::string figures;
    for (const Chart& chart : charts) figures += chartFigure(chart, drives);
    std::string states;
    for (std::size_t i = 0; i < drives.size(); ++i) {
        const std::string letter = letterOf(i);
        states += stateFigure(drives[i], drives.size() == 1 ? "States" : letter + ": " + drives[i].name, drives);
    }
    if (figures.empty() && states.empty()) return {};
    return section("charts", "Over time", kTools + figures + states + kKeys);
}

std::string tablesOf(const Drive& drive, const std::string& mark, const std::string& prefix) {
    std::string parts = section("levels" + mark, prefix + "Levels and rates", levelTable(drive));
    parts += section("serving" + mark, prefix + "Serving cells", servingTable(drive));
    parts += section("neighbors" + mark, prefix + "Neighbors", neighborTable(drive));
    parts += section("states" + mark, prefix + "States", stateTable(drive));
    const std::string events = eventTable(drive);
    if (!events.empty()) {
        parts += section("events" + mark, prefix + "Events",
                         fmt::format("<details><summary>{}, one by one</summary>{}</details>\n",
                                     counted(drive.eventCount(), "event"), events));
    }
    return parts;
}

/// The widest step in which a line's readings were put together; none where every reading stands.
Elapsed widestStep(const std::vector<Chart>& charts) {
    Elapsed widest{1};
    for (const Chart& chart : charts) {
        for (const ChartLine& line : chart.lines) widest = std::max(widest, line.series->width());
    }
    return widest;
}

std::string notesOf(const std::vector<Chart>& charts, const std::vector<Drive>& drives) {
    std::string notes =
        "<li>A reading is a record having written the value. Medians and shares are of all readings, counted "
        "exactly; between two readings the straight line counts.</li>\n";
    const bool isByRecords = axisOf(drives) == Axis::Records;
    const Elapsed step = widestStep(charts);
    notes +=
        step <= Elapsed(1)
            ? std::string("<li>The lines show every reading.</li>\n")
            : fmt::format(
                  "<li>The lines are thinned: they show the mean of every {}, in a band from the lowest to the highest "
                  "reading of that time; none that sticks out is lost.</li>\n",
                  isByRecords ? counted(static_cast<std::uint64_t>(step / std::chrono::seconds(1)) + 1, "record")
                              : withUnit(std::chrono::duration<double>(step).count(), "s"));
    notes += isByRecords
                 ? std::string("<li>The records bear no times: everything is told by their number.</li>\n")
                 : std::string(
                       "<li>Times are the records' own, in UTC. Five minutes without a record, or a time that goes "
                       "back, is a pause: it counts for no cell and is left out of the charts.</li>\n");
    return notes +
           "<li>A handover is a change of cell in a connected state, a reselection any other.</li>\n"
           "<li>Grades are the steps that network planners agree on; no standard sets them.</li>\n";
}

std::string titleOf(const std::vector<Drive>& drives, const PageTerms& terms) {
    if (!terms.title.empty()) return terms.title;
    std::string title;
    for (const Drive& drive : drives) title += (title.empty() ? "" : " and ") + drive.name;
    return title;
}

}  // namespace

std::string reportPage(const std::vector<Drive>& drives, const PageTerms& terms) {
    const bool isOne = drives.size() == 1;
    const std::vector<Chart> charts = chartsOf(drives);
    std::map<std::string, std::string> parts;
    parts["title"] = html(titleOf(drives, terms));
    parts["version"] = html(Environment::current().version);
    parts["heading"] = heading(drives, titleOf(drives, terms));
    if (!terms.shared.empty()) parts["shared"] = "<p class=\"shared\">" + html(terms.shared) + "</p>\n";
    parts["summary"] = isOne ? summary(drives.front()) : comparison(drives);
    parts["charts"] = chartPart(charts, drives);
    if (!isOne) parts["tables"] = section("compared", "Serving cells, compared", comparedCells(drives));
    for (std::size_t i = 0; i < drives.size(); ++i) {
        const std::string letter = letterOf(i);
        parts["tables"] += tablesOf(drives[i], isOne ? "" : "-" + letter, isOne ? "" : letter + ": ");
        parts["unread"] += (isOne ? "" : "<h3>" + letter + "</h3>\n") + unreadPart(drives[i]);
    }
    parts["notes"] = notesOf(charts, drives);
    parts["licence"] = htmlLines(builtIn("copyright"));
    parts["data"] = chartJson(charts, drives);
    parts["style"] = builtIn("report.css");
    parts["library style"] = builtIn("dygraph.css");
    parts["library"] = builtIn("dygraph.js");
    parts["script"] = script();
    parts["scripts"] = nameOfScript(parts["library"]) + " " + nameOfScript(parts["script"]);
    return filled(builtIn("report.html"), parts);
}

}  // namespace kelvo::report
