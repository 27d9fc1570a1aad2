#include "telephony/wire/LogMask.h"

#include <gtest/gtest.h>

namespace kelvo::wire {
namespace {

Bytes bitsOf(const LogMask& mask) { return {mask.bits().begin(), mask.bits().end()}; }

TEST(LogMask, HasItemIInBitIOfByteIEighth) {
    LogMask mask(0xB, 0x201);
    for (const LogCode code : {0xB000U, 0xB007U, 0xB008U, 0xB0C2U, 0xB200U}) mask.set(code);
    Bytes expected(65);
    expected[0] = 0x81;
    expected[1] = 0x01;
    expected[0x0C2 / 8] = 0x04;
    expected[64] = 0x01;
    EXPECT_EQ(bitsOf(mask), expected);
    EXPECT_TRUE(mask.test(0xB0C2));
    EXPECT_FALSE(mask.test(0xB0C1));
}

TEST(LogMask, HoldsTheItemsOfItsEquipmentAlone) {
    LogMask mask(0x5, 0x130);
    EXPECT_TRUE(mask.holds(0x512F));
    EXPECT_FALSE(mask.holds(0x5130));
    EXPECT_FALSE(mask.holds(0x412F));
    mask.set(0x5130);
    mask.set(0x412F);
    EXPECT_EQ(bitsOf(mask), Bytes(38));
    EXPECT_FALSE(mask.test(0x5130));
}

TEST(LogMask, TakesItsBytesFromAnAnswer) {
    const LogMask mask(1, 12, Bytes{0x01, 0x08, 0xFF});
    EXPECT_TRUE(mask.test(0x1000));
    EXPECT_TRUE(mask.test(0x100B));
    EXPECT_FALSE(mask.test(0x1001));
    EXPECT_EQ(bitsOf(mask), (Bytes{0x01, 0x08}));
    EXPECT_EQ(bitsOf(LogMask(1, 12, Bytes{0x01})), (Bytes{0x01, 0x00}));
}

TEST(LogMask, IsNeverLargerThanThereAreCodes) { EXPECT_EQ(bitsOf(LogMask(1, 0xFFFFFFFF)).size(), 512U); }

TEST(LogMask, MayBeEmpty) { EXPECT_EQ(bitsOf(LogMask(2, 0)), Bytes()); }

}  // namespace
}  // namespace kelvo::wire
