#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>

#include "LogGenerator/RecordLedger.h"
#include "platform/system/Clock.h"
#include "platform/values/Bytes.h"
#include "platform/values/Reading.h"

namespace kelvo {

/// Where a shown value comes from, and how old it is.
struct Provenance {
    std::uint64_t record = 0;             ///< the number of the record in the stream; 1 is the first
    std::optional<LogCode> code;          ///< none for a cell monitor's tree
    std::optional<SystemTime> modemTime;  ///< the record's own time; none while the modem's clock is not set
    std::chrono::nanoseconds arrival{0};  ///< when it came, in the clock that told the arrivals
    std::chrono::microseconds stream{0};  ///< when that was in the stream's time
    std::chrono::microseconds age{0};     ///< since then, in the stream's time; goes on while no records come
    Place place;                          ///< of the field that holds the value; false when no single field does
    ByteView bytes;  ///< the record, from the log type byte on; empty when a later one of its code has shown something
};

/// What is known of the record with that number; `place` is none. None for 0, and for a record that no value on the
/// screens comes from any more. `bytes` hold until the next record.
std::optional<Provenance> provenanceOf(std::uint64_t record, const RecordLedger& ledger, std::chrono::nanoseconds now);

/// The record's kind in words: "0xb17f  LTE serving cell, idle"; empty without a code.
std::string describe(const Provenance& provenance);

}  // namespace kelvo
