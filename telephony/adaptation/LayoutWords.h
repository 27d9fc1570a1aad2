#pragma once

#include <algorithm>
#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <limits>
#include <string_view>

#include "LogGenerator/RecordView.h"

/// The words in which newer layouts of a record are turned into the fixed one. A fixed layout is a list of named
/// fields; a newer one says for each of those names where the value lies in it, in which steps, or what stands there
/// because it is not to be had. A fixed field that the newer layout forgets, names twice or does not know does not
/// compile.
///
/// Offsets count from the start of the payload (or of the list entry); numbers are little-endian.
namespace kelvo::adaptation {

/// What one step of a raw number is worth: raw x numerator / denominator + offset, in the field's unit.
struct Steps {
    int numerator = 0;  ///< 0: an identity or a plain number, which is never rounded
    int denominator = 1;
    int offset = 0;
};

constexpr Steps steps(int numerator, int denominator, int offset) { return {numerator, denominator, offset}; }

/// A field of the fixed layout.
struct FixedField {
    std::string_view name;
    std::uint16_t at;
    Raw raw;
    Steps steps{};

    constexpr FixedField(std::string_view fieldName, int offset, Raw how, Steps worth = {})
        : name(fieldName), at(static_cast<std::uint16_t>(offset)), raw(how), steps(worth) {}

    constexpr int firstBit() const { return 8 * at + raw.lowBit; }
    constexpr int lastBit() const { return firstBit() + raw.width - 1; }
};

/// What happens to a raw value on its way.
enum class Turn : std::uint8_t {
    Copied,    ///< as it stands; one that does not fit the fixed field makes the record refused
    Cut,       ///< as it stands, at most the fixed field's greatest value
    Stepped,   ///< the nearest step of the fixed field, ties up, within the field's range
    Channel,   ///< a 32-bit EARFCN: above 65,535 it becomes 65535, "said elsewhere" (3GPP TS 36.331, maxEARFCN)
    Search,    ///< a search threshold in 2 dB: 63 (none) becomes 32, and 32, which would read as none, 33
    Constant,  ///< not in the newer layout
};

/// A field of the fixed layout as a newer one has it.
struct NewerField {
    std::string_view name;
    std::uint16_t at = 0;
    Raw raw = u8;
    Steps steps{};
    Turn turn = Turn::Copied;
    std::int64_t constant = 0;

    /// Copied as it stands.
    constexpr NewerField(std::string_view fieldName, int offset, Raw how)
        : name(fieldName), at(static_cast<std::uint16_t>(offset)), raw(how) {}
    /// Turned into the fixed field's steps.
    constexpr NewerField(std::string_view fieldName, int offset, Raw how, Steps worth)
        : name(fieldName), at(static_cast<std::uint16_t>(offset)), raw(how), steps(worth), turn(Turn::Stepped) {}
    constexpr NewerField(std::string_view fieldName, int offset, Raw how, Turn what)
        : name(fieldName), at(static_cast<std::uint16_t>(offset)), raw(how), turn(what) {}
    constexpr NewerField(std::string_view fieldName, std::int64_t value)
        : name(fieldName), turn(Turn::Constant), constant(value) {}
};

/// Not in the newer layout: the fixed field holds `value`, a raw number.
constexpr NewerField notToBeHad(std::string_view name, std::int64_t value) { return {name, value}; }
/// The version that adapted records carry.
constexpr NewerField always(std::string_view name, std::int64_t value) { return {name, value}; }

/// One value's way from a newer record to the fixed one: raw x factor + summand, divided by a power of two and rounded
/// down.
struct Move {
    std::uint16_t from;
    Raw fromRaw;
    std::uint16_t to;
    Raw toRaw;
    Turn turn;
    std::uint8_t shift = 0;
    std::int64_t factor = 1;
    std::int64_t summand = 0;  ///< of a constant: its value

    constexpr std::int64_t greatest() const { return (std::int64_t{1} << toRaw.width) - 1; }
};

template <std::size_t N>
struct FixedLayout {
    std::size_t size;
    std::array<FixedField, N> fields;

