#include <gtest/gtest.h>

#include "tests/telephony/adaptation/Sent.h"

namespace kelvo::test {
namespace {

TEST(AdaptLte, PassesTheFixedLayoutsAsTheyAre) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0xB0C1, 9).u8(0, 1).u16(3, 5780)), "passed");
    EXPECT_EQ(adapt(Sent(0xB0C2, 25).u8(0, 2).u16(3, 5780)), "passed");
    EXPECT_EQ(adapt(Sent(0xB179, 16).u8(0, 1)), "passed");
    EXPECT_EQ(adapt(Sent(0xB179, 16 + 2 * 6 + 3 * 2).u8(0, 2).u8(14, 2).u8(15, 3)), "passed");
    EXPECT_EQ(adapt(Sent(0xB17F, 20).u8(0, 1)), "passed");
    EXPECT_EQ(adapt(Sent(0xB180, 28).u8(0, 3)), "passed");
    EXPECT_EQ(adapt(Sent(0xB180, 8 + 32 * 20).u8(0, 1).bits(6, 6, 10, 31)), "passed");
    EXPECT_EQ(adapt(Sent(0xB186, 8)), "passed");
}

TEST(AdaptLte, TurnsMasterInformation) {
    Adapter adapt;
    const Sent fixed = Sent(0xB0C1, 9).u8(0, 1).u16(1, 503).u16(3, 5780).u16(5, 1020).u8(7, 2).u8(8, 50);
    EXPECT_EQ(adapt(Sent(0xB0C1, 11).u8(0, 2).u16(1, 503).u32(3, 5780).u16(7, 1020).u8(9, 2).u8(10, 50)), is(fixed));
    EXPECT_EQ(adapt(Sent(0xB0C1, 12).u8(0, 3).u16(1, 503).u32(3, 5780).u16(7, 1020).u8(9, 2).u8(10, 50).u8(11, 9)),
              is(fixed));
    EXPECT_EQ(
        adapt(Sent(0xB0C1, 18).u8(0, 17).u16(1, 503).u32(3, 5780).u16(7, 1020).u8(9, 77).u8(17, 2)),
        is(Sent(0xB0C1, 9).u8(0, 1).u16(1, 503).u16(3, 5780).u16(5, 1020).u8(7, 2)));  // narrow-band: no bandwidth
    EXPECT_EQ(adapt(fixed), "passed");
}

TEST(AdaptLte, RefusesLengthsAndVersionsThatItDoesNotKnow) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0xB0C1, 10).u8(0, 1)), "0xB0C1 version 1, 10 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB0C1, 12).u8(0, 2)), "0xB0C1 version 2, 12 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB0C1, 11).u8(0, 4)), "0xB0C1 version 4, 11 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB0C1, 0)), "0xB0C1 version 0, 0 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB0C2, 29).u8(0, 2)), "0xB0C2 version 2, 29 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB0C2, 25).u8(0, 3)), "0xB0C2 version 3, 25 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB17F, 24).u8(0, 1)), "0xB17F version 1, 24 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB17F, 36).u8(0, 5).u8(1, 1)), "0xB17F version 5, 36 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB17F, 36).u8(0, 5).u8(1, 2)), "0xB17F version 5, 36 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB17F, 36).u8(0, 6)), "0xB17F version 6, 36 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB179, 18).u8(0, 1)), "0xB179 version 1, 18 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB179, 40).u8(0, 4)), "0xB179 version 4, 40 bytes: not known");  // 12 bytes behind the counts
    EXPECT_EQ(adapt(Sent(0xB179, 28).u8(0, 5)), "0xB179 version 5, 28 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB180, 27).u8(0, 1)), "0xB180 version 1, 27 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB186, 7)), "0xB186, 7 bytes: too short");
    EXPECT_EQ(adapt(Sent(0xB195, 40)), "0xB195, 40 bytes: not a code of Kelvo's");
}

TEST(AdaptLte, TurnsTheServingCell) {
    Adapter adapt;
    const Sent fixed = Sent(0xB0C2, 25)
                           .u8(0, 2)
                           .u16(1, 73)
                           .u16(3, 1825)
                           .u16(5, 19825)
                           .u8(7, 75)
                           .u8(8, 50)
                           .u32(9, 0x8765F321)
                           .u16(13, 4566)
                           .u32(15, 3)
                           .u16(19, 262)
                           .u8(21, 2)
                           .u16(22, 1)
                           .u8(24, 2);
    EXPECT_EQ(adapt(Sent(0xB0C2, 29)
                        .u8(0, 3)
                        .u16(1, 73)
                        .u32(3, 1825)
                        .u32(7, 19825)
                        .u8(11, 75)
                        .u8(12, 50)
                        .u32(13, 0x8765F321)
                        .u16(17, 4566)
                        .u32(19, 3)
                        .u16(23, 262)
                        .u8(25, 2)
                        .u16(26, 1)
                        .u8(28, 2)),
              is(fixed));
    EXPECT_FALSE(adapt.last.channel);
    EXPECT_EQ(adapt(fixed), "passed");
}

