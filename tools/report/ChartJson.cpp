#include "tools/report/ChartJson.h"

#include <algorithm>
#include <cmath>
#include <map>
#include <nlohmann/json.hpp>

#include "platform/encodings/Utf8.h"
#include "tools/report/Words.h"

namespace kelvo::report {
namespace {

using Json = nlohmann::ordered_json;

std::int64_t milliseconds(Elapsed at) { return std::chrono::floor<std::chrono::milliseconds>(at).count(); }

/// Each less the one before.
class Differences {
public:
    void add(Elapsed at) {
        const std::int64_t now = milliseconds(at);
        _json.push_back(now - _last);
        _last = now;
    }
    Json take() { return std::move(_json); }

private:
    Json _json = Json::array();
    std::int64_t _last = 0;
};

/// A number in as many digits as a level has.
Json compact(double number) { return Json::parse(numberText(number), nullptr, false); }

Json lineJson(const ChartLine& line) {
    Differences at;
    Json values = Json::array();
    for (const Point& point : line.series->points()) {
        if (point.begins && !values.empty()) {
            at.add(point.at);
            values.push_back(nullptr);  // the line breaks here
        }
        at.add(point.at);
        if (point.low == point.high) {
            values.push_back(compact(point.mean));
        } else {
            values.push_back({compact(point.low), compact(point.mean), compact(point.high)});
        }
    }
    return {{"name", printable(line.name)}, {"style", line.style}, {"x", at.take()}, {"y", std::move(values)}};
}

Json chartJson(const Chart& chart) {
    Json grades = Json::array();
    for (const LevelGrade& grade : gradesByName(chart.measure)) {
        if (std::isfinite(grade.floor)) grades.push_back({grade.name, grade.floor});
    }
    Json lines = Json::array();
    for (const ChartLine& line : chart.lines) lines.push_back(lineJson(line));
    return {{"title", printable(chart.title)}, {"unit", printable(chart.unit)}, {"grades", grades}, {"lines", lines}};
}

Json laneJson(const NamedLane& lane) {
    std::map<std::string, std::size_t> known;
    Json texts = Json::array();
    // From the end of the one before, length, text; of one put together -1 less the text.
    Json segments = Json::array();
    std::int64_t last = 0;
    for (const Lane::Segment& segment : lane.lane.segments()) {
        const auto [text, isNew] = known.emplace(segment.text, known.size());
        if (isNew) texts.push_back(printable(segment.text));
        const std::int64_t from = milliseconds(segment.from);
        const std::int64_t to = milliseconds(segment.to);
        segments.push_back(from - last);
        segments.push_back(to - from);
        const auto number = static_cast<std::int64_t>(text->second);
        segments.push_back(segment.isBusy ? -1 - number : number);
        last = to;
    }
    return {{"name", lane.name}, {"texts", texts}, {"segments", segments}};
}

Json driveJson(const Drive& drive) {
    const Elapsed closest = drive.length / 4000;  // more marks than that nobody can tell apart
    Json stretches = Json::array();
    for (const Stretch& stretch : drive.time.stretches()) {
        const auto clock = std::chrono::floor<std::chrono::milliseconds>(stretch.time).time_since_epoch().count();
        stretches.push_back({milliseconds(stretch.at), clock});
    }
    std::map<bool, Elapsed> marked;  // handovers and reselections each by themselves
    Differences at;
    std::string kinds;
    for (const CellChange& change : drive.changes) {
        const auto last = marked.find(change.isHandover);
        if (last != marked.end() && change.at - last->second < closest) continue;
        marked[change.isHandover] = change.at;
        at.add(change.at);
        kinds += change.isHandover ? 'h' : 'r';
    }
    Json lanes = Json::array();
    for (const NamedLane& lane : drive.lanes) lanes.push_back(laneJson(lane));
    return {{"name", printable(drive.name)},
            {"stretches", stretches},
            {"marks", {{"x", at.take()}, {"kinds", kinds}}},
            {"lanes", lanes}};
}

/// A "<" could end the script element, or begin a comment within; it stands in texts alone, which may write it so.
std::string forScript(std::string json) {
    std::string safe;
    for (const char c : json) {
        if (c == '<') {
            safe += "\\u003c";
        } else if (c == '>') {
            safe += "\\u003e";
        } else if (c == '&') {
            safe += "\\u0026";
        } else {
            safe += c;
        }
    }
    return safe;
}

}  // namespace

std::string chartJson(const std::vector<Chart>& charts, const std::vector<Drive>& drives) {
    const Axis axis = axisOf(drives);
    Json json = {{"axis", axis == Axis::Clock     ? "clock"
                          : axis == Axis::Elapsed ? "elapsed"
                                                  : "records"},
                 {"length", milliseconds(lengthOf(drives))}};
    json["charts"] = Json::array();
    for (const Chart& chart : charts) json["charts"].push_back(chartJson(chart));
    json["drives"] = Json::array();
    for (const Drive& drive : drives) json["drives"].push_back(driveJson(drive));
    return forScript(json.dump(-1, ' ', true, Json::error_handler_t::replace));
}

}  // namespace kelvo::report
