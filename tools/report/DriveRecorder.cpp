#include "tools/report/DriveRecorder.h"

#include <fmt/format.h>

#include <algorithm>

namespace kelvo::report {
namespace {

using namespace overview;

constexpr auto kRecently = std::chrono::seconds(5);  // what was heard before is no rival of what is heard now
constexpr std::size_t kUnsettled = 500;              // of the latest events something may change yet
constexpr std::size_t kMostMeasures = 12;            // a recording has two to five; a hostile one must not fill a page

/// Some screens show the level RSCP in dB, others in dBm, which it is in (3GPP TS 25.215, clause 5.1.1).
const std::string& unitOf(const Measure& measure) {
    static const std::string dbm = "dBm";
    return measure.name == "RSCP" && measure.figure.unit == "dB" ? dbm : measure.figure.unit;
}

MeasureFigures* figuresOf(std::vector<MeasureFigures>& all, const std::string& name, const std::string& unit) {
    for (MeasureFigures& figures : all) {
        if (figures.name == name && figures.unit == unit) return &figures;
    }
    if (all.size() >= kMostMeasures) return nullptr;
    MeasureFigures& made = all.emplace_back();
    made.name = name;
    made.unit = unit;
    return &made;
}

void keep(std::string& kept, const std::string& text) {
    if (!text.empty() && kept != text) kept = text;
}

void addReading(Distribution& readings, std::string& name, std::string& unit, const Measure& measure) {
    if (name.empty()) {
        name = measure.name;
        unit = unitOf(measure);
    }
    if (name == measure.name && unit == unitOf(measure)) readings.add(measure.figure.number);
}

/// "1-1" of one record is "001-01" of another: a country code has three digits and a network code at least two.
std::string networkOf(const Observation& seen) {
    const auto fact = std::ranges::find(seen.serving, "Network", &Fact::name);
    if (fact == seen.serving.end()) return {};
    const std::size_t dash = fact->text.find('-');
    if (dash == fact->text.npos || fact->text.find_first_not_of("0123456789-") != fact->text.npos) return fact->text;
    return fmt::format("{:0>3}-{:0>2}", fact->text.substr(0, dash), fact->text.substr(dash + 1));
}

/// Whether the records tell of service at all.
bool tellsService(const Observation& seen) {
    return std::ranges::any_of(seen.registration,
                               [](const Fact& fact) { return fact.name == "Service" || fact.name == "Registration"; });
}

Lane& laneOf(Drive& drive, const char* name) {
    const auto found = std::ranges::find(drive.lanes, name, &NamedLane::name);
    return found != drive.lanes.end() ? found->lane : drive.lanes.emplace_back(NamedLane{name, {}}).lane;
}

/// The measure by which a cell around is compared with others.
const std::optional<Measure>& measureOf(const HeardCell& heard) { return heard.level ? heard.level : heard.quality; }

}  // namespace

void DriveRecorder::note(const Tracker& tracker, std::uint64_t number, Elapsed at, Time now) {
    const Observation& seen = tracker.latest();
    noteServing(seen, at);
    noteLevels(seen, at);
    noteNeighbors(tracker, number, at, now);
    noteRates(seen, number, at);
    noteLanes(seen, at);
    noteEvents(tracker, at);
}

void DriveRecorder::interrupt() {
    for (auto* measures : {&_drive.levels, &_drive.rates}) {
        for (MeasureFigures& figures : *measures) {
            figures.series.interrupt();
            figures.bestNeighbor.interrupt();
        }
    }
}

void DriveRecorder::end(const Tracker& tracker, Elapsed at) {
    if (_serving != nullptr) _serving->served += at - _servingSince;
    _serving = nullptr;
    for (NamedLane& lane : _drive.lanes) lane.lane.end(at);
    std::erase_if(_drive.lanes, [](const NamedLane& lane) { return lane.lane.segments().empty(); });
    while (!_eventTimes.empty()) keepOldestEvent(tracker);
    _drive.length = at;
}

/// The tracker fills in an event's levels, and finds out whether it was a handover, a while after it happened.
void DriveRecorder::noteEvents(const Tracker& tracker, Elapsed at) {
    _eventTimes.resize(_eventTimes.size() + (tracker.eventCount() - _eventCount), at);
    _eventCount = tracker.eventCount();
    while (_eventTimes.size() > kUnsettled) keepOldestEvent(tracker);
}

void DriveRecorder::keepOldestEvent(const Tracker& tracker) {
    const std::size_t fromEnd = _eventTimes.size();
    const Elapsed at = _eventTimes.front();
    _eventTimes.pop_front();
    if (fromEnd > tracker.events().size()) return;  // one record told of more than the tracker keeps
    const Event& event = tracker.events()[tracker.events().size() - fromEnd];
    ++_drive.counts[event.kind];
    const bool isHandover = event.kind == Event::Kind::Handover;
    if (isHandover || event.kind == Event::Kind::Reselection) _drive.changes.push_back({at, isHandover});
    if (_drive.events.size() < Drive::kMostEvents) _drive.events.push_back({at, event});
}

void DriveRecorder::noteServing(const Observation& seen, Elapsed at) {
    if (_serving != nullptr) _serving->served += at - _servingSince;
    _servingSince = at;
    if (seen.cell != _cell || (_serving == nullptr && !seen.cell.empty())) {
        _cell = seen.cell;
        _serving = _cell.empty() ? nullptr : _drive.serving.at(_cell);
        if (_serving != nullptr) {
            if (_serving->visits++ == 0) _serving->first = at;
        }
    }
    if (_serving == nullptr) return;
    _serving->last = at;
    keep(_serving->access, seen.access);
    keep(_serving->band, seen.band);
    keep(_serving->area, seen.area);
    keep(_serving->network, networkOf(seen));
}

/// A reading is a record that wrote the value, whether or not it changed.
void DriveRecorder::noteLevels(const Observation& seen, Elapsed at) {
    if (seen.access != _access) {
        _access = seen.access;
        interrupt();
    }
    const auto note = [&](const std::optional<Measure>& measure, std::uint64_t& last, bool isQuality) {
        if (!measure || measure->figure.record == last) return false;
        last = measure->figure.record;
        if (MeasureFigures* figures = figuresOf(_drive.levels, measure->name, unitOf(*measure))) {
            figures->isQuality = isQuality;
            figures->readings.add(measure->figure.number);
            figures->series.add(at, measure->figure.number);
        }
        return true;
    };
    if (note(seen.level, _levelRecord, false) && _serving != nullptr) {
        addReading(_serving->level, _serving->levelName, _serving->levelUnit, *seen.level);
    }
    if (note(seen.quality, _qualityRecord, true) && _serving != nullptr) {
        addReading(_serving->quality, _serving->qualityName, _serving->qualityUnit, *seen.quality);
    }
}

void DriveRecorder::noteNeighbors(const Tracker& tracker, std::uint64_t number, Elapsed at, Time now) {
    const Observation& seen = tracker.latest();
    const bool isNews = std::ranges::any_of(seen.cells, [&](const HeardCell& cell) { return cell.record == number; });
    if (!isNews) return;
    const Measure* best = nullptr;
    for (const TrackedCell& cell : tracker.cells()) {
        const auto& measure = measureOf(cell.heard);
        if (measure && now - cell.lastHeard <= kRecently &&
            (best == nullptr || (best->name == measure->name && measure->figure.number > best->figure.number))) {
            best = &*measure;
        }
        if (cell.heard.record != number) continue;
        CellFigures* figures = _drive.neighbors.at(cell.heard.identity);
        if (figures == nullptr) continue;
        if (figures->heard++ == 0) figures->first = at;
        figures->last = at;
        figures->mark = cell.heard.mark;
        if (cell.heard.level) addReading(figures->level, figures->levelName, figures->levelUnit, *cell.heard.level);
        if (cell.heard.quality) {
            addReading(figures->quality, figures->qualityName, figures->qualityUnit, *cell.heard.quality);
        }
        const auto& serving = cell.heard.level ? seen.level : seen.quality;
        if (measure && serving && serving->name == measure->name && measure->figure.number > serving->figure.number) {
            ++figures->stronger;
        }
    }
    if (best == nullptr) return;
    if (MeasureFigures* figures = figuresOf(_drive.levels, best->name, unitOf(*best))) {
        figures->bestNeighbor.add(at, best->figure.number);
    }
}

void DriveRecorder::noteRates(const Observation& seen, std::uint64_t number, Elapsed at) {
    for (const Fact& rate : seen.rates) {
        if (!rate.figure || rate.figure->record != number) continue;
        MeasureFigures* figures = figuresOf(_drive.rates, rate.name, rate.figure->unit);
        if (figures == nullptr) continue;
        figures->readings.add(rate.figure->number);
        figures->series.add(at, rate.figure->number);
    }
}

void DriveRecorder::noteLanes(const Observation& seen, Elapsed at) {
    laneOf(_drive, "Radio").note(at, seen.access);
    laneOf(_drive, "Network").note(at, networkOf(seen));
    laneOf(_drive, "Serving cell").note(at, seen.cell);
    laneOf(_drive, "State").note(at, seen.state);
    laneOf(_drive, "Area").note(at, seen.area);
    laneOf(_drive, "Registration").note(at, seen.registrationState);
    if (tellsService(seen)) {
        laneOf(_drive, "Service").note(at, seen.isWithoutService ? "no service" : "in service");
    }
    std::string contexts;
    for (const Context& context : seen.contexts) {
        if (context.isUp) contexts += (contexts.empty() ? "" : ", ") + context.name;
    }
    laneOf(_drive, "Data contexts").note(at, contexts);
}

}  // namespace kelvo::report
