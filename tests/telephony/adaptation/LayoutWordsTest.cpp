#include <gtest/gtest.h>

#include <array>

#include "telephony/adaptation/CarryOut.h"

namespace kelvo::adaptation {
namespace {

// A level in 1/16 dB from -180 dBm, as 12 bits, to 1/4 dB from -140 dBm in 9 bits.
constexpr auto kFixed = fixedLayout(4, {{"level", 0, u32.bits(9, 17), steps(1, 4, -140)}});
constexpr auto kNewer = newerLayout(kFixed, 2, {{"level", 0, u16.bits(0, 11), steps(1, 16, -180)}});

std::int64_t turned(std::uint16_t raw) {
    const std::array<std::uint8_t, 2> from = {static_cast<std::uint8_t>(raw), static_cast<std::uint8_t>(raw >> 8)};
    std::array<std::uint8_t, 4> to{};
    EXPECT_TRUE(carryOut<kNewer>(from, to.data()));
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
    EXPECT_TRUE(carryOut<kWide>(std::array<std::uint8_t, 4>{0xFF, 0xFF, 0, 0}, to.data()));
    EXPECT_EQ(to, (std::array<std::uint8_t, 2>{0xFF, 0xFF}));
    EXPECT_FALSE(carryOut<kWide>(std::array<std::uint8_t, 4>{0, 0, 1, 0}, to.data()));
}

TEST(LayoutWords, ReadNothingPastTheEnd) {
    static constexpr auto kSmall = fixedLayout(2, {{"PCI", 0, u16}});
    static constexpr auto kLate = newerLayout(kSmall, 4, {{"PCI", 2, u16}});
    std::array<std::uint8_t, 2> to{};
    EXPECT_TRUE(carryOut<kLate>(std::array<std::uint8_t, 4>{0, 0, 7, 0}, to.data()));
    EXPECT_FALSE(carryOut<kLate>(std::array<std::uint8_t, 3>{0, 0, 7}, to.data()));
}

}  // namespace
}  // namespace kelvo::adaptation
