#include <gtest/gtest.h>

#include "tests/telephony/adaptation/Sent.h"

namespace kelvo::test {
namespace {

// 0x4005: two UMTS cells or a GSM cell.
Sent umtsCells(Sent sent, std::size_t at, std::size_t stride) {
    return sent.u16(at, 10562)
        .u16(at + 2, 300)
        .u8(at + 4, 0xB0)
        .u16(at + 5, 0xFFA0)
        .u8(at + 7, 0xEE)
        .u16(at + 8, 12)
        .u16(at + stride, 10587)
        .u16(at + stride + 2, 511)
        .u8(at + stride + 4, 0xA0)
        .u16(at + stride + 5, 0xFF90)
        .u8(at + stride + 7, 0xDD)
        .u16(at + stride + 8, 0xFFFE);
}
Sent gsmCell(Sent sent, std::size_t at, std::uint32_t band) {
    return sent.u16(at, 1023 | band << 12).u16(at + 2, 63).u8(at + 4, 0xB5).u16(at + 5, 0xFFC0);
}

TEST(AdaptGsm, TurnsTheRankingOfUmtsCells) {
    Adapter adapt;
    const Sent fixed = umtsCells(Sent(0x4005, 22).u8(0, 2), 2, 10);
    EXPECT_EQ(adapt(fixed), "passed");
    EXPECT_EQ(adapt(umtsCells(Sent(0x4005, 24).u8(0, 0x42), 2, 11).u8(12, 7).u8(23, 7)), is(fixed));
    EXPECT_EQ(adapt(umtsCells(Sent(0x4005, 39).u8(0, 0x82).u32(2, 0xFFFFFFFF), 7, 16).u32(17, 0xFFFFFFFF)), is(fixed));
    EXPECT_EQ(adapt.last.leftOut, 0);
}

TEST(AdaptGsm, TurnsTheRankingOfGsmCells) {
    Adapter adapt;
    const Sent fixed = gsmCell(Sent(0x4005, 9).u8(1, 1), 2, 0);
    EXPECT_EQ(adapt(fixed), "passed");
    EXPECT_EQ(adapt(gsmCell(Sent(0x4005, 10).u8(0, 0x40).u8(1, 1), 2, 3)), is(fixed));
    EXPECT_EQ(adapt(gsmCell(Sent(0x4005, 20).u8(0, 0x80).u8(1, 1), 7, 15)), is(fixed));
}

TEST(AdaptGsm, SaysUmtsCellsWhereARankingHoldsBoth) {
    Adapter adapt;
    const Sent fixed = umtsCells(Sent(0x4005, 22).u8(0, 2), 2, 10);
    EXPECT_EQ(adapt(gsmCell(umtsCells(Sent(0x4005, 29).u8(0, 2).u8(1, 1), 2, 10), 22, 0)), is(fixed));
    EXPECT_EQ(adapt.last.leftOut, 1);
    EXPECT_EQ(adapt(gsmCell(umtsCells(Sent(0x4005, 52).u8(0, 0x82).u8(1, 1), 7, 16), 39, 0)), is(fixed));
    EXPECT_EQ(adapt.last.leftOut, 1);
}

TEST(AdaptGsm, RefusesRankingsWhoseCountsDoNotFit) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0x4005, 21).u8(0, 2)), "0x4005 version 0, 21 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x4005, 23).u8(0, 2)), "0x4005 version 0, 23 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x4005, 2).u8(0, 0xC0)), "0x4005 version 3, 2 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x4005, 1)), "0x4005 version 0, 1 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x4005, 2)), "passed");  // no cell at all
    EXPECT_EQ(adapt(Sent(0x4005, 7).u8(0, 0x80)), is(Sent(0x4005, 2)));
}

