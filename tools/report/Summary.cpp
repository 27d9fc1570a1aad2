#include "tools/report/Summary.h"

#include <fmt/format.h>

#include <algorithm>

#include "tools/report/Words.h"

namespace kelvo::report {
namespace {

using overview::Event;

constexpr std::size_t kMostCards = 6;  // of measures; the table of levels has all

using Times = std::vector<std::pair<std::string, Elapsed>>;

/// Longest first.
Times timesOf(const Drive& drive, std::string_view lane) {
    const Lane* found = drive.lane(lane);
    if (found == nullptr) return {};
    Times times(found->times().begin(), found->times().end());
    std::ranges::stable_sort(times, std::greater<>(), &std::pair<std::string, Elapsed>::second);
    return times;
}

double shareOf(Elapsed part, Elapsed whole) {
    return whole.count() > 0 ? static_cast<double>(part.count()) / static_cast<double>(whole.count()) : 0;
}

struct GradeShare {
    std::string_view name;
    double share;
};

std::vector<GradeShare> gradeShares(const MeasureFigures& figures) {
    std::vector<GradeShare> shares;
    std::uint64_t above = 0;
    for (const LevelGrade& grade : gradesByName(figures.name)) {
        const std::uint64_t from = figures.readings.countFrom(grade.floor);
        shares.push_back(
            {grade.name, static_cast<double>(from - above) / static_cast<double>(figures.readings.count())});
        above = from;
    }
    return shares;
}

std::string gradeBar(const MeasureFigures& figures) {
    const auto shares = gradeShares(figures);
    if (shares.empty()) return {};
    std::string bar = "<div class=\"grades\" aria-hidden=\"true\">";
    std::string words;
    for (std::size_t i = 0; i < shares.size(); ++i) {
        if (shares[i].share <= 0) continue;
        bar += fmt::format("<i class=\"g{}\" style=\"flex-grow:{:.4f}\"></i>", i, shares[i].share);
        words += fmt::format("<li class=\"g{}\">{} {}</li>", i, shares[i].name, shareText(shares[i].share));
    }
    return bar + "</div><ul class=\"gradewords\">" + words + "</ul>";
}

std::string measureCard(const MeasureFigures& figures, std::string_view what) {
    const Distribution& readings = figures.readings;
    std::string card = fmt::format(
        "<section class=\"card\"><h3>{} <small>{}</small></h3><p class=\"big\">{}<span> {}</span></p>"
        "<p class=\"note\">median of {}</p>",
        html(figures.name), what, numberText(readings.median()), html(figures.unit),
        counted(readings.count(), "reading"));
    card += gradeBar(figures) + "<dl class=\"range\">";
    const std::pair<const char*, double> marks[] = {{"min", 0}, {"5 %", 0.05}, {"95 %", 0.95}, {"max", 1}};
    for (const auto& [name, share] : marks) {
        card += fmt::format("<div><dt>{}</dt><dd>{}</dd></div>", name, numberText(readings.percentile(share)));
    }
    return card + "</dl></section>\n";
}

std::string listItems(const Times& times, const Drive& drive, std::size_t most) {
    std::string items;
    for (std::size_t i = 0; i < times.size() && i < most; ++i) {
        items +=
            fmt::format("<li><b>{}</b> {}</li>", html(times[i].first), lengthText(times[i].second, drive.isByRecords));
    }
    if (times.size() > most) items += fmt::format("<li>and {} more</li>", times.size() - most);
    return items;
}

std::string changesOf(const Drive& drive) {
    std::string changes;
    if (const Lane* registration = drive.lane("Registration")) {
        changes += fmt::format("<li>{}</li>", counted(registration->changes(), "registration change"));
    }
    const std::pair<Event::Kind, const char*> kinds[] = {
        {Event::Kind::Reject, "reject"}, {Event::Kind::Area, "area change"}, {Event::Kind::Access, "radio change"}};
    for (const auto& [kind, noun] : kinds) {
        if (const std::uint64_t count = drive.count(kind)) changes += fmt::format("<li>{}</li>", counted(count, noun));
    }
    const std::uint64_t lost = drive.count(Event::Kind::ServiceLost);
    if (lost != 0) changes += fmt::format("<li>service lost {}</li>", counted(lost, "time"));
    return changes.empty() ? "" : "<ul class=\"plain\">" + changes + "</ul>";
}

std::string networkCard(const Drive& drive) {
    const Times networks = timesOf(drive, "Network");
    const Times radios = timesOf(drive, "Radio");
    std::string card = "<section class=\"card\"><h3>Networks <small>time on each</small></h3>";
    card += networks.empty() ? "<p class=\"note\">The records name no network.</p>"
                             : "<ul class=\"plain\">" + listItems(networks, drive, 3) + "</ul>";
    if (!radios.empty()) card += "<p class=\"rule\"></p><ul class=\"plain\">" + listItems(radios, drive, 3) + "</ul>";
    const std::string changes = changesOf(drive);
    return card + (changes.empty() ? "" : "<p class=\"rule\"></p>" + changes) + "</section>\n";
}

std::string cellCard(const Drive& drive) {
    const std::size_t served = drive.serving.cells.size();
    if (served == 0 && drive.neighbors.cells.empty()) return {};
    std::string card = fmt::format(
        "<section class=\"card\"><h3>Cells <small>that served</small></h3><p class=\"big\">{}{}</p>"
        "<p class=\"note\">{} heard around</p><ul class=\"plain\"><li>{}</li><li>{}</li></ul>",
        grouped(served), drive.serving.beyond != 0 ? "+" : "", counted(drive.neighbors.cells.size(), "cell"),
        counted(drive.count(Event::Kind::Handover), "handover"),
        counted(drive.count(Event::Kind::Reselection), "reselection"));
    const Times cells = timesOf(drive, "Serving cell");
    if (!cells.empty()) {
        card += fmt::format("<p class=\"note\">longest: <b>{}</b>, {}</p>", html(cells.front().first),
                            lengthText(cells.front().second, drive.isByRecords));
    }
    return card + "</section>\n";
}

std::string cardsOf(const Drive& drive) {
    std::string cards;
    std::size_t count = 0;
    for (const MeasureFigures& figures : drive.levels) {
        if (figures.readings.isEmpty() || ++count > kMostCards) continue;
        cards += measureCard(figures, figures.isQuality ? "quality" : "level");
    }
    cards += cellCard(drive) + networkCard(drive);
    for (const MeasureFigures& figures : drive.rates) {
        if (!figures.readings.isEmpty() && ++count <= kMostCards) cards += measureCard(figures, "");
    }
    return "<div class=\"cards\">\n" + cards + "</div>\n";
}

/// "LTE", "UMTS and GSM"; of many the first three.
std::string listOf(const Times& times) {
    const std::size_t told = std::min<std::size_t>(times.size(), 3);
    std::string text;
    for (std::size_t i = 0; i < told; ++i) {
        text += (i == 0 ? "" : i + 1 == times.size() ? " and " : ", ") + ("<b>" + html(times[i].first) + "</b>");
    }
    return times.size() > told ? text + fmt::format(" and {} more", times.size() - told) : text;
}

std::string radioSentence(const Drive& drive) {
    const Times radios = timesOf(drive, "Radio");
    const Times networks = timesOf(drive, "Network");
    std::string sentence = "In <b>" + lengthText(drive.length, drive.isByRecords) + "</b> ";
    if (radios.empty() && networks.empty()) return sentence + "the records tell of no radio. ";
    sentence += "the phone was on " + (radios.empty() ? "" : listOf(radios));
    if (!networks.empty()) {
        sentence += fmt::format("{}{} {}", radios.empty() ? "" : ", ", networks.size() == 1 ? "network" : "networks",
                                listOf(networks));
    }
    return sentence + ". ";
}

std::string levelSentence(const Drive& drive) {
    const auto isLevel = [](const MeasureFigures& figures) { return !figures.isQuality; };
    std::vector<const MeasureFigures*> told;
    for (const MeasureFigures& figures : drive.levels) {
        if (!figures.readings.isEmpty()) told.push_back(&figures);
    }
    if (told.empty()) return "The records tell of no level. ";
    std::ranges::stable_sort(told, std::greater<>(), [&](const auto* figures) {
        return std::pair(isLevel(*figures), figures->readings.count());
    });
    const MeasureFigures& main = *told.front();
    const auto shares = gradeShares(main);
    std::string sentence =
        fmt::format("Its {} was {} in the middle ({}, the median)", isLevel(main) ? "level" : "quality",
                    "<b>" + html(withUnit(main.readings.median(), main.unit)) + "</b>", html(main.name));
    sentence += fmt::format(", nine tenths of the readings from {} to {}", numberText(main.readings.percentile(0.05)),
                            html(withUnit(main.readings.percentile(0.95), main.unit)));
    if (shares.size() == 4) {
        sentence += fmt::format("; <b>{}</b> of them were good or better, {} poor",
                                shareText(shares[0].share + shares[1].share), shareText(shares[3].share));
    }
    return sentence + ". ";
}

std::string cellSentence(const Drive& drive) {
    const std::uint64_t served = drive.serving.cells.size();
    if (served == 0) return "They tell of no serving cell. ";
    std::string sentence = fmt::format("<b>{}</b> served it, with {} and {}", counted(served, "cell"),
                                       counted(drive.count(Event::Kind::Handover), "handover"),
                                       counted(drive.count(Event::Kind::Reselection), "reselection"));
    const Times cells = timesOf(drive, "Serving cell");
    if (served > 1 && !cells.empty()) {
        sentence += fmt::format("; {} served longest, {} of the time", html(cells.front().first),
                                shareText(shareOf(cells.front().second, drive.length)));
    }
    return sentence + ". ";
}

std::string troubleSentence(const Drive& drive) {
    std::string text;
    const std::uint64_t lost = drive.count(Event::Kind::ServiceLost);
    const std::uint64_t rejects = drive.count(Event::Kind::Reject);
    if (const Lane* service = drive.lane("Service")) {
        const auto without = service->times().find("no service");
        if (without == service->times().end()) {
            text += "It was never without service. ";
        } else {
            text +=
                fmt::format("It was <b>without service</b> for {}{}. ", lengthText(without->second, drive.isByRecords),
                            lost > 1 ? ", lost " + counted(lost, "time") : "");
        }
    }
    if (rejects != 0) text += fmt::format("The network <b>refused</b> it {}. ", counted(rejects, "time"));
    return text;
}

}  // namespace

std::string heading(const std::vector<Drive>& drives, const std::string& title) {
    std::string lines;
    for (const Drive& drive : drives) {
        std::string when = "without times";
        if (drive.records == 0) {
            when = "empty";
        } else if (!drive.isByRecords) {
            const std::string first = timeText(drive.time.earliest());
            std::string last = timeText(drive.time.latest());
            if (last.substr(0, 10) == first.substr(0, 10)) last.erase(0, 11);
            when = fmt::format("{} to {} UTC", first, last);
            if (drive.time.pauses() != 0) when += fmt::format(", {} left out", counted(drive.time.pauses(), "pause"));
        }
        const std::string name = drive.name == title ? "" : "<b>" + html(drive.name) + "</b>";
        lines += fmt::format("<p class=\"when\">{}<span>{}</span> <span>{}</span> <span>{}</span></p>\n", name, when,
                             counted(drive.records, "record"), namesOf(drive.technology).name);
    }
    return lines;
}

std::string summary(const Drive& drive) {
    if (drive.records == 0) return "<p class=\"lead\">The file holds no record.</p>\n";
    const std::string sentences =
        radioSentence(drive) + levelSentence(drive) + cellSentence(drive) + troubleSentence(drive);
    return "<p class=\"lead\">" + sentences + "</p>\n" + cardsOf(drive);
}

}  // namespace kelvo::report
