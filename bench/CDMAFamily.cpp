#include "bench/Families.h"
#include "platform/telephony/TelephonyConstants.h"
#include "tests/support/Subpackets.h"

namespace kelvo::bench {
namespace {

using test::Subpackets;

constexpr std::uint32_t kVariants = 16;

Bytes evdoStatus(std::uint32_t i) {
    return Record(0x1183, 50)
        .u8(13, 0x2C)
        .u8(14, 3)
        .u8(15, 0xB5 + i)
        .u8(16, 0xB0 + i)
        .u8(36, 5)
        .u8(37, 4)
        .u16(18, 168)
        .bytes();
}

Bytes fingers(std::uint32_t i) {
    Record record = Record(0x108a, 23 + 14 * 6).u8(22, 6);
    for (std::uint32_t j = 0; j < 6; ++j)
        record.u16(23 + 14 * j, j < 4 ? 168 + j : 65535).u16(29 + 14 * j, 90 + 70 * j + i);
    return record.bytes();
}

Bytes activeSetPilots(std::uint32_t i) {
    Record record = Record(0x12b6, 25 + 12 * 3).u8(15, 3);
    for (std::uint32_t j = 0; j < 3; ++j) record.u16(25 + 12 * j, 168 + j).u16(27 + 12 * j, 90 + 70 * j + i);
    return record.bytes();
}

Bytes status1x(std::uint32_t i) {
    Subpackets packet = Subpackets(0x119c).add(1, 8).u8(4, 8).add(2, 16).u8(10, 0x90 + i).u8(11, 0x98).u16(12, 235);
    packet.add(3, 12 + 3 * 20).u16(4, 4).u8(6, 8).u8(7, 3).u8(8, 3).u8(9, 1).u16(10, 168);
    for (std::uint32_t j = 0; j < 3; ++j) packet.u16(12 + 20 * j, 168 + j).u16(28 + 20 * j, 72 + 50 * j + i);
    return packet.add(4, 40).bytes();
}

Bytes trafficFrame(std::uint32_t i) { return Subpackets(0x119d).add(3, 9).add(11, 25).u8(24, i % 7 == 0).bytes(); }
Bytes forwardRate(std::uint32_t i) { return Record(0x1192, 241).u32(13, i).u32(29, i * 600).bytes(); }
Bytes reverseRate(std::uint32_t i) { return Record(0x127e, 1750).u32(14, i).u32(18 + 96, i * 150).bytes(); }
Bytes identification(std::uint32_t i) {
    return Record(0x134f, 200).u8(13, 2).u32(42, i % 13).u32(46, 2).u16(50, 4139).u16(52, 17).bytes();
}

}  // namespace

Family cdmaFamily() {
    const auto frames = vary(kVariants, trafficFrame);
    return {"CDMA",
            kPLLogChannelTechnology_Oskra_CDMA,
            {{"mix",
              interleave({frames, frames, frames, frames, frames, vary(kVariants, evdoStatus), vary(kVariants, fingers),
                          vary(kVariants, activeSetPilots), vary(kVariants, status1x), vary(kVariants, forwardRate),
                          vary(kVariants, reverseRate), vary(kVariants, identification)})},
             {"1x status (0x119c, 3 pilots)", vary(kVariants, status1x)}}};
}

}  // namespace kelvo::bench
