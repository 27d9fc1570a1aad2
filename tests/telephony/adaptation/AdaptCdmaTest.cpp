#include <gtest/gtest.h>

#include "tests/telephony/adaptation/Sent.h"

namespace kelvo::test {
namespace {

TEST(AdaptCdma, WantsTheExactLengthOfTwoRecords) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0x1183, 37)), "passed");
    EXPECT_EQ(adapt(Sent(0x1183, 36)), "0x1183, 36 bytes: too short");
    EXPECT_EQ(adapt(Sent(0x1183, 38)), "0x1183, 38 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x108A, 10 + 2 * 14).u8(9, 2)), "passed");
    EXPECT_EQ(adapt(Sent(0x108A, 10 + 2 * 14).u8(9, 3)), "0x108A, 38 bytes: too short");
    EXPECT_EQ(adapt(Sent(0x108A, 10 + 2 * 14).u8(9, 1)), "0x108A, 38 bytes: not known");
}

TEST(AdaptCdma, WantsTheLeastLengthOfTheOthers) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0x12B6, 12 + 24).u8(2, 2)), "passed");
    EXPECT_EQ(adapt(Sent(0x12B6, 12 + 23).u8(2, 2)), "0x12B6, 35 bytes: too short");
    EXPECT_EQ(adapt(Sent(0x1192, 228)), "passed");
    EXPECT_EQ(adapt(Sent(0x1192, 227)), "0x1192, 227 bytes: too short");
    EXPECT_EQ(adapt(Sent(0x127E, 1737)), "passed");
    EXPECT_EQ(adapt(Sent(0x127E, 1736)), "0x127E, 1736 bytes: too short");
    EXPECT_EQ(adapt(Sent(0x134F, 2607).u8(0, 8)), "passed");
    EXPECT_EQ(adapt(Sent(0x134F, 157)), "0x134F, 157 bytes: too short");
}

// The count of sub-packets lies at payload offset 1, the first of them at 4: id, a byte, size, its header included.
TEST(AdaptCdma, WantsSubpacketsWithinTheRecord) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0x119C, 4)), "passed");
    EXPECT_EQ(adapt(Sent(0x119C, 4 + 5 + 14).u8(1, 2).u8(4, 1).u16(6, 5).u8(9, 2).u16(11, 14)), "passed");
    EXPECT_EQ(adapt(Sent(0x119C, 4 + 5 + 13).u8(1, 2).u8(4, 1).u16(6, 5).u8(9, 2).u16(11, 14)),
              "0x119C, 22 bytes: sub-packets that do not fit");
    EXPECT_EQ(adapt(Sent(0x119C, 4 + 5).u8(1, 2).u8(4, 1).u16(6, 5)), "0x119C, 9 bytes: sub-packets that do not fit");
    EXPECT_EQ(adapt(Sent(0x119C, 3)), "0x119C, 3 bytes: too short");
}

TEST(AdaptCdma, WantsSubpacketsAsLongAsWhatIsReadOfThem) {
    Adapter adapt;
    const auto one = [](std::uint32_t id, std::uint32_t size) {
        return Sent(0x119C, 4 + 60).u8(1, 1).u8(4, id).u16(6, size);
    };
    EXPECT_EQ(adapt(one(1, 5)), "passed");
    EXPECT_EQ(adapt(one(1, 4)), "0x119C, 64 bytes: sub-packets that do not fit");
    EXPECT_EQ(adapt(one(2, 14)), "passed");
    EXPECT_EQ(adapt(one(2, 13)), "0x119C, 64 bytes: sub-packets that do not fit");
    EXPECT_EQ(adapt(one(3, 12)), "passed");
    EXPECT_EQ(adapt(one(3, 11)), "0x119C, 64 bytes: sub-packets that do not fit");
    EXPECT_EQ(adapt(one(3, 12 + 2 * 20).u8(4 + 8, 2).u8(4 + 9, 1)), "passed");  // two pilots of 20 bytes
    EXPECT_EQ(adapt(one(3, 11 + 2 * 20).u8(4 + 8, 2).u8(4 + 9, 1)), "0x119C, 64 bytes: sub-packets that do not fit");
    EXPECT_EQ(adapt(one(4, 4)), "passed");
    EXPECT_EQ(adapt(one(4, 3)), "0x119C, 64 bytes: sub-packets that do not fit");
    EXPECT_EQ(adapt(Sent(0x119D, 4 + 25).u8(1, 1).u8(4, 11).u16(6, 25)), "passed");
    EXPECT_EQ(adapt(Sent(0x119D, 4 + 25).u8(1, 1).u8(4, 11).u16(6, 24)),
              "0x119D, 29 bytes: sub-packets that do not fit");
}

}  // namespace
}  // namespace kelvo::test
