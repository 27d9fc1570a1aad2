#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "model/Trend.h"
#include "model/TrendSeries.h"
#include "platform/values/Value.h"

namespace kelvo {

/// What the last 30 minutes of refreshes showed: every number's readings, and of texts their changes.
///
/// A trend has a name: the path of its value on the screens, but with what a list's row is about in place of the row's
/// number, so that the trend of a neighbor follows the cell. Names hold as long as the trend is kept; rows change.
///
/// Never more than `kMostBytes`: what has not been written for longest goes first, and what finds no room is not kept.
/// Main queue only. Time is the caller's.
class Trends {
public:
    using Time = Trend::Time;
    static constexpr Time kSpan = std::chrono::minutes(30);
    static constexpr std::size_t kMostBytes = std::size_t{4} * 1024 * 1024;

    /// What the screens show at `now`. Refreshes that follow one another within a second are one.
    void note(const Value& display, Time now);

    /// The name of what the value or row at `path` is about now.
    std::string nameAt(std::string_view path) const;
    /// Where what `name` means stands on the screens now; for a cell that is no longer listed no path of a screen.
    std::string pathOf(std::string_view name) const;

    /// Empty for what is no number, and for what is not kept.
    Trend trend(std::string_view name) const;
    /// The texts that stood there, each with the time from which on, oldest first; what stood there at the beginning is
    /// among them. At most `kMostChanges`.
    std::vector<TrendChange> changes(std::string_view name) const;
    /// When another cell began to serve, and which ("PCI 301").
    std::vector<TrendChange> servingCells() const;
    /// The names of all numbers that are kept, sorted.
    std::vector<std::string> names() const;

    std::size_t bytes() const { return _bytes; }

    static constexpr std::size_t kMostChanges = 64;

private:
    struct Text {
        std::string now;
        std::uint32_t noted = 0;  ///< the refresh at which it was seen last
        std::vector<std::pair<std::uint32_t, std::string>> changes = {};
    };
    struct Mark {
        std::uint32_t refresh;
        std::string text;
        int rank;
    };
    /// Where a list's row stands now, and the name of what it is about.
    struct Row {
        std::string path;
        std::string name;
    };
    struct Hash {
        using is_transparent = void;
        std::size_t operator()(std::string_view text) const { return std::hash<std::string_view>()(text); }
    };
    template <class T>
    using ByName = std::unordered_map<std::string, T, Hash, std::equal_to<>>;
    class Walk;

    template <class T>
    T* find(ByName<T>& all, std::string_view name);
    void noteNumber(std::string_view name, const Reading& reading, std::uint64_t record);
    void noteText(std::string_view name, std::string_view key, const std::string& text, bool isInList);
    void noteServingCell(std::string_view key, const std::string& text, int rank);
    void forgetOld();
    void makeRoom();
    void count();
    Time timeOf(std::uint32_t refresh) const { return _times[refresh - _firstRefresh]; }
    bool isKept(std::uint32_t refresh) const { return refresh >= _firstRefresh; }

    std::deque<Time> _times;          // of the refreshes that are kept
    std::uint32_t _firstRefresh = 0;  // of them
    std::uint32_t _refresh = 0;       // the last one
    ByName<TrendSeries> _numbers;
    ByName<Text> _texts;
    std::deque<Mark> _servingCells;
    ByName<std::string> _serving;  // what each kind of name of the serving cell was last: "PCI" and so on
    std::vector<Row> _rows;
    std::size_t _bytes = 0;
    std::uint64_t _newestRecord = 0;        // of all readings
    std::uint64_t _newestRecordBefore = 0;  // at the refresh before
};

}  // namespace kelvo
