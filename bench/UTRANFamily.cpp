#include "bench/Families.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo::bench {
namespace {

constexpr std::uint32_t kVariants = 32;

Bytes rrcState(std::uint32_t i) { return Record(0xD0E0, 15).u8(13, 1).u8(14, i % 6).bytes(); }
Bytes servingCell(std::uint32_t i) {
    return Record(0xD0E2, 26).u16(17, 9400).u16(19, 10054).u32(21, 12345678 + i).bytes();
}

Bytes neighbors(std::uint32_t i) {
    Record record(0xD00A, 168 + 16 * 8);
    record.u8(16, 8 << 1);
    for (std::uint32_t j = 0; j < 8; ++j) record.u32(168 + 16 * j, 0x12345678 + 0x1010101 * i + j);
    return record.bytes();
}

Bytes channels(std::uint32_t i) {
    Record record = Record(0xD00C, 289 + 34 * 4 + 8 * 2).u16(14, 2 << 12 | 4 << 6);
    for (std::uint32_t j = 0; j < 8; ++j) record.u8(17 + j, i + j).u8(425 + 2 * j, i * j);
    return record.bytes();
}

}  // namespace

Family utranFamily() {
    const auto cells = vary(kVariants, neighbors);
    return {"UTRAN",
            kPLLogChannelTechnology_Oskra_UTRAN2,
            {{"mix",
              interleave({vary(kVariants, rrcState), vary(kVariants, servingCell), cells, vary(kVariants, channels)})},
             {"neighbor cells (0xD00A, 8 cells)", cells}}};
}

}  // namespace kelvo::bench
