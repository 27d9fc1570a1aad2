#include "overview/Tracker.h"

#include <fmt/format.h>

#include <algorithm>
#include <utility>

namespace kelvo::overview {
namespace {

using Kind = Event::Kind;

bool isCellChange(Kind kind) { return kind == Kind::CellFound || kind == Kind::Handover || kind == Kind::Reselection; }

/// Whether `cell` must not stand below `above`.
bool overtakes(const TrackedCell& cell, const TrackedCell& above) {
    const auto& level = cell.heard.level;
    if (!level) return false;
    const double margin = level->figure.unit.empty() ? 0 : Tracker::kSteady;
    return !above.heard.level || level->figure.number > above.heard.level->figure.number + margin;
}

/// Each cell moves up to the first that it overtakes. Those above are in order already, so none that it passes is much
/// stronger than it.
void order(std::vector<TrackedCell>& cells) {
    for (auto cell = cells.begin(); cell != cells.end(); ++cell) {
        const auto place =
            std::find_if(cells.begin(), cell, [&](const auto& above) { return overtakes(*cell, above); });
        std::rotate(place, cell, cell + 1);
    }
}

/// Whether one of the two is the other without its code: "ARFCN 23" and "ARFCN 23, BSIC 42". What a modem measures
/// before it has read the code is that cell, as far as anybody can tell.
bool isSameCell(const std::string& one, const std::string& other) {
    const std::string& shorter = one.size() < other.size() ? one : other;
    const std::string& longer = one.size() < other.size() ? other : one;
    return one == other || (shorter.find(',') == shorter.npos && longer.starts_with(shorter + ","));
}

}  // namespace

std::string_view nameOf(Event::Kind kind) {
    switch (kind) {
        case Kind::CellFound: return "cell found";
        case Kind::Handover: return "handover";
        case Kind::Reselection: return "reselection";
        case Kind::Access: return "radio change";
        case Kind::Band: return "band change";
        case Kind::State: return "state change";
        case Kind::Area: return "area change";
        case Kind::Registration: return "registration";
        case Kind::Reject: return "reject";
        case Kind::ContextUp: return "context up";
        case Kind::ContextDown: return "context down";
        case Kind::ServiceLost: return "service lost";
        case Kind::ServiceBack: break;
    }
    return "service back";
}

void Tracker::note(Observation seen, Time now) {
    const Observation before = std::exchange(_seen, std::move(seen));
    noteCells(now);
    noteServing(before, now);
    noteLevel(now);
    noteStates(before, now);
    noteContexts(before, now);
    noteService(before, now);
}

void Tracker::noteCells(Time now) {
    for (const HeardCell& heard : _seen.cells) {
        const auto known = std::ranges::find_if(
            _cells, [&](const TrackedCell& cell) { return isSameCell(cell.heard.identity, heard.identity); });
        if (known == _cells.end()) {
            _cells.push_back({heard, now, false});
        } else if (heard.record > known->heard.record) {
            const std::string identity = std::max(known->heard.identity, heard.identity);  // that with its code
            *known = {heard, now, false};
            known->heard.identity = identity;
        }
    }
    std::erase_if(_cells, [&](const TrackedCell& cell) {
        return isSameCell(cell.heard.identity, _seen.cell) || now - cell.lastHeard > kHeardFor + kLostFor;
    });
    for (TrackedCell& cell : _cells) cell.isLost = now - cell.lastHeard > kHeardFor;
    order(_cells);
}

void Tracker::noteServing(const Observation& before, Time now) {
    if (_seen.cell.empty() || _seen.cell == before.cell) return;
    const bool isFirst = before.cell.empty();
    const bool isFresh = _levelTime && now - *_levelTime <= kHeardFor;
    const bool stays = isFresh && before.isDedicated && _seen.isDedicated;
    happened({.time = now,
              .kind = isFirst ? Kind::CellFound
                      : stays ? Kind::Handover
                              : Kind::Reselection,
              .from = before.cell,
              .to = _seen.cell,
              .levelBefore = isFirst || !isFresh ? std::string() : _level,
              .levelAfter = {},
              .record = _seen.cellRecord});
    _awaitsLevel = true;
}

/// A level that was written before the cell changed is the old cell's.
void Tracker::noteLevel(Time now) {
    if (!_seen.level) return;
    if (std::exchange(_levelRecord, _seen.level->figure.record) != _levelRecord) _levelTime = now;
    if (_levelRecord < _seen.cellRecord) return;
    _level = _seen.level->figure.text;
    if (!std::exchange(_awaitsLevel, false)) return;
    const auto change =
        std::find_if(_events.rbegin(), _events.rend(), [](const Event& e) { return isCellChange(e.kind); });
    if (change != _events.rend()) change->levelAfter = _level;
}

void Tracker::noteStates(const Observation& before, Time now) {
    noteChange(Kind::Access, before.access, _seen.access, now);
    if (before.access == _seen.access) {  // bands and states of two radios do not compare
        noteChange(Kind::Band, before.band, _seen.band, now);
        noteChange(Kind::State, before.state, _seen.state, now);
    }
    noteChange(Kind::Area, before.area, _seen.area, now);
    noteChange(Kind::Registration, before.registrationState, _seen.registrationState, now);
    if (_seen.reject != before.reject && !_seen.reject.empty()) {
        happened(
            {.time = now, .kind = Kind::Reject, .from = {}, .to = _seen.reject, .levelBefore = {}, .levelAfter = {}});
    }
}

void Tracker::noteContexts(const Observation& before, Time now) {
    const auto tell = [&](Kind kind, const std::vector<Context>& those, const std::vector<Context>& others) {
        for (const Context& context : those) {
            const auto isThere = [&](const Context& other) { return other.isUp && other.name == context.name; };
            if (!context.isUp || std::ranges::any_of(others, isThere)) continue;
            const bool isUp = kind == Kind::ContextUp;
            happened({.time = now,
                      .kind = kind,
                      .from = isUp ? std::string() : context.name,
                      .to = isUp ? context.name : std::string(),
                      .levelBefore = {},
                      .levelAfter = {}});
        }
    };
    tell(Kind::ContextDown, before.contexts, _seen.contexts);
    tell(Kind::ContextUp, _seen.contexts, before.contexts);
}

void Tracker::noteService(const Observation& before, Time now) {
    if (!std::exchange(_isBegun, true)) {
        if (_seen.isWithoutService) _lostSince = now;
        return;
    }
    if (_seen.isWithoutService == before.isWithoutService) return;
    Event event{.time = now, .kind = Kind::ServiceLost, .from = {}, .to = {}, .levelBefore = {}, .levelAfter = {}};
    if (_seen.isWithoutService) {
        _lostSince = now;
    } else {
        event.kind = Kind::ServiceBack;
        const auto length = std::chrono::duration_cast<std::chrono::milliseconds>(now - _lostSince.value_or(now));
        event.to = fmt::format("after {:.1f} s", static_cast<double>(length.count()) / 1000);
    }
    happened(std::move(event));
}

void Tracker::noteChange(Kind kind, const std::string& from, const std::string& to, Time now) {
    if (from == to || from.empty() || to.empty()) return;
    happened({.time = now, .kind = kind, .from = from, .to = to, .levelBefore = {}, .levelAfter = {}});
}

void Tracker::happened(Event event) {
    while (!_events.empty() && (_events.size() >= _limits.events || event.time - _events.front().time > _limits.span)) {
        _events.pop_front();
    }
    _events.push_back(std::move(event));
}

}  // namespace kelvo::overview