TEST(AdaptLte, SaysAnExtendedChannelAs65535AndTellsIt) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0xB0C2, 29).u8(0, 3).u32(3, 66586).u32(7, 132122)),
              is(Sent(0xB0C2, 25).u8(0, 2).u16(3, 65535).u16(5, 65535)));
    EXPECT_EQ(adapt.last.channel, 66586U);
    EXPECT_EQ(adapt(Sent(0xB0C1, 11).u8(0, 2).u32(3, 65535)), is(Sent(0xB0C1, 9).u8(0, 1).u16(3, 65535)));
    EXPECT_FALSE(adapt.last.channel);
    EXPECT_EQ(adapt(Sent(0xB0C1, 11).u8(0, 2).u32(3, 65536)), is(Sent(0xB0C1, 9).u8(0, 1).u16(3, 65535)));
    EXPECT_EQ(adapt.last.channel, 65536U);
}

TEST(AdaptLte, TurnsConnectedModeMeasurements) {
    Adapter adapt;
    // RSRP -101.3125 dBm is 154.75 quarters above -140, RSRQ -9.9375 dB 80.5 eighths above -20.
    const Sent fixed = Sent(0xB179, 16 + 2 * 6 + 3 * 2)
                           .u8(0, 2)
                           .u16(4, 2075)
                           .u16(6, 100)
                           .u16(8, 10239)
                           .u16(10, 155)
                           .u16(12, 81)
                           .u8(14, 2)
                           .u8(15, 3)
                           .u16(16, 101)
                           .u16(18, 0)
                           .u16(20, 0)  // below what the fixed layout can say
                           .u16(22, 102)
                           .u16(24, 160)
                           .u16(26, 160)  // -100 dBm, 0 dB
                           .u16(28, 11)
                           .u16(30, 12)
                           .u16(32, 503);
    EXPECT_EQ(adapt(Sent(0xB179, 24 + 2 * 12 + 3 * 16)
                        .u8(0, 3)
                        .u16(8, 2075)
                        .u16(10, 100)
                        .u16(12, 10239)
                        .u16(14, 1259)
                        .u16(18, 321)
                        .u8(22, 2)
                        .u8(23, 3)
                        .u16(24, 101)
                        .u16(26, 0xFF00)
                        .u16(30, 0xFFFF)  // negative raw numbers
                        .u16(36, 102)
                        .u16(38, 1280)
                        .u16(42, 480)
                        .u32(48, 11)
                        .u32(64, 12)
                        .u32(80, 503)),
              is(fixed));
    EXPECT_EQ(adapt(Sent(0xB179, 28 + 2 * 12 + 3 * 16)
                        .u8(0, 4)
                        .u32(8, 2075)
                        .u16(12, 100)
                        .u16(14, 10239)
                        .u16(16, 1259)
                        .u16(20, 321)
                        .u8(24, 2)
                        .u8(25, 3)
                        .u16(28, 101)
                        .u16(30, 0xFF00)
                        .u16(34, 0xFFFF)
                        .u16(40, 102)
                        .u16(42, 1280)
                        .u16(46, 480)
                        .u16(52, 11)
                        .u16(54, 0xABCD)
                        .u16(68, 12)
                        .u16(84, 503)),
              is(fixed));
    EXPECT_EQ(adapt(fixed), "passed");
}

TEST(AdaptLte, RefusesSecondaryCellsAndPcisThatDoNotFit) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0xB179, 28).u8(0, 4).u8(4, 1)), "0xB179 version 4, 28 bytes: a secondary cell's");
    EXPECT_EQ(adapt(Sent(0xB179, 24 + 16).u8(0, 3).u8(23, 1).u32(24, 65536)),
              "0xB179 version 3, 40 bytes: an identity that does not fit");
}

TEST(AdaptLte, TakesTheGreatestCountsOfConnectedMode) {
    Adapter adapt;
    const std::string made = adapt(Sent(0xB179, 28 + 255 * 12 + 255 * 16).u8(0, 4).u8(24, 255).u8(25, 255));
    EXPECT_EQ(made.size(), 2U * (13 + 16 + 255 * 6 + 255 * 2));
}

