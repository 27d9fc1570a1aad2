#include "telephony/wire/modem/RecordMasks.h"

#include <algorithm>

namespace kelvo::modem {

void RecordMasks::set(const wire::LogMask& mask) {
    const std::uint32_t equipment = mask.equipment();
    wire::LogMask inForce(equipment, std::min(mask.items(), _ranges[equipment]));
    for (std::uint32_t item = 0; item < inForce.items(); ++item) {
        const auto code = static_cast<std::uint16_t>(equipment << 12 | item);
        if (mask.test(code)) inForce.set(code);
    }
    _masks[equipment] = std::move(inForce);
}

void RecordMasks::clear() {
    _masks.clear();
    for (std::uint32_t equipment = 0; equipment < wire::kEquipmentIds; ++equipment) _masks.emplace_back(equipment, 0);
}

void RecordMasks::setAll() {
    for (std::uint32_t equipment = 0; equipment < wire::kEquipmentIds; ++equipment)
        set(wire::LogMask(equipment, _ranges[equipment], Bytes(_ranges[equipment] / 8 + 1, 0xFF)));
}

bool RecordMasks::wantAny() const {
    return std::ranges::any_of(_masks, [](const wire::LogMask& mask) {
        return std::ranges::any_of(mask.bits(), [](std::uint8_t byte) { return byte != 0; });
    });
}

}  // namespace kelvo::modem
