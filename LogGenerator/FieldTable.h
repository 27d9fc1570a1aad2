#pragma once

#include <array>
#include <cstddef>
#include <cstdint>

#include "LogGenerator/FieldChecks.h"
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
    Key key;
    Shown shown;

    constexpr Field(int offset, Raw how, Key displayKey, Shown text)
        : at(static_cast<std::uint16_t>(offset)), raw(how), key(displayKey), shown(text) {
        check::field(how, text);
    }
};

/// A layout: at least `size` bytes for a record, `size` bytes each for the entries of a list.
template <std::size_t N>
struct Layout {
    std::size_t size;
    std::array<Field, N> fields;
};

/// A record of at least `minimum` bytes; offsets count from the log type byte.
template <std::size_t N>
consteval Layout<N> record(std::size_t minimum, const Field (&fields)[N]) {
    check::fields(minimum, fields);
    return {minimum, std::to_array(fields)};
}

/// An entry of `size` bytes in a list; offsets count from the entry.
template <std::size_t N>
consteval Layout<N> entry(std::size_t size, const Field (&fields)[N]) {
    check::fields(size, fields);
    return {size, std::to_array(fields)};
}

}  // namespace kelvo
