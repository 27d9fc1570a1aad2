#include "LogGenerator/CDMA/C2K1xStatus.h"

#include <gtest/gtest.h>

#include "tests/support/C2KScreen.h"
#include "tests/support/Subpackets.h"

namespace kelvo {
namespace {

using test::C2KScreen;
using test::Lines;
using test::Record;
using test::Subpackets;

/// The radio as every test here has it unless it says otherwise; open for the sub-packets 3 and 4.
Subpackets status(std::uint32_t state) {
    return Subpackets(0x119c)
        .add(1, 8)
        .u8(4, state)
        .add(2, 16)
        .u8(4, 1)
        .u8(5, 10)
        .u16(6, 325)
        .u16(8, 65535)
        .u8(10, 0x9C)  // -100
        .u8(11, 100)
        .u16(12, 235);
}

Record complete(std::uint32_t state) { return status(state).add(3, 12).add(4, 8); }

TEST(C2K1xStatus, ShowsEveryFieldInTraffic) {
    C2KScreen screen(complete(8));
    EXPECT_EQ(screen["k1xDeviceState"], "Traffic [8]");
    EXPECT_EQ(screen["k1xRx0BandClass"], "1.8 to 2.0GHz PCS band [1]");
    EXPECT_EQ(screen["k1xRx0ChanNum"], "325");
    EXPECT_EQ(screen["k1xRxAGC0"], "-96.65 dBm");  // -33.4 - 63.248
    EXPECT_EQ(screen["k1xRx1BandClass"], "Secondary 800 MHz band [10]");
    EXPECT_EQ(screen["k1xRx1ChanNum"], "65535");
    EXPECT_EQ(screen["k1xRxAGC1"], "-29.85 dBm");  // 33.4 - 63.248
    EXPECT_EQ(screen["k1xTxAGC"], "+23.50 dBm");
    EXPECT_EQ(*screen.list("k1xActiveSetInfo"), *Dictionary::make({{"_sorted", "_sorted"}}));
    EXPECT_EQ(screen.display->size(), 9U);
    EXPECT_EQ(screen.log(), Lines{});
}

TEST(C2K1xStatus, HasNoSecondChainAndNoTransmitterOutsideTraffic) {
    for (std::uint32_t state : {0, 6, 7, 9, 12}) {
        C2KScreen screen(complete(8));
        screen.feed(complete(state));
        EXPECT_EQ(screen["k1xRx0ChanNum"], "325");
        EXPECT_EQ(screen["k1xRxAGC0"], "-96.65 dBm");
        EXPECT_EQ(screen["k1xRx1BandClass"], "N/A") << state;
        EXPECT_EQ(screen["k1xRx1ChanNum"], "N/A") << state;
        EXPECT_EQ(screen["k1xRxAGC1"], "N/A") << state;
        EXPECT_EQ(screen["k1xTxAGC"], "N/A") << state;
    }
}

TEST(C2K1xStatus, NamesStates) {
    const char* const names[] = {"Inactive [0]",
                                 "Deep sleep in start state [1]",
                                 "Initial state for CDMA operation [2]",
                                 "Acquisition [3]",
                                 "Sync [4]",
                                 "Slew [5]",
                                 "Paging [6]",
                                 "Slotted mode sleep state [7]",
                                 "Traffic [8]",
                                 "UnSlew [9]",
                                 "Operation in PCG state [10]",
                                 "Powerup state [11]",
                                 "[Bad Value 12]"};
    for (std::uint32_t state = 0; state < 13; ++state) {
        EXPECT_EQ(C2KScreen(complete(state))["k1xDeviceState"], names[state]);
    }
    EXPECT_EQ(C2KScreen(complete(255))["k1xDeviceState"], "[Bad Value 255]");
}

TEST(C2K1xStatus, PrintsLevelsFromEndToEnd) {
    const auto levels = [](std::uint32_t chain0, std::uint32_t chain1, std::uint32_t transmit) -> Record {
        return Subpackets(0x119c)
            .add(4, 4)
            .add(3, 12)
            .add(2, 14)
            .u8(4, 13)
            .u8(5, 255)
            .u8(10, chain0)
            .u8(11, chain1)
            .u16(12, transmit)
            .add(1, 5)
            .u8(4, 8);
    };
    C2KScreen screen(levels(127, 128, 0x8000));
    EXPECT_EQ(screen["k1xRxAGC0"], "-20.83 dBm");   // 42.418 - 63.248
    EXPECT_EQ(screen["k1xRxAGC1"], "-106.00 dBm");  // -42.752 - 63.248
    EXPECT_EQ(screen["k1xTxAGC"], "-3276.80 dBm");
    EXPECT_EQ(screen["k1xRx0BandClass"], "[Bad Value 13]");
    EXPECT_EQ(screen["k1xRx1BandClass"], "[Bad Value 255]");
    screen.feed(levels(0, 1, 0));
    EXPECT_EQ(screen["k1xRxAGC0"], "-63.25 dBm");
    EXPECT_EQ(screen["k1xRxAGC1"], "-62.91 dBm");
    EXPECT_EQ(screen["k1xTxAGC"], "+0.00 dBm");
    screen.feed(levels(0, 0, 0xFFFF));
    EXPECT_EQ(screen["k1xTxAGC"], "-0.10 dBm");
}

TEST(C2K1xStatus, ChangesNothingWhenASubpacketIsMissing) {
    C2KScreen screen(complete(6));
    screen.state.set("TrafficFER", 0.5);
    screen.feed(status(3).add(3, 12));
    EXPECT_EQ(screen.log(), (Lines{{4, "Log code 0x119c: missing subpacket (ss=1,rf=1,ai=1,fi=0)."}}));
    screen.feed(Subpackets(0x119c).add(2, 16).add(4, 8));
    EXPECT_EQ(screen.log(), (Lines{{4, "Log code 0x119c: missing subpacket (ss=0,rf=1,ai=0,fi=1)."}}));
    screen.feed(Record(0x119c, 17));
    EXPECT_EQ(screen.log(), (Lines{{4, "Log code 0x119c: missing subpacket (ss=0,rf=0,ai=0,fi=0)."}}));
    EXPECT_EQ(screen["k1xDeviceState"], "Paging [6]");
    EXPECT_EQ(screen["k1xTrafficFER"], "(absent)");
    EXPECT_TRUE(screen.state["TrafficFER"]);
}

TEST(C2K1xStatus, KeepsEveryValueOfACompleteRecordWhenTheFingersAreMissing) {
    C2KScreen screen(complete(8));
    screen.state.set("TrafficFER", 0.5);
    screen.feed(Subpackets(0x119c)
                    .add(1, 8)
                    .u8(4, 6)
                    .add(2, 16)
                    .u8(4, 2)
                    .u8(5, 2)
                    .u16(6, 999)
                    .u16(8, 999)
                    .add(3, 26)
                    .u8(8, 1)
                    .u16(12, 7));
    EXPECT_EQ(screen.log(), (Lines{{4, "Log code 0x119c: missing subpacket (ss=1,rf=1,ai=1,fi=0)."}}));
    EXPECT_EQ(screen["k1xDeviceState"], "Traffic [8]");
    EXPECT_EQ(screen["k1xRx0BandClass"], "1.8 to 2.0GHz PCS band [1]");
    EXPECT_EQ(screen["k1xRx0ChanNum"], "325");
    EXPECT_EQ(screen["k1xRxAGC0"], "-96.65 dBm");
    EXPECT_EQ(screen["k1xRx1BandClass"], "Secondary 800 MHz band [10]");
    EXPECT_EQ(screen["k1xRx1ChanNum"], "65535");
    EXPECT_EQ(screen["k1xRxAGC1"], "-29.85 dBm");
    EXPECT_EQ(screen["k1xTxAGC"], "+23.50 dBm");
    EXPECT_EQ(*screen.list("k1xActiveSetInfo"), *Dictionary::make({{"_sorted", "_sorted"}}));
    EXPECT_EQ(screen["k1xTrafficFER"], "(absent)");
    EXPECT_EQ(screen.state["TrafficFER"], Value(0.5));
}

TEST(C2K1xStatus, LooksForEachSubpacketEvenWhenASizeIsBad) {
    Record record = complete(8);
    record.u16(17 + 8 + 16 + 2, 0xFFFF);  // of the active set, which 3 and 4 have to pass
    C2KScreen screen(record);
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code error in subpkt#2: bad size (65535)."},
                                   {3, "Log code error in subpkt#2: bad size (65535)."},
                                   {4, "Log code 0x119c: missing subpacket (ss=1,rf=1,ai=0,fi=0)."}}));
}

