#include "bench/Families.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo::bench {
namespace {

constexpr std::uint32_t kVariants = 32;

Bytes antennas(std::uint32_t i) { return Record(0xB0C1, 22).u8(20, 1 + i % 4).bytes(); }

Bytes servingCell(std::uint32_t i) {
    return Record(0xB0C2, 38)
        .u16(14, (301 + 7 * i) % 504)
        .u16(16, 5780 + i)
        .u16(18, 23780 + i)
        .u8(20, 50)
        .u8(21, 50)
        .u32(22, 12345678 + 256 * i)
        .u16(26, 4097 + i % 3)
        .u32(28, 12)
        .bytes();
}

Bytes servingMeasurement(std::uint32_t i) {
    return Record(0xB17F, 33).u16(17, 5780).u32(21, 0x9C4A2D87 + 0x1030507 * i).u32(25, 0x1234567 + 257 * i).bytes();
}

Bytes connectedMode(std::uint32_t i, std::uint32_t cells) {
    Record record(0xB179, 29 + 6 * cells);
    record.u16(17, 5780).u16(21, i % 1024).u16(23, 150 + i).u16(25, 80 + i).u8(27, cells);
    for (std::uint32_t j = 0; j < cells; ++j)
        record.u16(29 + 6 * j, 300 + j).u16(31 + 6 * j, 130 + (i + j) % 90).u16(33 + 6 * j, 70 + (i * j) % 90);
    return record.bytes();
}

Bytes idleNeighbors(std::uint32_t i) {
    Record record(0xB180, 181);
    record.u16(17, 5780).u16(19, 7 << 6 | 5);
    for (std::uint32_t j = 0; j < 8; ++j) {
        record.u32(21 + 20 * j, 0x12345678 + 0x10101 * i + j).u32(25 + 20 * j, 0x2345678 + 0x1050301 * (i + j));
        record.u16(29 + 20 * j, 100 * i + j).u32(33 + 20 * j, 0x3456789 + 7919 * i);
    }
    return record.bytes();
}

Bytes candidates(std::uint32_t i) {
    Record record(0xB186, 53);
    record.u16(15, 5780).u8(19, 6);
    for (std::uint32_t j = 0; j < 6; ++j) record.u16(21 + 4 * j, (i + j) % 8).u16(23 + 4 * j, (i + j) % 4);
    return record.bytes();
}

}  // namespace

Family lteFamily() {
    const auto twoCells = vary(kVariants, [](std::uint32_t i) { return connectedMode(i, 2); });
    const auto idle = vary(kVariants, idleNeighbors);
    return {"LTE",
            kPLLogChannelTechnology_Oskra_LTE,
            {{"mix", interleave({vary(kVariants, antennas), vary(kVariants, servingCell),
                                 vary(kVariants, servingMeasurement), twoCells, idle, vary(kVariants, candidates)})},
             {"serving cell, identity (0xB0C2, 8 values)", vary(kVariants, servingCell)},
             {"serving cell, idle (0xB17F, 18 values)", vary(kVariants, servingMeasurement)},
             {"intra-frequency, connected (0xB179, 4 cells)",
              vary(kVariants, [](std::uint32_t i) { return connectedMode(i, 4); })},
             {"neighbor cells, idle (0xB180, 8 cells)", idle},
             {"cells (0xB0C1, 0xB0C2, 0xB179)",
              interleave({vary(kVariants, antennas), vary(kVariants, servingCell), twoCells})}}};
}

}  // namespace kelvo::bench
