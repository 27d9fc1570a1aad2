#pragma once

#include <bitset>
#include <cstdint>

#include "LogGenerator/LogCode.h"
#include "platform/values/Bytes.h"

namespace kelvo::wire {

/// A set of record codes: 8 KiB.
using RecordCodes = std::bitset<65536>;

inline constexpr std::uint32_t kEquipmentIds = 16;
inline constexpr std::uint32_t kMostItems = 4096;  ///< of one equipment: an item is the lower 12 bits of a code

/// Which records of one equipment are asked for: item i of it is bit i mod 8, from bit 0, of byte i / 8.
class LogMask {
public:
    /// A mask without any record, for an equipment of so many items (at most kMostItems).
    LogMask(std::uint32_t equipment, std::uint32_t items);
    /// The mask whose bytes are `bits`; bytes that are missing are zero.
    LogMask(std::uint32_t equipment, std::uint32_t items, ByteView bits);

    std::uint32_t equipment() const { return _equipment; }
    std::uint32_t items() const { return _items; }
    ByteView bits() const { return _bits; }

    /// Whether the record code is one of this equipment's, and has a place in the mask.
    bool holds(LogCode code) const { return code >> 12 == _equipment && (code & 0xFFF) < _items; }
    void set(LogCode code);
    bool test(LogCode code) const;

    bool operator==(const LogMask&) const = default;

private:
    std::uint32_t _equipment;
    std::uint32_t _items;
    Bytes _bits;
};

}  // namespace kelvo::wire