TEST(AdaptGsm, CutsTheLongCellIdentity) {
    Adapter adapt;
    const Sent fixed = Sent(0x4127, 16).u32(0, 9612).u32(4, 10562).u32(8, 0x0ABCDEF1).u16(12, 17).u16(14, 99);
    EXPECT_EQ(adapt(fixed), "passed");
    EXPECT_EQ(adapt(Sent(0x4127, 32)
                        .u32(0, 9612)
                        .u32(4, 10562)
                        .u32(8, 0x0ABCDEF1)
                        .u16(12, 17)
                        .u16(14, 99)
                        .u32(16, 5)
                        .u32(28, 6)),
              is(fixed));
    EXPECT_EQ(adapt(Sent(0x4127, 20)), "0x4127, 20 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x4127, 15)), "0x4127, 15 bytes: not known");
}

TEST(AdaptGsm, TakesTheSimOffTheTwinsOfTwoSims) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0x5B34, 14).u8(0, 1).u16(1, 512).u16(3, 42).u16(5, 4711)),
              is(Sent(0x5134, 13).u16(0, 512).u16(2, 42).u16(4, 4711)));
    EXPECT_EQ(adapt(Sent(0x5B2C, 5).u8(0, 1).u8(1, 5).u8(2, 1).u8(3, 2).u8(4, 3)),
              is(Sent(0x512C, 4).u8(0, 5).u8(1, 1).u8(2, 2).u8(3, 3)));
    EXPECT_EQ(adapt(Sent(0x5A72, 8).u8(7, 9)), is(Sent(0x5072, 7).u8(6, 9)));
    EXPECT_EQ(adapt(Sent(0x5A76, 5).u8(4, 9)), is(Sent(0x5076, 4).u8(3, 9)));
    EXPECT_EQ(adapt(Sent(0x5B37, 17).u8(16, 9)), is(Sent(0x5137, 16).u8(15, 9)));
    EXPECT_EQ(adapt(Sent(0x5BF4, 3).u8(2, 9)), is(Sent(0x51F4, 2).u8(1, 9)));
    EXPECT_EQ(adapt(Sent(0x5BF5, 6).u8(5, 9)), is(Sent(0x51F5, 5).u8(4, 9)));
    EXPECT_EQ(adapt(Sent(0x5BF6, 12).u8(11, 9)), is(Sent(0x51F6, 11).u8(10, 9)));
    EXPECT_EQ(adapt(Sent(0x5BF8, 3).u8(2, 9)), is(Sent(0x51F8, 2).u8(1, 9)));
    EXPECT_EQ(adapt(Sent(0x5BFB, 22).u8(21, 9)), is(Sent(0x51FB, 21).u8(20, 9)));
    EXPECT_EQ(adapt(Sent(0x5BFD, 23).u8(22, 9)), is(Sent(0x51FD, 22).u8(21, 9)));
    EXPECT_EQ(adapt(Sent(0x5BFF, 3).u8(2, 9)), is(Sent(0x51FF, 2).u8(1, 9)));
    EXPECT_EQ(adapt(Sent(0x5B34, 13)), "0x5B34, 13 bytes: too short");
    EXPECT_EQ(adapt(Sent(0x5B34, 0)), "0x5B34, 0 bytes: too short");
    EXPECT_EQ(adapt(Sent(0x5B38, 40)), "0x5B38, 40 bytes: not a code of Kelvo's");
    EXPECT_EQ(adapt(Sent(0x5B34, 4000)), "0x5B34, 4000 bytes: not known");
}

Sent extendedCells(LogCode code, std::size_t simBytes) {
    const std::size_t p = simBytes;
    return Sent(code, p + 26 + 2 * 25)
        .u16(p, 1023 | 5 << 12)
        .u16(p + 2, 777)
        .u8(p + 4, 3)
        .u8(p + 5, 41)
        .u32(p + 6, 65541)
        .u32(p + 10, 22)
        .u32(p + 14, 33)
        .u32(p + 18, 44)
        .u8(p + 22, 5)
        .u8(p + 23, 1)
        .u8(p + 24, 1)
        .u8(p + 25, 2)
        .u16(p + 26, 512)
        .u8(p + 31, 30)
        .u32(p + 32, 11)
        .u32(p + 36, 12)
        .u8(p + 48, 1)
        .u8(p + 49, 0)
        .u8(p + 50, 1)
        .u16(p + 51, 600)
        .u8(p + 56, 29)
        .u32(p + 57, 0xFFFFFFF0)
        .u32(p + 61, 14)
        .u8(p + 73, 2)
        .u8(p + 74, 1)
        .u8(p + 75, 0);
}

TEST(AdaptGsm, TurnsTheExtendedServingCellAndNeighbors) {
    Adapter adapt;
    const Sent fixed = Sent(0x5137, 16 + 2 * 14)
                           .u16(0, 1023)
                           .u8(2, 41)
                           .u32(3, 65541)
                           .u32(7, 22)
                           .u8(11, 5)
                           .u8(12, 1)
                           .u8(13, 1)
                           .u8(15, 2)
                           .u16(16, 512)
                           .u8(18, 30)
                           .u32(19, 11)
                           .u32(23, 12)
                           .u8(27, 1)
                           .u8(28, 0)
                           .u8(29, 1)
                           .u16(30, 600)
                           .u8(32, 29)
                           .u32(33, 0xFFFFFFF0)
                           .u32(37, 14)
                           .u8(41, 2)
                           .u8(42, 1)
                           .u8(43, 0);
    EXPECT_EQ(adapt(extendedCells(0x51FC, 0)), is(fixed));
    EXPECT_EQ(adapt(extendedCells(0x5BFC, 1)), is(fixed));
    EXPECT_EQ(adapt(fixed), "passed");
    EXPECT_EQ(adapt(Sent(0x51FC, 26 + 25).u8(25, 2)), "0x51FC, 51 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x51FC, 26 + 7 * 25).u8(25, 7)), "0x51FC, 201 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x51FC, 25)), "0x51FC, 25 bytes: not known");
}

