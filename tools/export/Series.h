#pragma once

#include <cstdint>
#include <string>

#include "platform/telephony/Technology.h"
#include "platform/values/Value.h"

namespace kelvo {

/// Everything that an export tells under one path of one technology.
struct Series {
    static constexpr std::size_t kNotHeld = static_cast<std::size_t>(-1);

    Technology technology{};
    std::string path{};  ///< "/Neighbor Cells List/PCI 301, EARFCN 1300/Measured RSRP"
    bool isWanted = true;

    std::string rendered{};         ///< the output's own: path and technology as it writes them; empty until it has
    std::int64_t id = -1;           ///< likewise: a column, a row of a table; -1 until it has one
    Value last{};                   ///< told last, where only changes are told
    std::size_t heldAt = kNotHeld;  ///< where the reading waits for the end of its interval
};

/// One reading: what a record has written.
struct Written {
    Series* series;
    const Value* value;  ///< a text
};

}  // namespace kelvo
