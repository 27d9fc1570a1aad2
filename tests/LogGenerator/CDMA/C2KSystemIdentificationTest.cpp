#include "LogGenerator/CDMA/C2KSystemIdentification.h"

#include <gtest/gtest.h>

#include "tests/support/C2KScreen.h"

namespace kelvo {
namespace {

using test::C2KScreen;
using test::Lines;
using test::Record;

Record identification(std::size_t size = 186) { return Record(0x134f, size).u8(13, 2).u32(46, 2); }

TEST(C2KSystemIdentification, ShowsEveryField) {
    C2KScreen screen(identification().u32(42, 1).u16(50, 4139).u16(52, 65535).u8(131, 201).u8(133, 6).u16(184, 30583));
    EXPECT_EQ(screen["k1xRoamingHome"], "ON [1]");
    EXPECT_EQ(screen["kSystemId"], "4139");
    EXPECT_EQ(screen["kNetworkId"], "65535");
    EXPECT_EQ(screen["kPacketZoneId"], "201");
    EXPECT_EQ(screen["kBaseId"], "30583");
    EXPECT_EQ(screen["kProtocolRevision"], "6");
    EXPECT_EQ(screen.display->size(), 6U);
    EXPECT_EQ(screen.log(), Lines{});
}

TEST(C2KSystemIdentification, NamesRoamingIndicators) {
    const char* const names[] = {"OFF [0]",
                                 "ON [1]",
                                 "Flashing [2]",
                                 "Out of Neighborhood [3]",
                                 "Out of Building [4]",
                                 "Preferred system [5]",
                                 "Available system [6]",
                                 "Alliance partner [7]",
                                 "Premium partner [8]",
                                 "Full service functionality [9]",
                                 "Partial service functionality [10]",
                                 "Banner ON [11]",
                                 "Banner OFF [12]",
                                 "ERI - 13"};
    for (std::uint32_t indicator = 0; indicator < 14; ++indicator) {
        EXPECT_EQ(C2KScreen(identification().u32(42, indicator))["k1xRoamingHome"], names[indicator]);
    }
    EXPECT_EQ(C2KScreen(identification().u32(42, 255))["k1xRoamingHome"], "ERI - 255");
    EXPECT_EQ(C2KScreen(identification().u32(42, 0x10001))["k1xRoamingHome"], "ERI - 65537");
    EXPECT_EQ(C2KScreen(identification().u32(42, 0xFFFFFFFF))["k1xRoamingHome"], "ERI - -1");
    EXPECT_EQ(C2KScreen(identification().u32(42, 0x80000000))["k1xRoamingHome"], "ERI - -2147483648");
}

TEST(C2KSystemIdentification, HasIdsForOneTypeOfSystemOnly) {
    C2KScreen screen(identification().u32(46, 1).u16(50, 11).u16(52, 12).u8(131, 13));
    EXPECT_EQ(screen["kSystemId"], "(unknown system type 1)");
    EXPECT_EQ(screen["kNetworkId"], "(unknown system type 1)");
    EXPECT_EQ(screen["kPacketZoneId"], "13");
    screen.feed(identification().u32(46, 0x10002));
    EXPECT_EQ(screen["kSystemId"], "(unknown system type 65538)");
    screen.feed(identification().u32(46, 0xFFFFFFFF));
    EXPECT_EQ(screen["kNetworkId"], "(unknown system type -1)");
}

TEST(C2KSystemIdentification, ReadsTheBaseStationPastTheEndAsZero) {
    C2KScreen screen(identification(171).u8(133, 6));
    EXPECT_EQ(screen["kBaseId"], "0");
    EXPECT_EQ(screen["kProtocolRevision"], "6");
    screen.feed(identification(185).u8(184, 0x34));
    EXPECT_EQ(screen["kBaseId"], "52");
    EXPECT_EQ(screen.log(), Lines{});
}

TEST(C2KSystemIdentification, ChangesNothingForAShortRecordOrAnOldVersion) {
    C2KScreen screen(identification().u16(50, 4139));
    screen.feed(identification(170));
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code 0x134f is 170 bytes long but must be at least 171 bytes."}}));
    screen.feed(identification().u8(13, 1));
    screen.feed(identification().u8(13, 0));
    EXPECT_EQ(screen.log(),
              (Lines{{3, "Log code 0x134f has version=1; only version 2 or higher expected; dropping."},
                     {3, "Log code 0x134f has version=0; only version 2 or higher expected; dropping."}}));
    EXPECT_EQ(screen["kSystemId"], "4139");
    screen.feed(identification().u8(13, 255).u16(50, 1));
    EXPECT_EQ(screen["kSystemId"], "1");
}

}  // namespace
}  // namespace kelvo
