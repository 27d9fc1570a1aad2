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

/// Whether one of the two is the other without its code or its carrier: "ARFCN 23" or "PSC 5" and "ARFCN 23, BSIC 42"
/// or "UARFCN 10562, PSC 5". What a modem measures before it has read the code is that cell, as far as anybody can
/// tell.
bool isSameCell(std::string_view one, std::string_view other) {
    if (one == other) return true;
    const std::string_view shorter = one.size() < other.size() ? one : other;
    const std::string_view longer = one.size() < other.size() ? other : one;
    const std::size_t comma = longer.find(", ");
    return comma != longer.npos && (shorter == longer.substr(0, comma) || shorter == longer.substr(comma + 2));
}

/// Of characters in UTF-8 none is cut in two.
std::string shortened(const std::string& text, std::size_t longest) {
    if (text.size() <= longest) return text;
    while (longest > 0 && (static_cast<unsigned char>(text[longest]) & 0xC0) == 0x80) --longest;
    return text.substr(0, longest);
}

/// The name of the first part of "LAC 2101, URA 6", and its number; both leave `parts`.
std::pair<std::string_view, std::string_view> takePart(std::string_view& parts) {
    const std::size_t end = std::min(parts.find(", "), parts.size());
    const std::string_view part = parts.substr(0, end);
    parts.remove_prefix(std::min(end + 2, parts.size()));
    const std::size_t space = std::min(part.find(' '), part.size());
    return {part.substr(0, space), part.substr(space)};
}

/// The names of those parts that both have and that differ.
std::vector<std::string_view> changedParts(std::string_view before, std::string_view now) {
    std::vector<std::string_view> changed;
    while (!before.empty()) {
        const auto [name, number] = takePart(before);
        for (std::string_view rest = now; !rest.empty();) {
            const auto [same, other] = takePart(rest);
            if (same == name && other != number) changed.push_back(name);
        }
    }
    return changed;
}

void addChanged(std::vector<EventValue>& values, std::string_view name, const std::string& before,
                const std::string& after) {
    if (before != after) values.push_back({std::string(name), before, after});
}

void addChanged(std::vector<EventValue>& values, const std::vector<Fact>& before, const std::vector<Fact>& after) {
    for (const Fact& fact : before) {
        const auto same = std::ranges::find(after, fact.name, &Fact::name);
        addChanged(values, fact.name, fact.text, same != after.end() ? same->text : std::string());
    }
    for (const Fact& fact : after) {
        if (std::ranges::find(before, fact.name, &Fact::name) == before.end())
            addChanged(values, fact.name, {}, fact.text);
    }
}

std::vector<Fact> factsOf(const std::vector<Context>& contexts) {
    std::vector<Fact> facts;
    facts.reserve(contexts.size());
    for (const Context& context : contexts) facts.push_back({context.name, context.text});
    return facts;
}

std::string lengthText(Time::duration length) {
    const auto milliseconds = std::chrono::duration_cast<std::chrono::milliseconds>(length).count();
    return fmt::format("after {:.1f} s", static_cast<double>(milliseconds) / 1000);
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
        case Kind::ServiceBack: return "service back";
        case Kind::ConnectionLost: return "connection lost";
        case Kind::ConnectionBack: break;
    }
    return "connection back";
}

void Tracker::note(Observation seen, Time now, Time clock) {
    _before = std::exchange(_seen, std::move(seen));
    _now = now;
    _clock = clock;
    keepServing();
    noteCells();
    noteServing();
    noteWhetherHandover();
    noteStates();
    noteContexts();
    noteService();
    noteFigure(_level, _seen.level, true);
    noteFigure(_quality, _seen.quality, false);
}

void Tracker::letPass(Time now) {
    std::erase_if(_cells, [&](const TrackedCell& cell) {
        return isSameCell(cell.heard.identity, _seen.cell) || now - cell.lastHeard > kHeardFor + kLostFor;
    });
    for (TrackedCell& cell : _cells) cell.isLost = now - cell.lastHeard > kHeardFor;
}

void Tracker::noteConnectionLost(Time clock) { append({.time = clock, .kind = Kind::ConnectionLost}); }

void Tracker::noteConnectionBack(Time clock, Time::duration lost) {
    append({.time = clock, .kind = Kind::ConnectionBack, .to = lengthText(lost)});
}

void Tracker::restart() {
    std::deque<Event> events = std::move(_events);
    const std::uint64_t count = _eventCount;
    *this = Tracker(_limits);
    _events = std::move(events);
    _eventCount = count;
}

void Tracker::noteCells() {
    for (const HeardCell& heard : _seen.cells) {
        const auto known = std::ranges::find_if(
            _cells, [&](const TrackedCell& cell) { return isSameCell(cell.heard.identity, heard.identity); });
        if (known == _cells.end()) {
            _cells.push_back({heard, _now, false});
        } else if (heard.record > known->heard.record) {
            std::string whole = std::move(known->heard.identity);
            if (whole.size() < heard.identity.size()) whole = heard.identity;
            *known = {heard, _now, false};
            known->heard.identity = std::move(whole);
        }
    }
    letPass(_now);
    order(_cells);
}

