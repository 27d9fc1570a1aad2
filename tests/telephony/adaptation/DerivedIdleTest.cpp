#include "telephony/adaptation/DerivedIdle.h"

#include <gtest/gtest.h>

namespace kelvo::adaptation {
namespace {

using Payload = IdleCells::Payload;

// Bits `low` to `high` of the little-endian word of 32 bits at `at`.
std::uint32_t bits(const Payload& payload, std::size_t at, int low, int high) {
    std::uint32_t word = 0;
    for (std::size_t i = 0; i < 4; ++i) word |= std::uint32_t{payload[at + i]} << (8 * i);
    return word >> low & ((1U << (high - low + 1)) - 1);
}

TEST(DerivedIdle, SaysTheCellAndItsLevelsAndIsNeutralOtherwise) {
    // -95.25 dBm is 179 quarters above -140 dBm, -8.5 dB 86 quarters above -30 dB, -65 dBm 150 halves above -140 dBm.
    const Payload payload =
        derivedIdle({.earfcn = 1300, .pci = 301, .rsrp = -95.25, .rsrq = -8.5, .rssi = -65}, nullptr);
    const Payload expected = {
        2,    0,    0,    0,     // version 2, no words of release 9
        0x14, 0x05, 0x2D, 0x01,  // EARFCN 1300, PCI 301, priority 0
        0xB3, 0x66, 0x59, 0xAD,  // RSRP 179 and 179, RSRQ 86 and 86
        0x96, 0x00, 0x60, 0x0D,  // RSSI 150, Qrxlevmin 0, P_Max 64 (none), maximum power 53 (23 dBm)
        0x4B, 0x00, 0x04, 0x01,  // Srxlev 75 (45 dB), no failed cycles, both thresholds 32 (none), no rules
    };
    EXPECT_EQ(payload, expected);
    EXPECT_EQ(bits(payload, 8, 0, 8), 179U);
    EXPECT_EQ(bits(payload, 8, 9, 17), 179U);
    EXPECT_EQ(bits(payload, 8, 18, 24), 86U);
    EXPECT_EQ(bits(payload, 8, 25, 31), 86U);
    EXPECT_EQ(bits(payload, 12, 0, 8), 150U);
    EXPECT_EQ(bits(payload, 12, 9, 14), 0U);
    EXPECT_EQ(bits(payload, 12, 15, 21), 64U);
    EXPECT_EQ(bits(payload, 12, 22, 27), 53U);
    EXPECT_EQ(bits(payload, 16, 0, 6), 75U);
    EXPECT_EQ(bits(payload, 16, 7, 12), 0U);
    EXPECT_EQ(bits(payload, 16, 13, 18), 32U);
    EXPECT_EQ(bits(payload, 16, 19, 24), 32U);
    EXPECT_EQ(bits(payload, 16, 25, 29), 0U);
}

TEST(DerivedIdle, TakesTheNearestStepTiesUpAndSaturates) {
    const auto rsrp = [](double dBm) { return bits(derivedIdle({.rsrp = dBm}, nullptr), 8, 0, 8); };
    EXPECT_EQ(rsrp(-100.0), 160U);
    EXPECT_EQ(rsrp(-100.12), 160U);   // 159.52
    EXPECT_EQ(rsrp(-100.125), 160U);  // 159.5
    EXPECT_EQ(rsrp(-100.13), 159U);   // 159.48
    EXPECT_EQ(rsrp(-150), 0U);
    EXPECT_EQ(rsrp(100), 511U);
    const auto srxlev = [](double dBm) { return bits(derivedIdle({.rsrp = dBm}, nullptr), 16, 0, 6); };
    EXPECT_EQ(srxlev(-100.5), 70U);  // 39.5 dB become 40
    EXPECT_EQ(srxlev(-200), 0U);     // -30 dB is the least
    EXPECT_EQ(srxlev(0), 127U);
    EXPECT_EQ(bits(derivedIdle({.rsrq = -31}, nullptr), 8, 18, 24), 0U);
    EXPECT_EQ(bits(derivedIdle({.rssi = -64.75}, nullptr), 12, 0, 8), 151U);  // 150.5
}

TEST(DerivedIdle, MarksAChannelThatIsSaidElsewhere) {
    const Payload payload = derivedIdle({.earfcn = 66586, .pci = 503}, nullptr);
    EXPECT_EQ(bits(payload, 4, 0, 15), 65535U);
    EXPECT_EQ(bits(payload, 4, 16, 24), 503U);
}

TEST(DerivedIdle, IsCompletedByTheCellsLastRealRecord) {
    Payload last{};
    last[7] = 0x0A;   // priority 5
    last[8] = 160;    // measured RSRP -100 dBm
    last[13] = 0x14;  // Qrxlevmin 10
    last[16] = 60;    // Srxlev 30 dB
    last[17] = 0x60;  // S intra 3
    last[19] = 0x2E;  // rules updated, rules 11
    const Payload payload = derivedIdle({.earfcn = 1300, .pci = 301, .rsrp = -98.4, .rsrq = -8, .rssi = -65}, &last);
    EXPECT_EQ(bits(payload, 4, 25, 28), 5U);
    EXPECT_EQ(bits(payload, 12, 9, 14), 10U);
    EXPECT_EQ(bits(payload, 12, 15, 21), 0U);  // what the record said, not the neutral 64
    EXPECT_EQ(bits(payload, 16, 13, 18), 3U);
    EXPECT_EQ(bits(payload, 16, 25, 25), 1U);
    EXPECT_EQ(bits(payload, 16, 26, 29), 11U);
    EXPECT_EQ(bits(payload, 8, 0, 8), 166U);  // -98.5 dBm, six quarters more
    EXPECT_EQ(bits(payload, 16, 0, 6), 62U);  // 1.5 dB more, to whole dB, ties up
    EXPECT_EQ(payload[0], 2);
}

}  // namespace
}  // namespace kelvo::adaptation