TEST(C2K1xStatus, RefusesARecordWithoutRoomForSubpackets) {
    C2KScreen screen(Record(0x119c, 16));
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code 0x119c is 16 bytes long but must be at least 17 bytes."}}));
    EXPECT_TRUE(screen.display->empty());
}

TEST(C2K1xStatus, ReadsSubpacketsThatReachPastTheEndAsZero) {
    Record record = Subpackets(0x119c).add(2, 4).add(3, 4).add(4, 4).add(1, 4);
    record.u16(17 + 12 + 2, 8);  // the state lies right behind the last byte
    C2KScreen screen(record);
    EXPECT_EQ(screen["k1xDeviceState"], "Inactive [0]");
    EXPECT_EQ(screen.log(), Lines{});
}

TEST(C2K1xStatus, ShowsTheErrorRateOfAnEndedCallOnceAsOld) {
    C2KScreen screen;
    screen.state.set("TrafficFER", 0.03125);
    screen.feed(complete(6));
    EXPECT_EQ(screen["k1xTrafficFER"], "3.12% (old)");
    EXPECT_FALSE(screen.state["TrafficFER"]);
    screen.display->set("k1xTrafficFER", "untouched");
    screen.feed(complete(6));
    EXPECT_EQ(screen["k1xTrafficFER"], "untouched");
}

TEST(C2K1xStatus, KeepsTheErrorRateWhileInTraffic) {
    C2KScreen screen;
    screen.state.set("TrafficFER", 0.25);
    screen.feed(complete(8));
    EXPECT_EQ(screen["k1xTrafficFER"], "(absent)");
    EXPECT_EQ(screen.state["TrafficFER"], Value(0.25));
}

TEST(C2K1xStatus, LeavesAnErrorRateThatIsNoNumber) {
    C2KScreen screen;
    screen.state.set("TrafficFER", "0.25");
    screen.feed(complete(0));
    EXPECT_EQ(screen["k1xTrafficFER"], "(absent)");
    EXPECT_EQ(screen.state["TrafficFER"], Value("0.25"));
}

}  // namespace
}  // namespace kelvo
