#include <gtest/gtest.h>

#include <array>
#include <cmath>

#include "telephony/adaptation/LayoutWords.h"

namespace kelvo::adaptation {
namespace {

// A level in 1/16 dB from -180 dBm, as 12 bits, to 1/4 dB from -140 dBm in 9 bits.
constexpr auto kFixed = fixedLayout(4, {{"level", 0, u32.bits(9, 17), steps(1, 4, -140)}});
constexpr auto kNewer = newerLayout(kFixed, 2, {{"level", 0, u16.bits(0, 11), steps(1, 16, -180)}});

std::int64_t turned(std::uint16_t raw) {
    const std::array<std::uint8_t, 2> from = {static_cast<std::uint8_t>(raw), static_cast<std::uint8_t>(raw >> 8)};
    std::array<std::uint8_t, 4> to{};
    EXPECT_TRUE(carryOut(kNewer.moves, RecordView(from), 0, to.data()));
    return RecordView(to).read(0, u32.bits(9, 17));
}

TEST(LayoutWords, TakeTheNearestStepAndTheUpperOfTwo) {
    EXPECT_EQ(turned(1360), 180);  // -95 dBm
    EXPECT_EQ(turned(1361), 180);  // -94.9375
    EXPECT_EQ(turned(1362), 181);  // -94.875: half-way
    EXPECT_EQ(turned(1363), 181);  // -94.8125
    EXPECT_EQ(turned(1364), 181);  // -94.75
    EXPECT_EQ(turned(638), 0);     // -140.125: half a step below the range, which is at its lowest step
    EXPECT_EQ(turned(642), 1);     // -139.875
    EXPECT_EQ(turned(641), 0);     // -139.9375
}

TEST(LayoutWords, StopAtTheEndsOfTheFixedField) {
    EXPECT_EQ(turned(0), 0);       // -180 dBm
    EXPECT_EQ(turned(2685), 511);  // -12.1875 dBm: 511.25 steps
    EXPECT_EQ(turned(4095), 511);  // 75.9 dBm
}

TEST(LayoutWords, WriteBitsBesideOthers) {
    std::array<std::uint8_t, 4> bytes = {0xFF, 0xFF, 0xFF, 0xFF};
    writeBits(bytes.data(), u32.bits(9, 17), 0x101);
    EXPECT_EQ(bytes, (std::array<std::uint8_t, 4>{0xFF, 0x03, 0xFE, 0xFF}));
    writeBits(bytes.data(), u32, 0x12345678);
    EXPECT_EQ(bytes, (std::array<std::uint8_t, 4>{0x78, 0x56, 0x34, 0x12}));
    writeBits(bytes.data() + 3, u8.bits(6, 7), 2);
    EXPECT_EQ(bytes[3], 0x92);
}

TEST(LayoutWords, RefuseAnIdentityThatDoesNotFit) {
    static constexpr auto kSmall = fixedLayout(2, {{"PCI", 0, u16}});
    static constexpr auto kWide = newerLayout(kSmall, 4, {{"PCI", 0, u32}});
    std::array<std::uint8_t, 2> to{};
    EXPECT_TRUE(carryOut(kWide.moves, RecordView(std::array<std::uint8_t, 4>{0xFF, 0xFF, 0, 0}), 0, to.data()));
    EXPECT_EQ(to, (std::array<std::uint8_t, 2>{0xFF, 0xFF}));
    EXPECT_FALSE(carryOut(kWide.moves, RecordView(std::array<std::uint8_t, 4>{0, 0, 1, 0}), 0, to.data()));
}

/// Every raw value of every conversion that levels need: the step nearest to the value, the upper of two.
TEST(LayoutWords, SayTheNearestValueOverTheWholeRange) {
    struct Case {
        int fromDenominator, fromOffset, fromBits;
        int toDenominator, toOffset, toBits;
        Move move;
    };
    static constexpr auto levels = fixedLayout(32, {
                                                       {"RSRP, quarters", 0, u32.bits(0, 8), steps(1, 4, -140)},
                                                       {"RSRP, halves", 4, u32.bits(0, 8), steps(1, 2, -140)},
                                                       {"RSRQ, eighths", 8, u32.bits(0, 15), steps(1, 8, -20)},
                                                       {"RSRQ, quarters", 12, u32.bits(0, 6), steps(1, 4, -30)},
                                                       {"RSSI", 16, u32.bits(0, 8), steps(1, 2, -140)},
                                                       {"RSSI of a neighbor", 20, u32.bits(0, 7), steps(1, 2, -140)},
                                                   });
    static constexpr auto newer = newerLayout(levels, 32,
                                              {
                                                  {"RSRP, quarters", 0, u32.bits(0, 11), steps(1, 16, -180)},
                                                  {"RSRP, halves", 0, u32.bits(0, 11), steps(1, 16, -180)},
                                                  {"RSRQ, eighths", 0, u32.bits(0, 9), steps(1, 16, -30)},
                                                  {"RSRQ, quarters", 0, u32.bits(0, 9), steps(1, 16, -30)},
                                                  {"RSSI", 0, u32.bits(0, 10), steps(1, 16, -110)},
                                                  {"RSSI of a neighbor", 0, u32.bits(0, 10), steps(1, 16, -110)},
                                              });
    const std::array<Case, 6> cases = {{
        {16, -180, 12, 4, -140, 9, newer.moves[0]},
        {16, -180, 12, 2, -140, 9, newer.moves[1]},
        {16, -30, 10, 8, -20, 16, newer.moves[2]},
        {16, -30, 10, 4, -30, 7, newer.moves[3]},
        {16, -110, 11, 2, -140, 9, newer.moves[4]},
        {16, -110, 11, 2, -140, 8, newer.moves[5]},
    }};
    for (const Case& c : cases) {
        for (int raw = 0; raw < 1 << c.fromBits; ++raw) {
            const double value = static_cast<double>(raw) / c.fromDenominator + c.fromOffset;
            const double exact = (value - c.toOffset) * c.toDenominator;
            const double nearest = std::min(std::max(std::floor(exact + 0.5), 0.0), std::pow(2.0, c.toBits) - 1);
            const std::array<std::uint8_t, 4> from = {static_cast<std::uint8_t>(raw),
                                                      static_cast<std::uint8_t>(raw >> 8), 0, 0};
            std::array<std::uint8_t, 32> to{};
            ASSERT_TRUE(carryOut(std::span(&c.move, 1), RecordView(from), 0, to.data()));
            ASSERT_EQ(static_cast<double>(RecordView(to).read(c.move.to, c.move.toRaw)), nearest) << raw;
        }
    }
}

}  // namespace
}  // namespace kelvo::adaptation
