#include "LogGenerator/CDMA/C2KEVDOStatus.h"

#include <gtest/gtest.h>

#include "tests/support/C2KScreen.h"

namespace kelvo {
namespace {

using test::C2KScreen;
using test::Lines;
using test::Record;

/// 0x1183 in the state Connected.
Record connected() { return Record(0x1183, 50).u8(36, 5); }

TEST(C2KEVDOStatus, ShowsEveryField) {
    C2KScreen screen(connected()
                         .u8(13, 0x2C)
                         .u8(14, 1 << 3 | 3)
                         .u8(15, 0xB5)
                         .u8(16, 0xB0)
                         .u8(17, 23)
                         .u16(18, 168)
                         .u8(37, 4)
                         .u16(38, 0xBEEF)
                         .u8(40, 0x01)
                         .u8(41, 77));
    EXPECT_EQ(screen["kChannel"], "812");  // 3 x 256 + 44
    EXPECT_EQ(screen["k1xEVDODeviceState"], "Connected [5]");
    EXPECT_EQ(screen["kBandClass"], "1.8 to 2.0GHz PCS band [1]");
    EXPECT_EQ(screen["kRxAGC0"], "-75 dBm");
    EXPECT_EQ(screen["kRxAGC1"], "-80 dBm");
    EXPECT_EQ(screen["kTxAGC"], "+23 dBm");
    EXPECT_EQ(screen["kServingPNOffset"], "168 × 64chips");
    EXPECT_EQ(screen["kSessionState"], "Open [4]");
    EXPECT_EQ(screen["kUATI24"], "0x01beef");
    EXPECT_EQ(screen["kColorCode"], "77");
    EXPECT_EQ(screen.display->size(), 10U);
    EXPECT_EQ(screen.log(), Lines{});
}

TEST(C2KEVDOStatus, KeepsChannelAndBandClassApart) {
    C2KScreen screen(connected().u8(13, 0xFF).u8(14, 0x07));
    EXPECT_EQ(screen["kChannel"], "2047");
    EXPECT_EQ(screen["kBandClass"], "800 MHz cellular band [0]");
    screen.feed(connected().u8(14, 0xF8));
    EXPECT_EQ(screen["kChannel"], "0");
    EXPECT_EQ(screen["kBandClass"], "[Bad Value 31]");
}

TEST(C2KEVDOStatus, PrintsLevelsWithTheirSign) {
    C2KScreen screen(connected().u8(15, 0).u8(16, 127).u8(17, 128));
    EXPECT_EQ(screen["kRxAGC0"], "+0 dBm");
    EXPECT_EQ(screen["kRxAGC1"], "+127 dBm");
    EXPECT_EQ(screen["kTxAGC"], "-128 dBm");
}

TEST(C2KEVDOStatus, SaysThatAPnOffsetIsInvalid) {
    C2KScreen screen(connected().u16(18, 65535));
    EXPECT_EQ(screen["kServingPNOffset"], "Invalid Value");
    screen.feed(connected().u16(18, 65534));
    EXPECT_EQ(screen["kServingPNOffset"], "65534 × 64chips");
}

TEST(C2KEVDOStatus, HasNoSecondChainAndNoTransmitterBeforeAccess) {
    for (std::uint32_t state = 0; state < 4; ++state) {
        C2KScreen screen(connected().u8(15, 5).u8(16, 6).u8(17, 7));
        screen.feed(Record(0x1183, 50).u8(36, state).u8(15, 8).u8(16, 9).u8(17, 10));
        EXPECT_EQ(screen["kRxAGC0"], "+8 dBm");
        EXPECT_EQ(screen["kRxAGC1"], "N/A") << state;
        EXPECT_EQ(screen["kTxAGC"], "N/A") << state;
    }
    for (std::uint32_t state : {4, 5, 6, 255}) {
        C2KScreen screen(Record(0x1183, 50).u8(36, state).u8(16, 9).u8(17, 10));
        EXPECT_EQ(screen["kRxAGC1"], "+9 dBm") << state;
        EXPECT_EQ(screen["kTxAGC"], "+10 dBm") << state;
    }
}

TEST(C2KEVDOStatus, NamesDeviceStates) {
    const char* const names[] = {"Inactive [0]", "Acquisition [1]", "Sync [2]",     "Idle [3]",
                                 "Access [4]",   "Connected [5]",   "[Reserved 6]", "[Reserved 7]"};
    for (std::uint32_t state = 0; state < 8; ++state) {
        EXPECT_EQ(C2KScreen(Record(0x1183, 50).u8(36, state))["k1xEVDODeviceState"], names[state]);
    }
    EXPECT_EQ(C2KScreen(Record(0x1183, 50).u8(36, 9))["k1xEVDODeviceState"], "[Reserved 9]");
    EXPECT_EQ(C2KScreen(Record(0x1183, 50).u8(36, 255))["k1xEVDODeviceState"], "[Reserved 255]");
}

TEST(C2KEVDOStatus, NamesSessionStates) {
    const char* const names[] = {"Closed [0]",        "AMP setup [1]", "AT-initiated neg [2]",
                                 "Initiated neg [3]", "Open [4]",      "[Reserved 5]"};
    for (std::uint32_t state = 0; state < 6; ++state) {
        EXPECT_EQ(C2KScreen(connected().u8(37, state))["kSessionState"], names[state]);
    }
}

TEST(C2KEVDOStatus, NamesBandClasses) {
    const char* const names[] = {"800 MHz cellular band [0]",
                                 "1.8 to 2.0GHz PCS band [1]",
                                 "872 to 960MHz TACS band [2]",
                                 "832 to 925MHz JTACS band [3]",
                                 "1.75 to 1.87GHz Korean PCS band [4]",
                                 "450MHz band [5]",
                                 "2GHz band [6]",
                                 "700MHz band [7]",
                                 "1800 MHz band [8]",
                                 "900 MHzband [9]",
                                 "Secondary 800 MHz band [10]",
                                 "400 MHz European PAMR band [11]",
                                 "800 MHz European PAMR band [12]",
                                 "[Bad Value 13]"};
    for (std::uint32_t band = 0; band < 14; ++band) {
        EXPECT_EQ(C2KScreen(connected().u8(14, band << 3))["kBandClass"], names[band]);
    }
}

TEST(C2KEVDOStatus, ReadsTheUatiFromThreeBytes) {
    EXPECT_EQ(C2KScreen(connected().u16(38, 0xFFFF).u8(40, 0xFF).u8(41, 0x12))["kUATI24"], "0xffffff");
    EXPECT_EQ(C2KScreen(connected().u8(41, 0xFF))["kUATI24"], "0x000000");
}

TEST(C2KEVDOStatus, RefusesEveryOtherLength) {
    C2KScreen screen(connected().u8(41, 1));
    for (std::size_t size : {13U, 49U, 51U, 52U}) {
        screen.feed(Record(0x1183, size).u8(12, 9));
        EXPECT_EQ(screen.log(),
                  (Lines{{3, "Log code 0x1183 is " + std::to_string(size) + " bytes long but should be 50 bytes."}}));
    }
    EXPECT_EQ(screen["kColorCode"], "1");
    EXPECT_EQ(screen["k1xEVDODeviceState"], "Connected [5]");
}

}  // namespace
}  // namespace kelvo
