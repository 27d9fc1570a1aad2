#pragma once

#include <cstddef>
#include <cstdint>

#include "LogGenerator/Shown.h"
#include "platform/values/Dictionary.h"

namespace kelvo {

/// A pilot's level with its sign, as every list shows it.
inline constexpr ShownReal kC2KPilotLevel("%+.2f", dB);

/// A list of pilots as a screen of its own: a dictionary in key order whose keys are "position;PN", so that rows stand
/// in the order of their position's digits and show the PN offset as their label.
class C2KPilotList {
public:
    /// An empty list with room for `pilots` rows.
    explicit C2KPilotList(std::size_t pilots);

    /// Adds the pilot at `position` (from 0) of the record; `level` is in dB and may be infinite, `shown` static data.
    void add(std::size_t position, std::int64_t pn, double level, const ShownReal& shown = kC2KPilotLevel);
    void add(std::size_t position, std::int64_t pn, double level, const ShownReal&& shown) = delete;
    const DictionaryRef& rows() const { return _rows; }
    /// The rows, or the text "(none)" when there are none.
    Value rowsOrNone() const;

private:
    DictionaryRef _rows = Dictionary::make({{"_sorted", "_sorted"}});
};

}  // namespace kelvo
