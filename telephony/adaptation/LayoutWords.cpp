#include "telephony/adaptation/LayoutWords.h"

#include <algorithm>

namespace kelvo::adaptation {

namespace {

constexpr std::int64_t roundedDown(std::int64_t dividend, std::int64_t divisor) {
    const std::int64_t quotient = dividend / divisor;
    return quotient - (dividend % divisor < 0 ? 1 : 0);
}

constexpr std::int64_t kChannelSaidElsewhere = 65535;

std::int64_t turned(const Move& move, std::int64_t raw) {
    switch (move.turn) {
        case Turn::Copied: return raw;
        case Turn::Cut: return std::min(raw, move.greatest());
        case Turn::Stepped:
            return std::clamp<std::int64_t>(roundedDown(raw * move.factor + move.summand, move.divisor), 0,
                                            move.greatest());
        case Turn::Channel: return std::min(raw, kChannelSaidElsewhere);
        case Turn::Search: return raw == 63 ? 32 : raw == 32 ? 33 : raw;
        case Turn::Constant: return move.summand;
    }
    return raw;
}

}  // namespace

bool carryOut(std::span<const Move> moves, RecordView from, std::size_t fromBase, std::uint8_t* to) {
    for (const Move& move : moves) {
        const std::int64_t raw = move.turn == Turn::Constant ? 0 : from.read(fromBase + move.from, move.fromRaw);
        const std::int64_t value = turned(move, raw);
        if (value > move.greatest()) return false;
        writeBits(to + move.to, move.toRaw, static_cast<std::uint32_t>(value));
    }
    return true;
}

void writeBits(std::uint8_t* at, Raw raw, std::uint32_t value) {
    std::uint32_t word = 0;
    for (int i = 0; i < raw.bytes; ++i) word |= std::uint32_t{at[i]} << (8 * i);
    const std::uint32_t mask = (raw.bitWidth() == 32 ? ~std::uint32_t{0} : (std::uint32_t{1} << raw.bitWidth()) - 1)
                               << raw.lowBit;
    word = (word & ~mask) | (value << raw.lowBit & mask);
    for (int i = 0; i < raw.bytes; ++i) at[i] = static_cast<std::uint8_t>(word >> (8 * i));
}

}  // namespace kelvo::adaptation
