#include "model/Trends.h"

#include <algorithm>
#include <optional>

#include "LogGenerator/ArrayLock.h"
#include "model/CellIdentity.h"
#include "model/DisplayPath.h"
#include "model/KelvoModelNode.h"

namespace kelvo {

using namespace std::chrono_literals;

namespace {

constexpr auto kShortestRefresh = 1s;
constexpr std::size_t kMostSeries = 4096;
constexpr std::size_t kLongestName = 256;
constexpr std::size_t kLongestText = 64;
constexpr std::size_t kMostMarks = 256;
constexpr std::uint32_t kLateForgetting = 64;                 // refreshes; forgetting costs more than keeping
constexpr std::size_t kOneRefresh = std::size_t{512} * 1024;  // what one refresh may add before there is made room
constexpr std::size_t kNode = 64;                             // what a map has for each of its entries beside it

constexpr std::string_view kNothingYet = "–";  // of the display templates

/// The cell's several names change one after the other.
constexpr auto kOneChange = 6s;

std::size_t outside(const std::string& text) {
    constexpr std::size_t kInPlace = 15;
    return text.capacity() > kInPlace ? text.capacity() + 1 : 0;
}

std::string cut(const std::string& text) { return text.substr(0, kLongestText); }

}  // namespace

/// One walk over a display.
class Trends::Walk {
public:
    Walk(Trends& trends, const Value& display) : _trends(trends), _display(display) {}

    void start() { visit("Kelvo", _display); }

private:
    void visit(std::string_view key, const Value& value) {
        if (_name.size() > kLongestName) return;
        if (value.dictionary() || value.array()) {
            if (_depth == KelvoModelNode::kMaxDepth) return;
            ++_depth;
            value.array() ? visitArray(*value.array()) : visitDictionary(*value.dictionary());
            --_depth;
        } else {
            visitLeaf(key, value);
        }
    }

    void visitLeaf(std::string_view key, const Value& value) {
        const Reading* reading = value.reading();
        const bool isName = shortNameOf(key) != nullptr;
        if (reading != nullptr && !isName && !namesAnArea(key) && reading->quantity->measure(reading->raw)) {
            return _trends.noteNumber(_name, *reading, value.record());
        }
        if (isName && _openArrays > 0) return;  // is the row's name
        if (const std::string* text = value.string()) _trends.noteText(_name, key, *text, _openArrays > 0);
    }

    void visitDictionary(const Dictionary& dictionary) {
        const bool isSorted = dictionary.find("_sorted") != nullptr;
        for (const auto& [key, value] : dictionary) {
            if (key == "_sorted" || !value) continue;
            const std::string_view shown = isSorted ? nameOfSortedKey(key) : std::string_view(key);
            visitBelow(shown, shown, value);
        }
    }

    void visitArray(const Array& array) {
        std::optional<ArrayLock::Held> lock;
        if (_openArrays++ == 0) lock.emplace();
        const std::string channel = channelOfList(_display, _path);
        std::size_t index = 0;
        for (const Value& element : array) visitRow(std::to_string(index++), channel, element);
        --_openArrays;
    }

    void visitRow(const std::string& number, const std::string& channel, const Value& row) {
        std::string identity = row.dictionary() ? identityOf(*row.dictionary()) : std::string();
        if (identity.empty()) return visitBelow(number, number, row);
        if (!channel.empty()) identity += ", " + channel;
        const bool hasRoom = _trends._rows.size() < kMostSeries && identity.size() <= kLongestName;
        if (hasRoom) _trends._rows.push_back({pathByAppending(_path, number), pathByAppending(_name, identity)});
        visitBelow(number, hasRoom ? identity : number, row);
    }

    void visitBelow(std::string_view key, std::string_view name, const Value& value) {
        const std::size_t path = _path.size();
        const std::size_t names = _name.size();
        appendToPath(_path, key);
        appendToPath(_name, name);
        visit(key, value);
        _path.resize(path);
        _name.resize(names);
    }