/// The last event of its kind, when what changes now is another part of what changed then: "ARFCN 21" comes in one
/// record and "BSIC 44" in another, but it is one cell.
Event* Tracker::unfinished(bool isCell, const std::string& before, const std::string& now) {
    const auto last = std::find_if(_events.rbegin(), _events.rend(), [&](const Event& event) {
        return isCell ? isCellChange(event.kind) : event.kind == Kind::Area;
    });
    if (last == _events.rend() || _clock - last->time > kSettling || last->to != before) return nullptr;
    const auto parts = changedParts(before, now);
    if (parts.empty()) return nullptr;
    for (const std::string_view part : changedParts(last->from, last->to)) {
        if (std::ranges::find(parts, part) != parts.end()) return nullptr;
    }
    return &*last;
}

void Tracker::complete(Event& event, std::string_view name, const std::string& now) {
    event.to = shortened(now, Event::kLongestText);
    const auto value = std::ranges::find(event.values, name, &EventValue::name);
    if (value != event.values.end()) value->after = shortened(now, Event::kLongestValue);
}

/// Of several carriers that are told in turn the first stays the serving one for as long as it is told, and the others
/// are cells beside it; another cell on its own channel takes its place at once. What a record left out stands as it
/// was, and ages.
void Tracker::keepServing() {
    const bool isOther = !_before.cell.empty() && _seen.cell != _before.cell;
    const bool isTold = std::exchange(_carrierRecord, _seen.cellRecord) != _seen.cellRecord;
    const bool isCarrier =
        isOther && _seen.cellIsOneOfSeveral && (_seen.channel.empty() || _seen.channel != _before.channel);
    if (isCarrier && (!isTold || _now - _servingTold <= _limits.turn)) {
        _seen.cells.push_back({_seen.cell, "active", _seen.level, _seen.quality, _seen.cellRecord});
        _seen.cell = _before.cell;
        _seen.cellRecord = _before.cellRecord;
        _seen.channel = _before.channel;
        _seen.band = _before.band;
        _seen.serving = _before.serving;
        _seen.level = _before.level;
        _seen.quality = _before.quality;
    } else if (isOther || _seen.cellRecord != _before.cellRecord) {
        _servingTold = _now;
    }
    if (_seen.cell != _before.cell || _seen.access != _before.access) return;
    if (!_seen.level) _seen.level = _before.level;
    if (!_seen.quality) _seen.quality = _before.quality;
}

void Tracker::noteServing() {
    if (_seen.cell.empty() || _seen.cell == _before.cell) return;
    if (_seen.cellComesInParts) {
        if (Event* change = unfinished(true, _before.cell, _seen.cell)) return complete(*change, "Cell", _seen.cell);
    }
    const bool isFirst = _before.cell.empty();
    const bool wasConnected = isFresh(_level) && _connectedSince && _now - *_connectedSince >= kMoment;
    happened({.time = _clock,
              .kind = isFirst                             ? Kind::CellFound
                      : wasConnected && _seen.isDedicated ? Kind::Handover
                                                          : Kind::Reselection,
              .from = _before.cell,
              .to = _seen.cell,
              .levelBefore = isFirst || !isFresh(_level) ? std::string() : _level.text,
              .record = _seen.cellRecord});
    _level.isAwaited = true;
    _quality.isAwaited = true;
    _leftConnected = wasConnected && !isFirst ? std::optional(_now) : std::nullopt;
}

/// On another radio the record of the state may come after that of the cell; between the two it is not known.
void Tracker::noteWhetherHandover() {
    if (!_seen.isDedicated && !_seen.state.empty()) _connectedSince.reset();
    if (_seen.isDedicated && !_connectedSince) _connectedSince = _now;
    if (!_leftConnected || !_seen.isDedicated) return;
    const bool isOne = _now - *_leftConnected <= kSettling;
    _leftConnected.reset();
    const auto change =
        std::find_if(_events.rbegin(), _events.rend(), [](const Event& e) { return isCellChange(e.kind); });
    if (isOne && change != _events.rend()) change->kind = Kind::Handover;
}

/// A figure that was written before the cell changed is the old cell's.
void Tracker::noteFigure(Followed& followed, const std::optional<Measure>& now, bool isLevel) {
    if (!now) return;
    if (std::exchange(followed.record, now->figure.record) != followed.record) followed.time = _now;
    if (followed.record < _seen.cellRecord) return;
    followed.text = now->figure.text;
    if (std::exchange(followed.isAwaited, false)) fillIn(*now, isLevel);
}

