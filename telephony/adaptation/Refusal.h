#pragma once

#include <compare>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

#include "LogGenerator/LogCode.h"

namespace kelvo::adaptation {

/// Why a record is not handed on.
enum class Refusal : std::uint8_t {
    NotKnown,          ///< no layout of this version and length is known
    TooShort,          ///< shorter than the code's layout
    NotOurs,           ///< no screen shows this code
    SecondaryCell,     ///< a measurement of another carrier than the primary cell's
    NoServingCell,     ///< none of its cells is the primary serving cell
    NoNeighbors,       ///< the fixed layout says at least one
    TooManyNeighbors,  ///< the fixed layout says at most 32
    NoNetwork,         ///< the first network has digits that are none
    LyingSubpackets,   ///< CDMA: a sub-packet that is shorter than what is read, or lies beyond the record
    DoesNotFit,        ///< an identity that the fixed field cannot say
};

/// In words, as behind "0xB193 version 1, part 25 version 59, 524 bytes: ".
const char* reasonOf(Refusal refusal);

/// What a record is, as far as a refusal names it.
struct RecordKind {
    LogCode code = 0;
    std::optional<std::uint8_t> version;      ///< its version, for codes that have one
    std::optional<std::uint8_t> partVersion;  ///< of 0xB193's part 25
    std::size_t bytes = 0;                    ///< of the payload, or of the part with its four bytes of header

    // NOLINTNEXTLINE(modernize-use-nullptr): clang-tidy 14 finds a 0 in what the compiler writes here
    auto operator<=>(const RecordKind&) const = default;
};

/// "0xB193 version 1, part 25 version 59, 524 bytes".
std::string describe(const RecordKind& kind);

}  // namespace kelvo::adaptation
