#pragma once

#include <span>
#include <utility>

#include "platform/values/Bytes.h"
#include "telephony/adaptation/LayoutWords.h"

/// Turning bytes as a layout's table says. Each table becomes straight-line code of its own: a record has some twenty
/// fields, and a loop over them costs more than they do.
namespace kelvo::adaptation {

namespace detail {

inline std::uint32_t load(const std::uint8_t* at, int bytes) {
    std::uint32_t word = at[0];
    if (bytes > 1) word |= std::uint32_t{at[1]} << 8;
    if (bytes > 2) word |= std::uint32_t{at[2]} << 16 | std::uint32_t{at[3]} << 24;
    return word;
}

inline void store(std::uint8_t* at, int bytes, std::uint32_t word) {
    at[0] = static_cast<std::uint8_t>(word);
    if (bytes > 1) at[1] = static_cast<std::uint8_t>(word >> 8);
    if (bytes > 2) {
        at[2] = static_cast<std::uint8_t>(word >> 16);
        at[3] = static_cast<std::uint8_t>(word >> 24);
    }
}

constexpr std::uint32_t mask(const Raw& raw) { return ~std::uint32_t{0} >> (32 - raw.width); }

inline std::int64_t readBits(const std::uint8_t* at, const Raw& raw) {
    const std::uint32_t bits = load(at, raw.bytes) >> raw.lowBit & mask(raw);
    if (!raw.isSigned) return bits;
    const std::int64_t sign = std::int64_t{1} << (raw.width - 1);
    return (std::int64_t{bits} ^ sign) - sign;
}

inline std::int64_t turned(const Move& move, std::int64_t raw) {
    constexpr std::int64_t kChannelSaidElsewhere = 65535;
    switch (move.turn) {
        case Turn::Copied: return raw;
        case Turn::Cut: return std::min(raw, move.greatest());
        case Turn::Stepped:
            return std::clamp<std::int64_t>((raw * move.factor + move.summand) >> move.shift, 0, move.greatest());
        case Turn::Channel: return std::min(raw, kChannelSaidElsewhere);
        case Turn::Search: return raw == 63 ? 32 : raw == 32 ? 33 : raw;
        case Turn::Constant: break;
    }
    return move.summand;
}

}  // namespace detail

/// Replaces the bits of one field.
inline void writeBits(std::uint8_t* at, Raw raw, std::uint32_t value) {
    if (raw.width == 8 * raw.bytes) return detail::store(at, raw.bytes, value);
    const std::uint32_t field = detail::mask(raw) << raw.lowBit;
    detail::store(at, raw.bytes, (detail::load(at, raw.bytes) & ~field) | (value << raw.lowBit & field));
}

/// Carries out one move; false when the value does not fit and may not be cut.
template <Move move>
bool carryOut(const std::uint8_t* from, std::uint8_t* to) {
    const std::int64_t raw = move.turn == Turn::Constant ? 0 : detail::readBits(from + move.from, move.fromRaw);
    const std::int64_t value = detail::turned(move, raw);
    if (value > move.greatest()) return false;
    writeBits(to + move.to, move.toRaw, static_cast<std::uint32_t>(value));
    return true;
}

/// Turns a record in `layout`, or what begins with one of its list's entries, to `to`, whose bytes there are 0. False
/// when a value does not fit and may not be cut, or when the layout reaches past the end.
template <const auto& layout>
bool carryOut(ByteView from, std::uint8_t* to) {
    if (from.size() < layout.reach()) return false;
    return [&]<std::size_t... i>(std::index_sequence<i...>) {
        return (carryOut<layout.moves[i]>(from.data(), to) && ...);
    }
    (std::make_index_sequence<layout.moves.size()>());
}

/// A newer layout where it depends on the record which one it is.
struct Turning {
    std::size_t size;
    bool (*carryOut)(ByteView from, std::uint8_t* to);
    std::span<const Move> moves;
};
template <const auto& layout>
inline constexpr Turning turning{layout.size, carryOut<layout>, layout.moves};

}  // namespace kelvo::adaptation