/// The first figure of the cell that began to serve, which the events from then on lack.
void Tracker::fillIn(const Measure& figure, bool isLevel) {
    const std::string name = shortened(figure.name, Event::kLongestValue);
    const std::string text = shortened(figure.figure.text, Event::kLongestValue);
    for (auto event = _events.rbegin(); event != _events.rend(); ++event) {
        const bool isChange = isCellChange(event->kind);
        const auto value = std::ranges::find(event->values, name, &EventValue::name);
        if (value != event->values.end()) {
            if (value->after.empty()) value->after = text;
        } else if (isChange && event->values.size() < Event::kMostValues) {
            event->values.push_back({name, {}, text});
        }
        if (isChange && isLevel) event->levelAfter = text;
        if (isChange) return;
    }
}

void Tracker::noteStates() {
    noteChange(Kind::Access, _before.access, _seen.access);
    if (_before.access == _seen.access) {  // bands and states of two radios do not compare
        noteChange(Kind::Band, _before.band, _seen.band);
        noteChange(Kind::State, _before.state, _seen.state);
    }
    noteArea();
    noteChange(Kind::Registration, _before.registrationState, _seen.registrationState);
    if (_seen.reject != _before.reject && !_seen.reject.empty()) {
        happened({.time = _clock, .kind = Kind::Reject, .to = _seen.reject});
    }
}

/// A part that was not known before is no change. Without service there is no area, which is none either.
void Tracker::noteArea() {
    if (_seen.area.empty()) return;
    const std::string before = std::exchange(_area, _seen.area);
    if (Event* change = unfinished(false, before, _seen.area)) return complete(*change, "Area", _seen.area);
    if (!changedParts(before, _seen.area).empty()) noteChange(Kind::Area, before, _seen.area);
}

void Tracker::noteContexts() {
    const auto tell = [&](Kind kind, const std::vector<Context>& those, const std::vector<Context>& others) {
        for (const Context& context : those) {
            const auto isThere = [&](const Context& other) { return other.isUp && other.name == context.name; };
            if (!context.isUp || std::ranges::any_of(others, isThere)) continue;
            const bool isUp = kind == Kind::ContextUp;
            happened({.time = _clock,
                      .kind = kind,
                      .from = isUp ? std::string() : context.name,
                      .to = isUp ? context.name : std::string()});
        }
    };
    tell(Kind::ContextDown, _before.contexts, _seen.contexts);
    tell(Kind::ContextUp, _seen.contexts, _before.contexts);
}

void Tracker::noteService() {
    if (!_seen.knowsService) return;
    const auto before = std::exchange(_isWithoutService, _seen.isWithoutService);
    if (before == _seen.isWithoutService) return;
    if (_seen.isWithoutService) {
        _lostSince = _now;
        if (before) happened({.time = _clock, .kind = Kind::ServiceLost});
    } else if (before) {
        happened({.time = _clock, .kind = Kind::ServiceBack, .to = lengthText(_now - _lostSince)});
    }
}

void Tracker::noteChange(Kind kind, const std::string& from, const std::string& to) {
    if (from == to || from.empty() || to.empty()) return;
    happened({.time = _clock, .kind = kind, .from = from, .to = to});
}

void Tracker::addFigure(std::vector<EventValue>& values, const Followed& followed, const std::optional<Measure>& before,
                        const std::optional<Measure>& after) const {
    const std::string then = before && isFresh(followed) ? followed.text : std::string();
    const std::string now = after && after->figure.record >= _seen.cellRecord ? after->figure.text : std::string();
    const bool isOne = before && after && before->name == after->name;
    if (!then.empty()) values.push_back({before->name, then, isOne ? now : std::string()});
    if (!now.empty() && (then.empty() || !isOne)) values.push_back({after->name, {}, now});
}

std::vector<EventValue> Tracker::valuesAround() const {
    std::vector<EventValue> values;
    addChanged(values, "Cell", _before.cell, _seen.cell);
    addFigure(values, _level, _before.level, _seen.level);
    addFigure(values, _quality, _before.quality, _seen.quality);
    addChanged(values, "Radio", _before.access, _seen.access);
    addChanged(values, "State", _before.state, _seen.state);
    addChanged(values, "Area", _before.area, _seen.area);
    addChanged(values, _before.registration, _seen.registration);
    addChanged(values, factsOf(_before.contexts), factsOf(_seen.contexts));
    addChanged(values, _before.serving, _seen.serving);
    if (values.size() > Event::kMostValues) values.resize(Event::kMostValues);
    for (EventValue& value : values) {
        for (std::string* text : {&value.name, &value.before, &value.after})
            *text = shortened(*text, Event::kLongestValue);
    }
    values.shrink_to_fit();
    return values;
}

void Tracker::happened(Event event) {
    event.values = valuesAround();
    for (std::string* text : {&event.from, &event.to, &event.levelBefore})
        *text = shortened(*text, Event::kLongestText);
    append(std::move(event));
}

void Tracker::append(Event event) {
    while (!_events.empty() && (_events.size() >= _limits.events || event.time - _events.front().time > _limits.span)) {
        _events.pop_front();
    }
    _events.push_back(std::move(event));
    ++_eventCount;
}

}  // namespace kelvo::overview
