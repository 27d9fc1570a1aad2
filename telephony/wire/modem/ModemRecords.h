#pragma once

#include <chrono>
#include <optional>

#include "platform/values/Bytes.h"

namespace kelvo::modem {

/// One record of a played modem.
struct ModemRecord {
    std::chrono::nanoseconds at;  ///< since the first; never before the record before
    ByteView bytes;               ///< from its length on, as in a DLF file; borrowed until the next is asked for
};

/// The records of a played modem, in their order.
class ModemRecords {
public:
    virtual ~ModemRecords() = default;
    /// None after the last.
    virtual std::optional<ModemRecord> next() = 0;
};

}  // namespace kelvo::modem
