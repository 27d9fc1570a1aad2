#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

#include "platform/system/SteadyTime.h"

namespace kelvo {

/// A line on the terminal that says how far a command has come, from its second second on, five times a second. Gone
/// with the object.
class Progress {
public:
    /// `draw` brings text to the terminal; none: there is no terminal, and nothing is drawn.
    Progress(std::function<void(std::string_view)> draw, SteadyTime now);
    ~Progress();
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;

    /// Cheap enough to be called at every record. `portion` is asked only when something is drawn: from 0 to 1, or
    /// none.
    template <class Portion>
    void at(std::uint64_t records, Portion portion) {
        if (_draw && records % kLookEvery == 0 && isDue()) show(records, portion());
    }
    /// Takes the line away, for something else to be told.
    void clear();

private:
    static constexpr std::uint64_t kLookEvery = 256;

    bool isDue();
    void show(std::uint64_t records, std::optional<double> portion);

    std::function<void(std::string_view)> _draw;
    SteadyTime _now;
    std::chrono::nanoseconds _due;
    bool _isShown = false;
};

/// That of a command that reads and writes rows: on standard error where that is a terminal, unless the rows go to a
/// terminal themselves.
std::function<void(std::string_view)> progressOnTerminal(bool rowsGoToStandardOutput);

}  // namespace kelvo