// 0xB180: a header and cells; -100.0625 dBm and so on in sixteenths.
Sent newerNeighbor(Sent sent, std::size_t at) {
    return sent.bits(at, 0, 8, 77)
        .bits(at, 9, 19, 504)
        .bits(at, 20, 31, 1279)  // RSSI -78.5 dBm, RSRP -100.0625 dBm
        .bits(at + 4, 12, 23, 1284)
        .bits(at + 8, 12, 21, 323)
        .bits(at + 12, 0, 9, 322)  // -99.75, -9.8125, -9.875
        .bits(at + 12, 20, 25, 41)
        .u16(at + 16, 54321)
        .bits(at + 20, 0, 10, 2001)
        .bits(at + 20, 11, 29, 300001)
        .bits(at + 24, 0, 10, 1999)
        .bits(at + 24, 11, 29, 299999);
}
Sent fixedNeighbor(Sent sent, std::size_t at) {
    return sent.bits(at, 0, 8, 77)
        .bits(at, 9, 16, 123)
        .bits(at, 17, 25, 80)    // -78.5 dBm, -100 dBm
        .bits(at + 4, 0, 8, 81)  // -99.75: half-way, so -99.5 dBm
        .bits(at + 4, 9, 15, 81)
        .bits(at + 4, 16, 22, 81)  // -9.75 dB; -9.875: half-way, so -9.75
        .bits(at + 4, 23, 29, 41)
        .u16(at + 8, 54321)
        .bits(at + 12, 0, 10, 2001)
        .bits(at + 12, 11, 29, 300001)
        .bits(at + 16, 0, 10, 1999)
        .bits(at + 16, 11, 29, 299999);
}

TEST(AdaptLte, TurnsIdleNeighbors) {
    Adapter adapt;
    const Sent fixed = fixedNeighbor(Sent(0xB180, 28).u8(0, 2).u16(4, 2075).bits(6, 0, 5, 9), 8);
    EXPECT_EQ(adapt(newerNeighbor(Sent(0xB180, 36).u8(0, 4).u16(4, 2075).bits(6, 0, 5, 9).bits(6, 6, 15, 1), 8)),
              is(fixed));
    EXPECT_EQ(
        adapt(newerNeighbor(Sent(0xB180, 40).u8(0, 4).u8(1, 1).u16(4, 2075).bits(6, 0, 5, 9).bits(6, 6, 15, 1), 8)),
        is(fixed));
    EXPECT_EQ(adapt(newerNeighbor(Sent(0xB180, 40).u8(0, 5).u32(4, 2075).bits(8, 0, 5, 9).bits(8, 6, 31, 1), 12)),
              is(fixed));
    EXPECT_EQ(adapt(fixed), "passed");
}

TEST(AdaptLte, LeavesEmptyPlacesForNeighborsOut) {
    Adapter adapt;
    Sent three = Sent(0xB180, 12 + 3 * 28).u8(0, 5).u32(4, 2075).bits(8, 6, 31, 3);
    three = newerNeighbor(three, 12 + 28);
    three.u32(12 + 24, 0xFFFFFFFF);  // behind the first 24 bytes: the place is empty all the same
    EXPECT_EQ(adapt(three), is(fixedNeighbor(Sent(0xB180, 28).u8(0, 2).u16(4, 2075), 8)));

    EXPECT_EQ(adapt(Sent(0xB180, 12 + 28).u8(0, 5).bits(8, 6, 31, 1)),
              "0xB180 version 5, 40 bytes: without a neighbor");
    EXPECT_EQ(adapt(Sent(0xB180, 12).u8(0, 5)), "0xB180 version 5, 12 bytes: without a neighbor");
    EXPECT_EQ(adapt(Sent(0xB180, 12 + 27).u8(0, 5).bits(8, 6, 31, 1)), "0xB180 version 5, 39 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB180, 12).u8(0, 5).bits(8, 6, 31, (1U << 26) - 1)), "0xB180 version 5, 12 bytes: not known");
}

TEST(AdaptLte, SaysUpTo32Neighbors) {
    Adapter adapt;
    Sent full = Sent(0xB180, 8 + 32 * 28).u8(0, 4).bits(6, 6, 15, 32);
    Sent tooMany = Sent(0xB180, 8 + 33 * 28).u8(0, 4).bits(6, 6, 15, 33);
    for (std::size_t i = 0; i < 33; ++i) {
        if (i < 32) full.u8(8 + i * 28, 1);
        tooMany.u8(8 + i * 28, 1);
    }
    adapt(full);
    EXPECT_EQ(adapt.last.packet.size(), 13U + 8 + 32 * 20);
    EXPECT_EQ(adapt.last.packet[13 + 6] >> 6 | (adapt.last.packet[13 + 7] & 7) << 2, 31);
    EXPECT_EQ(adapt(tooMany), "0xB180 version 4, 932 bytes: more than 32 neighbors");
}

TEST(AdaptLte, RefusesPacketsWithoutAHeader) {
    adaptation::RecordAdapter adapter;
    const Bytes bytes(12, 1);
    const adaptation::Adapted adapted = adapter.adapt(bytes);
    EXPECT_EQ(adapted.outcome, adaptation::Adapted::Outcome::Refused);
    EXPECT_EQ(adapted.refusal, adaptation::Refusal::TooShort);
}

TEST(AdaptLte, PassesWhatThePhonesOwnServicesTell) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0xFF0001, 5)), "passed");
    EXPECT_EQ(adapt(Sent(0xFF0000, 0)), "passed");
}

}  // namespace
}  // namespace kelvo::test