// 0x7150. A network is three bytes of packed BCD: 64 F0 70 is 460-07, 62 F2 10 is 262-01, 13 00 14 is 310-410.
Sent networks(std::initializer_list<std::uint32_t> list) {
    Sent sent = Sent(0x7150, 19).u8(0, 0x64).u8(1, 0xF0).u8(2, 0x00).u8(3, static_cast<std::uint32_t>(list.size()));
    for (std::size_t at = 4; at < 19; ++at) sent.u8(at, 0xFF);
    std::size_t at = 4;
    for (const std::uint32_t network : list) {
        sent.u8(at, network >> 16).u8(at + 1, network >> 8 & 255).u8(at + 2, network & 255);
        at += 3;
    }
    return sent;
}
Sent said(std::initializer_list<std::uint32_t> digits, std::uint32_t count) {
    Sent sent = Sent(0x7150, 4 + digits.size()).u8(3, count);
    std::size_t at = 4;
    for (const std::uint32_t digit : digits) sent.u8(at++, digit);
    return sent;
}

TEST(AdaptGsm, SaysAnEquivalentNetwork) {
    Adapter adapt;
    EXPECT_EQ(adapt(networks({0x64F070})), is(said({4, 0, 6, 0, 0, 7}, 1)));  // MCC 460, MNC 007: two digits
    EXPECT_EQ(adapt(networks({0x130014})), is(said({3, 4, 1, 1, 0, 0}, 1)));  // MCC 310, MNC 410
    EXPECT_EQ(adapt(networks({})), is(Sent(0x7150, 4)));
    EXPECT_EQ(adapt.last.leftOut, 0);
}

TEST(AdaptGsm, SaysMoreNetworksWhereTheirDigitsAgree) {
    Adapter adapt;
    // Of 310-434 the next can share 3 (second digit of the MNC), 0 (last of the MCC) and 4 (last of the MNC): a MCC
    // that begins with 34 and a MNC that begins with 0.
    const Sent both = said({3, 4, 1, 3, 0, 4, 1, 0, 2}, 2);
    EXPECT_EQ(adapt(networks({0x134034, 0x432010})), is(both));  // 340-012
    EXPECT_EQ(adapt(networks({0x134034, 0x43F021})), is(both));  // 340-12
    EXPECT_EQ(adapt.last.leftOut, 0);
    EXPECT_EQ(adapt(both), "passed");
    EXPECT_EQ(adapt(networks({0x134034, 0x43F021, 0x64F070})), is(both));
    EXPECT_EQ(adapt.last.leftOut, 1);
    EXPECT_EQ(adapt(networks({0x134034, 0x432011})), is(said({3, 4, 1, 3, 0, 4}, 1)));  // 340-112
    EXPECT_EQ(adapt.last.leftOut, 1);
}

TEST(AdaptGsm, CountsTheNetworksThatDoNotFit) {
    Adapter adapt;
    EXPECT_EQ(adapt(networks({0x64F070, 0x62F210, 0x64F000})), is(said({4, 0, 6, 0, 0, 7}, 1)));
    EXPECT_EQ(adapt.last.leftOut, 2);
    EXPECT_EQ(adapt(networks({0xFFFFFF, 0x62F210})), "0x7150, 19 bytes: the first network is none");
    EXPECT_EQ(adapt(networks({0x6AF070})), "0x7150, 19 bytes: the first network is none");
}

TEST(AdaptGsm, PassesNetworksInTheFixedLayout) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0x7150, 4)), "passed");
    EXPECT_EQ(adapt(said({4, 0, 6, 0, 0, 7}, 1)), "passed");
    EXPECT_EQ(adapt(Sent(0x7150, 19).u8(3, 4)), "passed");
    EXPECT_EQ(adapt(Sent(0x7150, 19).u8(3, 3)), "0x7150, 19 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x7150, 19).u8(0, 0x64).u8(3, 6)), "0x7150, 19 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x7150, 18).u8(0, 0x64).u8(3, 1)), "0x7150, 18 bytes: not known");
    EXPECT_EQ(adapt(Sent(0x7150, 3)), "0x7150, 3 bytes: too short");
}

TEST(AdaptGsm, PassesWhatHasOneLayoutFromItsLeastLengthOn) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0x7130, 3)), "passed");
    EXPECT_EQ(adapt(Sent(0x7131, 3)), "passed");
    EXPECT_EQ(adapt(Sent(0x7132, 2)), "0x7132, 2 bytes: too short");
    EXPECT_EQ(adapt(Sent(0x7135, 43)), "passed");
    EXPECT_EQ(adapt(Sent(0x7135, 18)), "0x7135, 18 bytes: too short");
    EXPECT_EQ(adapt(Sent(0x4116, 3)), "passed");
    EXPECT_EQ(adapt(Sent(0x4125, 1)), "passed");
    EXPECT_EQ(adapt(Sent(0x5134, 13)), "passed");
    EXPECT_EQ(adapt(Sent(0x512C, 4)), "passed");
    EXPECT_EQ(adapt(Sent(0xD0E0, 2)), "passed");
    EXPECT_EQ(adapt(Sent(0xD00A, 7)), "0xD00A, 7 bytes: too short");
}

}  // namespace
}  // namespace kelvo::test
