#include "LogGenerator/GSMUMTS/GSMSet.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

TEST(GSMSet, ShowsTheRanking) {
    Fed<GSMSet> section(Array::make());
    section.feed(Record(0x4005, 29)
                     .u8(14, 2)
                     .u16(15, 975)
                     .u16(17, 42)
                     .u8(19, 0xB0)
                     .u16(20, 0xFFFB)
                     .u16(22, 65535)
                     .u16(24, 65534)
                     .u8(26, 3)
                     .u16(27, 17));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(0, "ARFCN"), "975");
    EXPECT_EQ(section.row(0, "BSIC"), "42");
    EXPECT_EQ(section.row(0, "RSSI"), "-80 dBm");
    EXPECT_EQ(section.row(0, "Ranking Value"), "-5");
    EXPECT_EQ(section.row(1, "ARFCN"), "65535");
    EXPECT_EQ(section.row(1, "BSIC"), "65534");
    EXPECT_EQ(section.row(1, "RSSI"), "3 dBm");
    EXPECT_EQ(section.row(1, "Ranking Value"), "17");
    EXPECT_EQ(section.log(), (Lines{{4, "GSMSet"}}));
}

TEST(GSMSet, ReadsItsCellsWhereTheUmtsCellsBegin) {
    Fed<GSMSet> section(Array::make());
    section.feed(Record(0x4005, 15 + 2 * 10 + 7).u8(13, 2).u8(14, 1).u16(15, 975).u16(35, 976));
    ASSERT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.row(0, "ARFCN"), "975");
}

TEST(GSMSet, IsEmptiedByARankingWithoutGsmCells) {
    Fed<GSMSet> section(Array::make({"row"}));
    section.feed(Record(0x4005, 40).u8(13, 3));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST(GSMSet, MakesUpNoRowsBeyondTheEnd) {
    Fed<GSMSet> section(Array::make());
    section.feed(Record(0x4005, 23).u8(14, 255));
    EXPECT_EQ(section.rowCount(), 2U);
}

TEST(GSMSet, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<GSMSet> section(Array::make({"row"}));
    section.feed(Record(0x4005, 14));
    section.feed(Record(0xff0001, 40));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log(), (Lines{{4, "GSMSet"}, {4, "GSMSet"}, {3, "Received an unknown log message: 16711681"}}));
}

}  // namespace
}  // namespace kelvo
