#include "overview/LiveOverview.h"

#include <algorithm>
#include <utility>

#include "platform/system/Environment.h"

namespace kelvo::overview {
namespace {

Time timeOfDay() { return std::chrono::floor<std::chrono::microseconds>(clock().now()); }

template <class Entries>
void keepLast(Entries& entries, Trend::Time from) {
    while (!entries.empty() && (entries.front().at < from || entries.size() > LiveOverview::kMostPoints)) {
        entries.pop_front();
    }
}

}  // namespace

Time LiveOverview::now() const { return std::max(_latest, Time(_model.streamTime())); }

std::optional<Time::duration> LiveOverview::ageOf(std::optional<Time> then) const {
    return then ? std::optional(now() - *then) : std::nullopt;
}

void LiveOverview::refreshed() {
    noteConnection();
    const auto technology = _model.technology();
    if (!technology || !isOfThisModem()) return letPass();
    Observation seen = observe(*technology, _model.display());
    if (_exchangedAt != 0) {  // what stands there of the other modem is not seen
        if (seen.cellRecord <= _exchangedAt) return letPass();
        std::erase_if(seen.cells, [&](const HeardCell& cell) { return cell.record <= _exchangedAt; });
    }
    _latest = now();
    const std::string before = _tracker.latest().cell;
    _tracker.note(std::move(seen), _latest, timeOfDay());
    noteServingCell(before);
    extend(_level, _tracker.latest().level);
    extend(_quality, _tracker.latest().quality);
    forgetOld();
}

void LiveOverview::connectionChanged() {
    noteConnection();
    isOfThisModem();
}

void LiveOverview::letPass() {
    noteConnection();
    _latest = now();
    _tracker.letPass(_latest);
    forgetOld();
}

/// A connection that went and came back between two looks was lost all the same.
void LiveOverview::noteConnection() {
    const Trend::Time now = _model.trendTime();
    const std::uint64_t before = std::exchange(_connections, _model.connectionCount());
    const bool isGone = !_model.isConnected() || _connections != before;
    if (before != 0 && !_lostSince && isGone) {
        _tracker.noteConnectionLost(timeOfDay());
        _lostSince = now;
    }
    if (!_lostSince || !_model.isConnected()) return;
    _tracker.noteConnectionBack(timeOfDay(), now - *_lostSince);
    _lostSince.reset();
}

/// The screens stay those of the first technology; a modem of another writes nothing there.
bool LiveOverview::isOfThisModem() {
    const auto spoken = _model.spokenTechnology();
    if (spoken && _technology && spoken != _technology) {
        _tracker.restart();
        _level = _quality = Line();
        _servingCells.clear();
        _exchangedAt = _model.recordCount();
    }
    if (spoken) _technology = spoken;
    return _technology == _model.technology();
}

void LiveOverview::noteServingCell(const std::string& before) {
    const std::string& cell = _tracker.latest().cell;
    if (!before.empty() && !cell.empty() && cell != before) _servingCells.push_back({_model.trendTime(), cell});
}

/// Readings of two kinds make no line.
void LiveOverview::extend(Line& line, const std::optional<Measure>& measure) {
    if (!measure) return;
    if (line.name != measure->name || line.unit != measure->figure.unit) {
        line = {.name = measure->name, .unit = measure->figure.unit};
    }
    if (std::exchange(line.lastRecord, measure->figure.record) == measure->figure.record) return;
    line.points.push_back({_model.trendTime(), measure->figure.number});
}

void LiveOverview::forgetOld() {
    const Trend::Time from = _model.trendTime() - kSpan;
    keepLast(_level.points, from);
    keepLast(_quality.points, from);
    keepLast(_servingCells, from);
}

}  // namespace kelvo::overview