    Trends& _trends;
    const Value& _display;
    std::string _path = "/";
    std::string _name = "/";
    int _depth = 0;
    int _openArrays = 0;
};

void Trends::note(const Value& display, Time now) {
    if (!_times.empty() && now - _times.back() < kShortestRefresh) return;
    if (!_times.empty()) ++_refresh;
    _times.push_back(now);
    forgetOld();
    count();
    makeRoom();
    _rows.clear();
    _newestRecordBefore = _newestRecord;
    Walk(*this, display).start();
    count();
}

/// The entry of that name, made when there is room for it; else null.
template <class T>
T* Trends::find(ByName<T>& all, std::string_view name) {
    const auto at = all.find(name);
    if (at != all.end()) return &at->second;
    const std::size_t needed = kNode + sizeof(std::string) + name.size() + sizeof(T) + kLongestText + 128;
    const bool isFull = _numbers.size() + _texts.size() >= kMostSeries || _bytes + needed > kMostBytes - kOneRefresh;
    if (isFull || name.size() > kLongestName) return nullptr;
    _bytes += needed;
    return &all.emplace(std::string(name), T()).first->second;
}

void Trends::noteNumber(std::string_view name, const Reading& reading, std::uint64_t record) {
    _newestRecord = std::max(_newestRecord, record);
    // A value that nobody writes any more stays on its screen: that is no new reading, and begins no trend.
    const bool isOld = record != 0 && record <= _newestRecordBefore;
    if (isOld && !_numbers.contains(name)) return;
    if (TrendSeries* series = find(_numbers, name)) series->note(_refresh, reading, record);
}

void Trends::noteText(std::string_view name, std::string_view key, const std::string& text, bool isInList) {
    if (text == kNothingYet) return;
    const std::string shown = cut(text);
    Text* known = find(_texts, name);
    if (known == nullptr) return;
    known->noted = _refresh;
    if (known->now == shown) return;
    constexpr std::size_t kChange = sizeof(Text::changes[0]) + kLongestText + 1;
    const bool hasRoom = _bytes + kChange <= kMostBytes - kOneRefresh / 2;
    if (known->changes.size() == kMostChanges || !hasRoom) known->changes.clear();
    if (known->changes.size() == known->changes.capacity()) known->changes.reserve(known->changes.size() + 4);
    known->changes.emplace_back(_refresh, shown);
    _bytes += kChange;
    known->now = shown;
    const int rank = isInList ? 0 : rankAsServingCell(key);
    if (rank > 0) noteServingCell(key, shown, rank);
}

// Several sections show the serving cell, and one that no record writes goes on showing the one before: what counts is
// what has changed. Another name of the same cell, a moment later, is the same change; people know a cell by its code.
void Trends::noteServingCell(std::string_view key, const std::string& text, int rank) {
    const std::string& kind = *shortNameOf(key);
    const std::string name = kind + ' ' + text;
    std::string& last = _serving[kind];
    const bool isFirst = last.empty();
    if (last == name) return;
    last = name;
    if (isFirst) return;
    const bool joins = !_servingCells.empty() && isKept(_servingCells.back().refresh) &&
                       timeOf(_refresh) - timeOf(_servingCells.back().refresh) <= kOneChange &&
                       rank != _servingCells.back().rank;
    if (!joins) {
        if (_servingCells.size() == kMostMarks) _servingCells.pop_front();
        _servingCells.push_back({_refresh, name, rank});
    } else if (rank < _servingCells.back().rank) {
        _servingCells.back().text = name;
        _servingCells.back().rank = rank;
    }
}

void Trends::forgetOld() {
    while (_times.back() - _times.front() > kSpan) {
        _times.pop_front();
        ++_firstRefresh;
    }
    while (!_servingCells.empty() && !isKept(_servingCells.front().refresh)) _servingCells.pop_front();
    std::erase_if(_numbers, [this](const auto& entry) { return !isKept(entry.second.end() - 1); });
    for (auto& [name, series] : _numbers) {
        if (series.begin() + kLateForgetting < _firstRefresh) series.forgetBefore(_firstRefresh);
    }
    std::erase_if(_texts, [this](const auto& entry) { return !isKept(entry.second.noted); });
}

/// What was written least recently goes, until a quarter is free.
void Trends::makeRoom() {
    if (_bytes <= kMostBytes - kOneRefresh) return;
    std::vector<std::uint32_t> ends;
    for (const auto& [name, series] : _numbers) ends.push_back(series.end());
    for (const auto& [name, text] : _texts) ends.push_back(text.changes.empty() ? 0 : text.changes.back().first);
    if (ends.empty()) return;
    const auto quarter = ends.begin() + static_cast<std::ptrdiff_t>(ends.size() / 4);
    std::nth_element(ends.begin(), quarter, ends.end());
    // Many may have been written last at the same refresh: of these no more go than have to.
    std::size_t left = ends.size() / 4 + 1;
    const std::uint32_t oldest = *quarter;
    const auto isOld = [&](std::uint32_t end) { return end <= oldest && left > 0 && left-- > 0; };
    std::erase_if(_numbers, [&](const auto& entry) { return isOld(entry.second.end()); });
    std::erase_if(_texts, [&](const auto& entry) {
        return isOld(entry.second.changes.empty() ? 0 : entry.second.changes.back().first);
    });
    count();
    makeRoom();
}

void Trends::count() {
    _bytes = _times.size() * sizeof(Time) + _servingCells.size() * (sizeof(Mark) + kLongestText) +
             (_numbers.bucket_count() + _texts.bucket_count()) * sizeof(void*);
    for (const auto& [name, series] : _numbers) _bytes += kNode + sizeof name + outside(name) + series.bytes();
    for (const auto& [name, text] : _texts) {
        _bytes += kNode + sizeof name + outside(name) + sizeof text + outside(text.now) +
                  text.changes.capacity() * sizeof(text.changes[0]);
        for (const auto& [refresh, change] : text.changes) _bytes += outside(change);
    }
    for (const Row& row : _rows) _bytes += sizeof row + outside(row.path) + outside(row.name);
}

namespace {

/// `path` with what stands in it as `from` at its beginning replaced by `to`; none when it begins otherwise.
std::optional<std::string> replaced(std::string_view path, std::string_view from, std::string_view to) {
    if (!path.starts_with(from)) return std::nullopt;
    const std::string_view rest = path.substr(from.size());
    if (!rest.empty() && rest.front() != '/') return std::nullopt;
    return std::string(to) + std::string(rest);
}

}  // namespace

std::string Trends::nameAt(std::string_view path) const {
    for (auto row = _rows.rbegin(); row != _rows.rend(); ++row) {  // inner rows are behind their outer ones
        if (auto name = replaced(path, row->path, row->name)) return *std::move(name);
    }
    return std::string(path);
}

std::string Trends::pathOf(std::string_view name) const {
    for (auto row = _rows.rbegin(); row != _rows.rend(); ++row) {
        if (auto path = replaced(name, row->name, row->path)) return *std::move(path);
    }
    return std::string(name);
}

Trend Trends::trend(std::string_view name) const {
    const auto at = _numbers.find(name);
    Trend trend;
    if (at == _numbers.end()) return trend;
    for (const TrendSeries::Sample& sample : at->second.samples()) {
        const auto measured = sample.quantity->measure(sample.raw);
        if (!measured || !isKept(sample.refresh)) continue;
        if (measured->unit != trend.unit) trend.points.clear();  // what was before is not to be compared
        trend.unit = measured->unit;
        trend.points.push_back({timeOf(sample.refresh), measured->number, sample.raw, sample.quantity});
    }
    return trend;
}

std::vector<TrendChange> Trends::changes(std::string_view name) const {
    const auto at = _texts.find(name);
    std::vector<TrendChange> changes;
    if (at == _texts.end()) return changes;
    for (const auto& [refresh, text] : at->second.changes) {
        if (!isKept(refresh)) changes.clear();  // the last of them still stood there at the beginning
        changes.push_back({isKept(refresh) ? timeOf(refresh) : _times.front(), text});
    }
    return changes;
}

std::vector<TrendChange> Trends::servingCells() const {
    std::vector<TrendChange> changes;
    for (const Mark& mark : _servingCells) changes.push_back({timeOf(mark.refresh), mark.text});
    return changes;
}

std::vector<std::string> Trends::names() const {
    std::vector<std::string> names;
    names.reserve(_numbers.size());
    for (const auto& [name, series] : _numbers) names.push_back(name);
    std::sort(names.begin(), names.end());
    return names;
}

}  // namespace kelvo
