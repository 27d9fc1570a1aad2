#include "telephony/wire/LogMask.h"

#include <algorithm>

namespace kelvo::wire {

LogMask::LogMask(std::uint32_t equipment, std::uint32_t items) : LogMask(equipment, items, {}) {}

LogMask::LogMask(std::uint32_t equipment, std::uint32_t items, ByteView bits)
    : _equipment(equipment), _items(std::min(items, kMostItems)), _bits((_items + 7) / 8) {
    std::copy_n(bits.begin(), std::min(bits.size(), _bits.size()), _bits.begin());
}

void LogMask::set(LogCode code) {
    if (holds(code)) _bits[(code & 0xFFF) / 8] |= static_cast<std::uint8_t>(1U << code % 8);
}

bool LogMask::test(LogCode code) const { return holds(code) && (_bits[(code & 0xFFF) / 8] >> code % 8 & 1) != 0; }

}  // namespace kelvo::wire
