#include "tools/OverviewJson.h"

#include <algorithm>

#include "tools/OverviewText.h"

namespace kelvo {
namespace {

using namespace overview;
using Json = nlohmann::ordered_json;

void add(Json& json, const char* name, const std::string& text) {
    if (!text.empty()) json[name] = text;
}

void add(Json& json, const char* name, const std::optional<Measure>& measure) {
    if (!measure) return;
    json[name] = {{"name", measure->name}, {"text", measure->figure.text}, {"number", measure->figure.number}};
    add(json[name], "unit", measure->figure.unit);
    add(json[name], "grade", measure->grade);
    json[name]["record"] = measure->figure.record;
}

Json jsonOf(const std::vector<Fact>& facts) {
    Json json = Json::object();
    for (const Fact& fact : facts) json[fact.name] = fact.text;
    return json;
}

/// As in the text, nothing is younger than now.
double seconds(Time::duration age) {
    return std::chrono::duration<double>(std::max(age, Time::duration::zero())).count();
}

}  // namespace

Json eventJson(const Event& event) {
    Json json = {{"time", isoText(event.time)}, {"event", nameOf(event.kind)}};
    add(json, "from", event.from);
    add(json, "to", event.to);
    add(json, "levelBefore", event.levelBefore);
    add(json, "levelAfter", event.levelAfter);
    if (event.record != 0) json["record"] = event.record;
    for (const EventValue& value : event.values) {
        Json& both = json["values"][value.name] = Json::object();
        add(both, "before", value.before);
        add(both, "after", value.after);
    }
    return json;
}

Json overviewJson(const Tracker& tracker, Time now) {
    const Observation& seen = tracker.latest();
    Json serving = Json::object();
    add(serving, "access", seen.access);
    add(serving, "state", seen.state);
    add(serving, "cell", seen.cell);
    add(serving, "level", seen.level);
    add(serving, "quality", seen.quality);
    if (tracker.levelTime()) serving["age"] = seconds(now - *tracker.levelTime());
    if (tracker.qualityTime()) serving["qualityAge"] = seconds(now - *tracker.qualityTime());
    add(serving, "area", seen.area);
    serving["facts"] = jsonOf(seen.serving);

    Json cells = Json::array();
    for (const TrackedCell& tracked : tracker.cells()) {
        Json cell = {{"cell", tracked.heard.identity}};
        add(cell, "mark", tracked.heard.mark);
        add(cell, "level", tracked.heard.level);
        add(cell, "quality", tracked.heard.quality);
        cell["age"] = seconds(now - tracked.lastHeard);
        cell["lost"] = tracked.isLost;
        cells.push_back(std::move(cell));
    }
    Json contexts = Json::array();
    for (const Context& context : seen.contexts) {
        contexts.push_back({{"name", context.name}, {"text", context.text}, {"up", context.isUp}});
    }
    Json events = Json::array();
    for (const Event& event : tracker.events()) events.push_back(eventJson(event));
    return {{"time", isoText(now)}, {"serving", serving},
            {"cells", cells},       {"registration", jsonOf(seen.registration)},
            {"contexts", contexts}, {"rates", jsonOf(seen.rates)},
            {"events", events}};
}

}  // namespace kelvo