    /// The field called `name`.
    consteval FixedField field(std::string_view name) const {
        for (const FixedField& field : fields) {
            if (field.name == name) return field;
        }
        throw "the fixed layout has no field of this name";
    }
};

/// A newer layout of `size` bytes, as the moves that turn it.
template <std::size_t N>
struct NewerLayout {
    std::size_t size;
    std::array<Move, N> moves;

    /// Where the last of what is read ends.
    consteval std::size_t reach() const {
        std::size_t reach = 0;
        for (const Move& move : moves) {
            if (move.turn != Turn::Constant) reach = std::max<std::size_t>(reach, move.from + move.fromRaw.bytes);
        }
        return reach;
    }
};

/// `size` bytes: those of the record before its lists, or of a list's entry.
template <std::size_t N>
consteval FixedLayout<N> fixedLayout(std::size_t size, const FixedField (&fields)[N]) {
    for (std::size_t i = 0; i < N; ++i) {
        if (fields[i].at + fields[i].raw.bytes > size) throw "a field lies past the end";
        if (fields[i].raw.bytes == 3 || fields[i].raw.isBigEndian) throw "a field is no little-endian number";
        for (std::size_t j = 0; j < i; ++j) {
            if (fields[i].name == fields[j].name) throw "a name stands twice";
            if (fields[i].firstBit() <= fields[j].lastBit() && fields[j].firstBit() <= fields[i].lastBit())
                throw "two fields share a bit";
        }
    }
    return {size, std::to_array(fields)};
}

namespace detail {

consteval Move move(const FixedField& to, const NewerField& from) {
    Move move{from.at, from.raw, to.at, to.raw, from.turn};
    if (from.turn == Turn::Constant) {
        if (from.constant < 0 || from.constant > move.greatest()) throw "a constant does not fit its field";
        move.summand = from.constant;
    }
    const bool isRounded = from.turn == Turn::Stepped || from.turn == Turn::Constant;
    if (to.steps.numerator != 0 && !isRounded) throw "the newer field has no steps";
    if (from.turn == Turn::Stepped) {
        if (to.steps.numerator == 0) throw "the fixed field has no steps";
        // Half a step more and rounded down is the nearest step, ties up.
        move.factor = std::int64_t{2} * from.steps.numerator * to.steps.denominator;
        const std::int64_t divisor = std::int64_t{2} * from.steps.denominator * to.steps.numerator;
        move.summand =
            std::int64_t{2} * (from.steps.offset - to.steps.offset) * from.steps.denominator * to.steps.denominator +
            divisor / 2;
        if (!std::has_single_bit(static_cast<std::uint64_t>(divisor))) throw "the steps are no power of two apart";
        move.shift = static_cast<std::uint8_t>(std::countr_zero(static_cast<std::uint64_t>(divisor)));
    }
    return move;
}

}  // namespace detail

/// A newer layout of the same record: every field of `fixed`, by its name, in any order.
template <std::size_t N, std::size_t M>
consteval NewerLayout<N> newerLayout(const FixedLayout<N>& fixed, std::size_t size, const NewerField (&fields)[M]) {
    NewerLayout<N> layout{size, {}};
    if (M != N) throw "a newer layout names each field of the fixed one once";
    for (std::size_t i = 0; i < N; ++i) {
        std::size_t found = 0;
        for (const NewerField& field : fields) {
            if (field.name != fixed.fields[i].name) continue;
            if (field.turn != Turn::Constant && field.at + field.raw.bytes > size) throw "a field lies past the end";
            if (field.raw.bytes == 3 || field.raw.isBigEndian) throw "a field is no little-endian number";
            layout.moves[i] = detail::move(fixed.fields[i], field);
            ++found;
        }
        if (found != 1) throw "a field of the fixed layout is not given, or given twice";
    }
    return layout;
}

}  // namespace kelvo::adaptation
