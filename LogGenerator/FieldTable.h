#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "LogGenerator/NumberFormat.h"
#include "LogGenerator/RecordView.h"
#include "platform/values/Dictionary.h"
#include "platform/values/Key.h"

/// The words in which record layouts are written, one field a line: where it lies, how it is stored, the display key,
/// how it is shown. What cannot be right does not compile: a field past the record's minimum length, a key twice, 32
/// bits without a word on their sign, a format that these tables do not print.
///
/// A record leaves raw values on the display, each with the table line that prints it when the display is read: tables
/// are static data.
namespace kelvo {

/// One row of a value table.
struct ValueRow {
    std::uint32_t raw;
    std::string_view text;
};

/// Names for raw values; any other value shows the fallback, which may hold a "%d" for the value.
template <std::size_t N>
struct ValueTable {
    std::array<ValueRow, N> rows;
    NumberFormat fallback;

    consteval ValueTable(const ValueRow (&list)[N], const char* fallbackFormat)
        : rows(std::to_array(list)), fallback(fallbackFormat) {}
};

/// How a raw value becomes the text on the screen.
struct Shown {
    enum class How : std::uint8_t { Nothing, Decimal, Signed32, Unsigned, Label, Linear, Eighths, Whole };

    How how = How::Nothing;
    NumberFormat format{};
    double scale = 1.0;
    double offset = 0.0;
    std::int64_t factor = 1;
    std::int64_t summand = 0;
    std::span<const ValueRow> rows{};
    std::int64_t exception = std::numeric_limits<std::int64_t>::min();
    std::string_view exceptionText{};
    bool exceptionIsAbsent = false;

    /// Shows `text` when the raw value equals `raw`.
    constexpr Shown unless(std::int64_t raw, std::string_view text) const {
        Shown changed = *this;
        changed.exception = raw;
        changed.exceptionText = text;
        return changed;
    }
    /// Leaves the key out when the raw value equals `raw`.
    constexpr Shown absentAt(std::int64_t raw) const {
        Shown changed = unless(raw, {});
        changed.exceptionIsAbsent = true;
        return changed;
    }
    constexpr bool leavesOut(std::int64_t raw) const {
        return how == How::Nothing || (exceptionIsAbsent && raw == exception);
    }

    /// Whether the text shows a real number: raw x scale + offset.
    constexpr bool isReal() const { return how == How::Linear || how == How::Eighths; }
    constexpr double real(std::int64_t raw) const { return static_cast<double>(raw) * scale + offset; }
};

/// "%d"; for 32 unsigned bits say `asSigned` or `asUnsigned`.
inline constexpr Shown decimal{.how = Shown::How::Decimal, .format = "%d"};
/// Unsigned 32 bits printed as a signed number.
inline constexpr Shown asSigned{.how = Shown::How::Signed32, .format = "%d"};
/// Printed as an unsigned number.
inline constexpr Shown asUnsigned{.how = Shown::How::Unsigned, .format = "%u"};

/// Printed in base 16, as the format's "%x" says.
constexpr Shown hexadecimal(const char* format) { return {.how = Shown::How::Unsigned, .format = format}; }

/// The value's name.
template <std::size_t N>
constexpr Shown label(const ValueTable<N>& table) {
    return {.how = Shown::How::Label, .format = table.fallback, .rows = table.rows};
}

/// One text for zero and another for everything else.
constexpr Shown flag(const char* nonZero, std::string_view zero) {
    return Shown{.how = Shown::How::Label, .format = nonZero}.unless(0, zero);
}

/// raw x factor + summand, in whole numbers.
constexpr Shown whole(std::int64_t factor, std::int64_t summand, const char* format) {
    return {.how = Shown::How::Whole, .format = format, .factor = factor, .summand = summand};
}

/// raw x scale + offset, in double precision.
constexpr Shown linear(double scale, double offset, const char* format) {
    Shown shown{.how = Shown::How::Linear, .format = format, .scale = scale, .offset = offset};
    const auto factor = static_cast<int>(scale * 8);
    const auto summand = static_cast<int>(offset * 8);
    // Steps of an eighth, the common case, print exactly from whole numbers.
    if (factor == scale * 8 && summand == offset * 8 && shown.format.precision >= 2) {
        shown.how = Shown::How::Eighths;
        shown.factor = factor;
        shown.summand = summand;
    }
    return shown;
}

/// One line of a layout.
struct Field {
    std::uint16_t at;
    Raw raw;
    Key key;
    Shown shown;

