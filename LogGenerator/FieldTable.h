#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

#include "LogGenerator/FieldChecks.h"
#include "LogGenerator/LogCode.h"
#include "LogGenerator/RecordView.h"
#include "LogGenerator/Shown.h"
#include "platform/values/Key.h"

/// The words in which record layouts are written, one field a line: where it lies, how it is stored (`RecordView.h`),
/// the display key, how it is shown (`Shown.h`). What cannot be right does not compile (`FieldChecks.h`).
namespace kelvo {

/// One line of a layout.
struct Field {
    std::uint16_t at;
    Raw raw;
    Place place;  ///< the same, as readings carry it
    Key key;
    Shown shown;

    constexpr Field(int offset, Raw how, Key displayKey, Shown text)
        : at(static_cast<std::uint16_t>(offset)),
          raw(how),
          place(how.placeAt(static_cast<std::size_t>(offset))),
          key(displayKey),
          shown(text) {
        check::field(how, text);
    }
};

/// A record of the kind `code`, at least `size` bytes long; offsets count from the log type byte.
template <std::size_t N>
struct RecordLayout {
    LogCode code;
    std::size_t size;
    std::array<Field, N> fields;
};

/// An entry of `size` bytes in a record's list; offsets count from the entry.
template <std::size_t N>
struct EntryLayout {
    std::size_t size;
    std::array<Field, N> fields;

    /// Entries that follow one another without gaps.
    constexpr RecordEntries entries(std::size_t start, std::size_t count) const { return {start, size, count}; }
};

template <std::size_t N>
consteval RecordLayout<N> record(const KnownCode& code, std::size_t minimum, const Field (&fields)[N]) {
    check::fields(minimum, fields);
    return {code, minimum, std::to_array(fields)};
}

template <std::size_t N>
consteval EntryLayout<N> entry(std::size_t size, const Field (&fields)[N]) {
    check::fields(size, fields);
    return {size, std::to_array(fields)};
}

}  // namespace kelvo
