#include <gtest/gtest.h>

#include "tests/telephony/adaptation/Sent.h"

namespace kelvo::test {
namespace {

// Levels in sixteenths: RSRP -95.25 dBm is 1356, -96.375 dBm 1338; RSRQ -8.5 dB 344, -9.1875 dB 333; RSSI -65 dBm 720.
Sent newerIdle(Sent sent, std::size_t pci, std::size_t words) {
    return sent.bits(pci, 0, 8, 301)
        .bits(pci, 9, 15, 5)
        .bits(words, 0, 11, 1356)
        .bits(words + 4, 0, 11, 1338)
        .bits(words + 8, 0, 9, 344)
        .bits(words + 8, 20, 29, 333)
        .bits(words + 12, 10, 20, 720)
        .bits(words + 16, 0, 5, 10)
        .bits(words + 16, 6, 12, 53)
        .bits(words + 16, 13, 18, 52)
        .bits(words + 16, 19, 25, 75)
        .bits(words + 16, 26, 31, 3)
        .bits(words + 20, 0, 5, 31)
        .bits(words + 20, 6, 11, 4)
        .bits(words + 20, 12, 12, 1)
        .bits(words + 20, 13, 16, 11);
}
// The same in the fixed steps: -95.25 dBm, -96.25 dBm (half-way), -8.5 dB, -9.25 dB, -65 dBm, Srxlev 25 dB.
Sent fixedIdle(Sent sent) {
    return sent.bits(6, 0, 8, 301)
        .bits(6, 9, 12, 5)
        .bits(8, 0, 8, 179)
        .bits(8, 9, 17, 175)
        .bits(8, 18, 24, 86)
        .bits(8, 25, 31, 83)
        .bits(12, 0, 8, 150)
        .bits(12, 9, 14, 10)
        .bits(12, 15, 21, 53)
        .bits(12, 22, 27, 52)
        .bits(16, 0, 6, 55)
        .bits(16, 7, 12, 3)
        .bits(16, 13, 18, 31)
        .bits(16, 19, 24, 4)
        .bits(16, 25, 25, 1)
        .bits(16, 26, 29, 11);
}

TEST(AdaptLteIdle, TurnsTheServingCellsMeasurements) {
    Adapter adapt;
    const Sent fixed = fixedIdle(Sent(0xB17F, 20).u8(0, 2).u16(4, 1300));
    EXPECT_EQ(adapt(newerIdle(Sent(0xB17F, 32).u8(0, 3).u16(4, 1300), 6, 8)), is(fixed));
    EXPECT_EQ(adapt(newerIdle(Sent(0xB17F, 32).u8(0, 4).u16(4, 1300), 6, 8)), is(fixed));
    EXPECT_EQ(adapt(newerIdle(Sent(0xB17F, 36).u8(0, 5).u32(4, 1300), 8, 12)), is(fixed));
    EXPECT_EQ(adapt(fixed), "passed");
}

TEST(AdaptLteIdle, ReadsPastTheWordOfRelease9) {
    Adapter adapt;
    const Sent fixed = fixedIdle(Sent(0xB17F, 20).u8(0, 2).u8(1, 1).u16(4, 1300));
    EXPECT_EQ(adapt(newerIdle(Sent(0xB17F, 36).u8(0, 3).u8(1, 1).u16(4, 1300).u32(32, 0xFFFFFFFF), 6, 8)), is(fixed));
    EXPECT_EQ(adapt(newerIdle(Sent(0xB17F, 40).u8(0, 5).u8(1, 1).u32(4, 1300).u32(36, 0xFFFFFFFF), 8, 12)), is(fixed));
}

// A record whose raw numbers are 0: RSSI -110 dBm is 60 half decibels above -140.
Sent silent() { return Sent(0xB17F, 20).u8(0, 2).bits(12, 0, 8, 60); }

TEST(AdaptLteIdle, TurnsSearchThresholdsAndThePriority) {
    Adapter adapt;
    // No threshold is 63 there and 32 here; 64 dB, which would read as none, becomes 66 dB.
    EXPECT_EQ(adapt(Sent(0xB17F, 32).u8(0, 3).bits(28, 0, 5, 63).bits(28, 6, 11, 32).bits(6, 9, 15, 16)),
              is(silent().bits(6, 9, 12, 15).bits(16, 13, 18, 32).bits(16, 19, 24, 33)));
    EXPECT_EQ(adapt(Sent(0xB17F, 32).u8(0, 3).bits(28, 0, 5, 62).bits(28, 6, 11, 33).bits(6, 9, 15, 15)),
              is(silent().bits(6, 9, 12, 15).bits(16, 13, 18, 62).bits(16, 19, 24, 33)));
}

TEST(AdaptLteIdle, MovesSrxlevToItsNewZero) {
    Adapter adapt;
    EXPECT_EQ(adapt(Sent(0xB17F, 32).u8(0, 3).bits(24, 19, 25, 127)),
              is(silent().bits(16, 0, 6, 107)));                                     // 77 dB in both
    EXPECT_EQ(adapt(Sent(0xB17F, 32).u8(0, 3).bits(24, 19, 25, 19)), is(silent()));  // -31 dB: -30
}

// 0xB193 with one part. A body of version 18, 19 or 36 starts at payload offset 8.
Sent container(std::uint32_t partVersion, std::size_t body) {
    return Sent(0xB193, 8 + body)
        .u8(0, 1)
        .u8(1, 1)
        .u8(4, 25)
        .u8(5, partVersion)
        .u16(6, static_cast<std::uint32_t>(4 + body));
}
constexpr std::size_t B = 8;

// A derived record of a cell that nothing else is known of: RSRP -110.0625 dBm, RSRQ -12.3125 dB, RSSI -79.5625 dBm.
Sent neutral(std::uint32_t earfcn, std::uint32_t pci) {
    return Sent(0xB17F, 20)
        .u8(0, 2)
        .u16(4, earfcn)
        .bits(6, 0, 8, pci)
        .bits(8, 0, 8, 120)  // 119.75 quarters above -140
        .bits(8, 9, 17, 120)
        .bits(8, 18, 24, 71)  // 70.75 quarters above -30
        .bits(8, 25, 31, 71)
        .bits(12, 0, 8, 121)   // 120.875 halves above -140
        .bits(12, 15, 21, 64)  // P_Max not present
        .bits(12, 22, 27, 53)  // 23 dBm
        .bits(16, 0, 6, 60)    // Srxlev 29.9375 dB, in whole dB 30
        .bits(16, 13, 18, 32)
        .bits(16, 19, 24, 32);
}

TEST(AdaptLteIdle, DerivesTheServingCellFromPart25Version18) {
    Adapter adapt;
    EXPECT_EQ(adapt(container(18, 92)
                        .u32(B, 1825)
                        .bits(B + 4, 0, 8, 73)
                        .bits(B + 28, 12, 23, 1119)
                        .bits(B + 36, 20, 29, 283)
                        .bits(B + 44, 0, 10, 487)),
              is(neutral(1825, 73)));
    EXPECT_EQ(adapt.last.derivation, adaptation::Adapted::Derivation::Neutral);
}

TEST(AdaptLteIdle, DerivesTheServingCellFromPart25Version19) {
    Adapter adapt;
    const Sent sent = container(19, 360)
                          .u32(B, 1825)
                          .u16(B + 4, 1)
                          .bits(B + 8, 0, 8, 73)
                          .bits(B + 8, 12, 12, 1)
                          .bits(B + 32, 12, 23, 1119)
                          .bits(B + 40, 20, 29, 283)
                          .bits(B + 48, 0, 10, 487);
    EXPECT_EQ(adapt(sent), is(neutral(1825, 73)));

    // The serving cell in the second place, behind a neighbor of the same carrier.
    constexpr std::size_t second = B + 88;
    EXPECT_EQ(adapt(container(19, 360)
                        .u32(B, 1825)
                        .u16(B + 4, 2)
                        .bits(B + 8, 0, 8, 200)
                        .bits(second + 8, 0, 8, 73)
                        .bits(second + 8, 12, 12, 1)
                        .bits(second + 32, 12, 23, 1119)
                        .bits(second + 40, 20, 29, 283)
                        .bits(second + 48, 0, 10, 487)),
              is(neutral(1825, 73)));
}

TEST(AdaptLteIdle, DerivesTheServingCellFromPart25Version36) {
    Adapter adapt;
    // Measured is the combined value, averaged the filtered one: -111.0625 dBm and -13.3125 dB.
    EXPECT_EQ(adapt(container(36, 520)
                        .u32(B, 1825)
                        .u16(B + 4, 1)
                        .u16(B + 6, 3)
                        .bits(B + 8, 0, 8, 73)
                        .bits(B + 8, 12, 12, 1)
                        .bits(B + 40, 0, 11, 1119)
                        .bits(B + 40, 12, 23, 1103)
                        .bits(B + 52, 0, 9, 283)
                        .bits(B + 52, 20, 29, 267)
                        .bits(B + 64, 0, 10, 487)),
              is(neutral(1825, 73).bits(8, 9, 17, 116).bits(8, 25, 31, 67)));
}

TEST(AdaptLteIdle, KeepsSrxlevWithinItsRangeWithoutARealRecord) {
    Adapter adapt;
    EXPECT_EQ(adapt(container(18, 92).u32(B, 1).bits(B + 28, 12, 23, 0)),  // -180 dBm
              is(Sent(0xB17F, 20)
                     .u8(0, 2)
                     .u16(4, 1)
                     .bits(12, 0, 8, 60)
                     .bits(12, 15, 21, 64)
                     .bits(12, 22, 27, 53)
                     .bits(16, 13, 18, 32)
                     .bits(16, 19, 24, 32)));
    adapt(container(18, 92).u32(B, 1).bits(B + 28, 12, 23, 4095));
    EXPECT_EQ(adapt.last.packet[13 + 16] & 127, 127);
    adapt(container(18, 92).u32(B, 1).bits(B + 28, 12, 23, 1128));  // -109.5 dBm: 30.5 dB, the upper of two
    EXPECT_EQ(adapt.last.packet[13 + 16] & 127, 61);
    adapt(container(18, 92).u32(B, 1).bits(B + 28, 12, 23, 1127));
    EXPECT_EQ(adapt.last.packet[13 + 16] & 127, 60);
}

Sent derivedOf73(std::uint32_t rsrp) {
    return container(18, 92).u32(B, 1825).bits(B + 4, 0, 8, 73).bits(B + 28, 12, 23, rsrp);
}

TEST(AdaptLteIdle, CompletesADerivedRecordByTheLastRealOneOfTheCell) {
    Adapter adapt;
    // Real: -100 dBm (160 quarters), Srxlev 20 dB.
    EXPECT_EQ(adapt(Sent(0xB17F, 20)
                        .u8(0, 1)
                        .u16(4, 1825)
                        .bits(6, 0, 8, 73)
                        .bits(6, 9, 12, 6)
                        .bits(8, 0, 8, 160)
                        .bits(12, 9, 14, 8)
                        .bits(12, 15, 21, 50)
                        .bits(12, 22, 27, 49)
                        .bits(16, 0, 6, 50)
                        .bits(16, 7, 12, 4)
                        .bits(16, 13, 18, 29)
                        .bits(16, 19, 24, 5)
                        .bits(16, 25, 25, 1)
                        .bits(16, 26, 29, 9)),
              "passed");
    const auto completed = [](std::uint32_t rsrpQuarters, std::uint32_t srxlev) {
        return Sent(0xB17F, 20)
            .u8(0, 2)
            .u16(4, 1825)
            .bits(6, 0, 8, 73)
            .bits(6, 9, 12, 6)
            .bits(8, 0, 8, rsrpQuarters)
            .bits(8, 9, 17, rsrpQuarters)
            .bits(12, 0, 8, 60)
            .bits(12, 9, 14, 8)
            .bits(12, 15, 21, 50)
            .bits(12, 22, 27, 49)
            .bits(16, 0, 6, srxlev)
            .bits(16, 7, 12, 4)
            .bits(16, 13, 18, 29)
            .bits(16, 19, 24, 5)
            .bits(16, 25, 25, 1)
            .bits(16, 26, 29, 9);
    };
    EXPECT_EQ(adapt(derivedOf73(1280 + 32)), is(completed(168, 52)));  // 2 dB up
    EXPECT_EQ(adapt.last.derivation, adaptation::Adapted::Derivation::Completed);
    // A derived record is never the one that counts: the difference is to the real one.
    EXPECT_EQ(adapt(derivedOf73(1280 + 40)), is(completed(170, 53)));  // 2.5 dB: the upper of two
    EXPECT_EQ(adapt(derivedOf73(1280 - 40)), is(completed(150, 48)));  // -2.5 dB: likewise -2
    EXPECT_EQ(adapt(derivedOf73(1280 - 44)), is(completed(149, 47)));  // -2.75 dB
    EXPECT_EQ(adapt(derivedOf73(640)), is(completed(0, 10)));          // -140 dBm: 40 dB down
    adapt(derivedOf73(640 + 511 * 4));
    EXPECT_EQ(adapt.last.packet[13 + 16] & 127, 127);
}

TEST(AdaptLteIdle, CompletesNoOtherCells) {
    Adapter adapt;
    adapt(Sent(0xB17F, 20).u8(0, 1).u16(4, 1825).bits(6, 0, 8, 74));
    adapt(Sent(0xB17F, 20).u8(0, 1).u16(4, 1826).bits(6, 0, 8, 73));
    adapt(derivedOf73(1280));
    EXPECT_EQ(adapt.last.derivation, adaptation::Adapted::Derivation::Neutral);
}

TEST(AdaptLteIdle, RemembersACellByItsRealChannel) {
    Adapter adapt;
    adapt(Sent(0xB17F, 36).u8(0, 5).u32(4, 66586).bits(8, 0, 8, 73));
    const auto derived = [](std::uint32_t earfcn) { return container(18, 92).u32(B, earfcn).bits(B + 4, 0, 8, 73); };
    adapt(derived(66587));
    EXPECT_EQ(adapt.last.derivation, adaptation::Adapted::Derivation::Neutral);
    EXPECT_EQ(adapt.last.channel, 66587U);
    adapt(derived(66586));
    EXPECT_EQ(adapt.last.derivation, adaptation::Adapted::Derivation::Completed);
    // A record that passes with 65535 does not say which channel it means.
    adapt(Sent(0xB17F, 20).u8(0, 2).u16(4, 65535).bits(6, 0, 8, 73));
    adapt(derived(65535));
    EXPECT_EQ(adapt.last.derivation, adaptation::Adapted::Derivation::Neutral);
}

TEST(AdaptLteIdle, RemembersThe64CellsHeardLast) {
    Adapter adapt;
    const auto real = [](std::uint32_t pci) { return Sent(0xB17F, 20).u8(0, 1).u16(4, 1825).bits(6, 0, 8, pci); };
    const auto derivation = [&](std::uint32_t pci) {
        adapt(container(18, 92).u32(B, 1825).bits(B + 4, 0, 8, pci));
        return adapt.last.derivation;
    };
    for (std::uint32_t pci = 0; pci < 64; ++pci) adapt(real(pci));
    EXPECT_EQ(derivation(0), adaptation::Adapted::Derivation::Completed);  // heard again, so it stays
    adapt(real(64));
    EXPECT_EQ(derivation(0), adaptation::Adapted::Derivation::Completed);
    EXPECT_EQ(derivation(1), adaptation::Adapted::Derivation::Neutral);  // the longest unheard
    EXPECT_EQ(derivation(2), adaptation::Adapted::Derivation::Completed);
}

TEST(AdaptLteIdle, NamesThePartThatItDoesNotKnow) {
    Adapter adapt;
    EXPECT_EQ(adapt(container(59, 520)), "0xB193 version 1, part 25 version 59, 524 bytes: not known");
    EXPECT_EQ(adapt(container(36, 519)), "0xB193 version 1, part 25 version 36, 523 bytes: not known");
    EXPECT_EQ(adapt(container(19, 360).u16(B + 4, 5)), "0xB193 version 1, part 25 version 19, 364 bytes: not known");
    EXPECT_EQ(adapt(container(19, 360).u16(B + 4, 0)), "0xB193 version 1, part 25 version 19, 364 bytes: not known");
    EXPECT_EQ(adapt(container(18, 92).u8(0, 2)), "0xB193 version 2, 100 bytes: not known");
}

TEST(AdaptLteIdle, RefusesARecordWithoutThePrimaryServingCell) {
    Adapter adapt;
    EXPECT_EQ(adapt(container(36, 520).u16(B + 4, 1).bits(B + 8, 9, 11, 1).bits(B + 8, 12, 12, 1)),
              "0xB193 version 1, part 25 version 36, 524 bytes: without the primary serving cell");
    EXPECT_EQ(adapt(container(19, 360).u16(B + 4, 1)),  // not the serving cell
              "0xB193 version 1, part 25 version 19, 364 bytes: without the primary serving cell");
    EXPECT_EQ(adapt(container(18, 92).bits(B + 4, 9, 11, 1)),
              "0xB193 version 1, part 25 version 18, 96 bytes: without the primary serving cell");
}

TEST(AdaptLteIdle, PassesOtherPartsByAndWantsThemToFillTheRecord) {
    Adapter adapt;
    const auto two = [](std::uint32_t firstSize) {
        return Sent(0xB193, 4 + 10 + 96)
            .u8(0, 1)
            .u8(1, 2)
            .u8(4, 22)
            .u8(5, 40)
            .u16(6, firstSize)
            .u8(14, 25)
            .u8(15, 18)
            .u16(16, 96)
            .u32(18, 1825)
            .bits(22, 0, 8, 73)
            .bits(46, 12, 23, 1119)
            .bits(54, 20, 29, 283)
            .bits(62, 0, 10, 487);
    };
    EXPECT_EQ(adapt(two(10)), is(neutral(1825, 73)));
    EXPECT_EQ(adapt(two(9)), "0xB193 version 1, 110 bytes: not known");
    EXPECT_EQ(adapt(two(3)), "0xB193 version 1, 110 bytes: not known");
    EXPECT_EQ(adapt(two(65535)), "0xB193 version 1, 110 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB193, 101).u8(0, 1).u8(1, 1).u8(4, 25).u8(5, 18).u16(6, 96)),  // a byte behind the parts
              "0xB193 version 1, 101 bytes: not known");
    EXPECT_EQ(adapt(Sent(0xB193, 4).u8(0, 1)), "0xB193 version 1, 4 bytes: not known");
}

}  // namespace
}  // namespace kelvo::test