    constexpr Field(int offset, Raw how, Key displayKey, Shown text)
        : at(static_cast<std::uint16_t>(offset)), raw(how), key(displayKey), shown(text) {
        if (how.lowBit + how.bitWidth() > how.bytes * 8) throw "the bits lie beyond the number";
        if (how.bitWidth() == 32 && !how.isSigned && text.how == Shown::How::Decimal) {
            throw "32 bits need a word on their sign";
        }
    }
};

/// A line that takes a key off the screen.
constexpr Field removed(Key key) { return {0, u8, key, Shown{}}; }

/// A layout: at least `size` bytes for a record, `size` bytes each for the entries of a list.
template <std::size_t N>
struct Layout {
    std::size_t size;
    std::array<Field, N> fields;
};

namespace detail {
template <std::size_t N>
consteval Layout<N> checkedLayout(std::size_t size, const Field (&fields)[N]) {
    for (std::size_t i = 0; i < N; ++i) {
        if (fields[i].at + fields[i].raw.bytes > size) throw "a field lies past the end";
        for (std::size_t j = 0; j < i; ++j) {
            if (fields[i].key == fields[j].key) throw "a key stands twice";
        }
    }
    return {size, std::to_array(fields)};
}
}  // namespace detail

/// A record of at least `minimum` bytes; offsets count from the log type byte.
template <std::size_t N>
consteval Layout<N> record(std::size_t minimum, const Field (&fields)[N]) {
    return detail::checkedLayout(minimum, fields);
}

/// An entry of `size` bytes in a list; offsets count from the entry.
template <std::size_t N>
consteval Layout<N> entry(std::size_t size, const Field (&fields)[N]) {
    return detail::checkedLayout(size, fields);
}

/// Writes `raw` to `text` in the way `shown` says.
void print(std::string& text, std::int64_t raw, const Shown& shown);
/// The same in another format.
void print(std::string& text, std::int64_t raw, const Shown& shown, const NumberFormat& format);
/// Writes a real number to `text`; infinities and not-a-number as printf writes them.
void print(std::string& text, double value, const NumberFormat& format);

/// Makes `value` the text that `print` writes, once somebody reads it. `shown` is part of a table: static data.
void showValue(Value& value, std::int64_t raw, const Shown& shown);
void showValue(Value& value, std::int64_t raw, Shown&& shown) = delete;

/// Makes `value` the text of a real number, once somebody reads it. `format` is static data.
void showReal(Value& value, double number, const NumberFormat& format);
void showReal(Value& value, double number, NumberFormat&& format) = delete;

/// Shows fields in their order; `base` is the offset from which theirs count. Keys that stand already keep their place.
void showFields(Dictionary& shown, RecordView record, std::size_t base, std::span<const Field> fields);
/// Shows fields as the next entries of a row.
void showFields(Dictionary::Rewrite& row, RecordView record, std::size_t base, std::span<const Field> fields);

/// Makes `values` hold one text for each entry, as `raw` lies at the entry's start.
void showValues(const ArrayRef& values, RecordView record, const RecordEntries& entries, Raw raw, const Shown& shown);

/// Makes `list` hold one row for each entry, in record order. Entries that lie wholly beyond the record's end are not
/// made up. A null list is ignored.
void showRows(const ArrayRef& list, ByteView data, const RecordEntries& entries, std::span<const Field> fields);

/// The same, for entries that follow one another without gaps from `start` on.
template <std::size_t N>
void showRows(const ArrayRef& list, ByteView data, std::size_t start, std::size_t count, const Layout<N>& layout) {
    showRows(list, data, RecordEntries(start, layout.size, count), layout.fields);
}

}  // namespace kelvo
