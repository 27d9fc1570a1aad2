#include "LogGenerator/LTE/LTEServingCellInfo.h"

#include <gtest/gtest.h>

#include "tests/support/CellArray.h"
#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::cell;
using test::cellArray;
using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

TEST(LTEServingCellInfo, ShowsEveryFieldOfTheServingCell) {
    Fed<LTEServingCellInfo> section(Record(0xB0C2, 38)
                                        .u16(14, 301)
                                        .u16(16, 5780)
                                        .u16(18, 23780)
                                        .u8(20, 50)
                                        .u8(21, 100)
                                        .u32(22, 12345678)
                                        .u16(26, 4566)
                                        .u32(28, 17));
    EXPECT_EQ(section["Physical Cell ID"], "301");
    EXPECT_EQ(section["Download Frequency"], "5780");
    EXPECT_EQ(section["Upload Frequency"], "23780");
    EXPECT_EQ(section["Download Bandwidth"], "10 MHz");
    EXPECT_EQ(section["Upload Bandwidth"], "20 MHz");
    EXPECT_EQ(section["Cell Identity"], "12345678");
    EXPECT_EQ(section["Tracking Area Code"], "4566");
    EXPECT_EQ(section["Freq Band Indicator"], "17");
    EXPECT_EQ(
        test::keysOf(section.part()),
        (std::vector<std::string>{"Physical Cell ID", "Download Frequency", "Upload Frequency", "Download Bandwidth",
                                  "Upload Bandwidth", "Cell Identity", "Tracking Area Code", "Freq Band Indicator"}));
    EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"}}));
}

TEST(LTEServingCellInfo, NamesBandwidthsAndCallsAnUnlistedOneUnknown) {
    Fed<LTEServingCellInfo> section(Record(0xB0C2, 38).u8(20, 6).u8(21, 7));
    EXPECT_EQ(section["Download Bandwidth"], "1.4 MHz");
    EXPECT_EQ(section["Upload Bandwidth"], "Unknown");
    section.feed(Record(0xB0C2, 38).u8(20, 15).u8(21, 25));
    EXPECT_EQ(section["Download Bandwidth"], "3 MHz");
    EXPECT_EQ(section["Upload Bandwidth"], "5 MHz");
    section.feed(Record(0xB0C2, 38).u8(20, 75).u8(21, 0));
    EXPECT_EQ(section["Download Bandwidth"], "15 MHz");
    EXPECT_EQ(section["Upload Bandwidth"], "Unknown");
}

TEST(LTEServingCellInfo, PrintsWideValuesAsSigned) {
    Fed<LTEServingCellInfo> section(Record(0xB0C2, 38).u32(22, 0xFFFFFFFE).u32(28, 0x80000000).u16(26, 0xFFFF));
    EXPECT_EQ(section["Cell Identity"], "-2");
    EXPECT_EQ(section["Freq Band Indicator"], "-2147483648");
    EXPECT_EQ(section["Tracking Area Code"], "65535");
}

TEST(LTEServingCellInfo, KeepsTheOldValuesWhenARecordIsOneByteShort) {
    Fed<LTEServingCellInfo> section(Record(0xB0C2, 38).u16(14, 7));
    section.clearLog();
    section.feed(Record(0xB0C2, 37).u16(14, 8));
    EXPECT_EQ(section["Physical Cell ID"], "7");
    EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"}}));
}

TEST(LTEServingCellInfo, ShowsAntennasAndStillReportsTheCode) {
    Fed<LTEServingCellInfo> section(Record(0xB0C1, 22).u8(20, 2));
    EXPECT_EQ(section["Num Tx Antennas"], "2");
    EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"}, {3, "Received an unknown log message: 45249"}}));
    section.clearLog();
    section.feed(Record(0xB0C1, 21).u8(20, 4));
    EXPECT_EQ(section["Num Tx Antennas"], "2");
    EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"}}));
}

TEST(LTEServingCellInfo, ReportsACodeOfOthers) {
    Fed<LTEServingCellInfo> section(Record(0xB179, 40));
    EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"}, {3, "Received an unknown log message: 45433"}}));
    EXPECT_TRUE(section.part().dictionary()->empty());
}

TEST(LTEServingCellInfo, TakesTheFirstServingLteCellOfTheCellArray) {
    Fed<LTEServingCellInfo> section(cellArray({
        cell("GSM", "Serving", {{"kPLCellMonitorTAC", 1}}),
        Dictionary::make(),
        cell("LTE", "Neighbor", {{"kPLCellMonitorTAC", 2}}),
        cell("LTE", "Serving",
             {{"kPLCellMonitorTAC", 4566},
              {"kPLCellMonitorCellId", -5},
              {"kPLCellMonitorPID", 301},
              {"kPLCellMonitorBandInfo", 17},
              {"kPLCellMonitorUARFCN", 5780}}),
        cell("LTE", "Serving", {{"kPLCellMonitorTAC", 3}}),
    }));
    EXPECT_EQ(section["Tracking Area Code"], "4566");
    EXPECT_EQ(section["Cell Identity"], "-5");
    EXPECT_EQ(section["Physical Cell ID"], "301");
    EXPECT_EQ(section["Freq Band Indicator"], "17");
    EXPECT_EQ(section["UARFCN"], "5780");
    EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"}}));
}

TEST(LTEServingCellInfo, SaysWhichValueACellLacksAndShowsTheOthers) {
    Fed<LTEServingCellInfo> section(Record(0xB0C2, 38).u32(22, 99));
    section.clearLog();
    section.feed(cellArray({cell("LTE", "Serving",
                                 {{"kPLCellMonitorTAC", "12"},
                                  {"kPLCellMonitorBandInfo", std::int64_t{2147483648}},
                                  {"kPLCellMonitorPID", 44}})}));
    EXPECT_EQ(section["Cell Identity"], "99");
    EXPECT_EQ(section["Physical Cell ID"], "44");
    EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"},
                                    {3, "Serving Cell Info: Failed to retrieve TAC\n"},
                                    {3, "Serving Cell Info: Failed to retrieve Cell ID\n"},
                                    {3, "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
                                    {3, "Serving Cell Info: Failed to retrieve UARFCN\n"}}));
}

TEST(LTEServingCellInfo, TakesItsOwnFrequenciesOverTheCellArraysUarfcn) {
    Fed<LTEServingCellInfo> section(cellArray({cell("LTE", "Serving", {{"kPLCellMonitorUARFCN", 5780}})}));
    ASSERT_EQ(section["UARFCN"], "5780");
    section.feed(Record(0xB0C2, 38));
    EXPECT_EQ(section["UARFCN"], "(absent)");
}

TEST(LTEServingCellInfo, KeepsTheCellArraysUarfcnWhenARecordIsOneByteShort) {
    Fed<LTEServingCellInfo> section(cellArray({cell("LTE", "Serving", {{"kPLCellMonitorUARFCN", 5780}})}));
    const Value before = section.part().copy();
    section.feed(Record(0xB0C2, 37));
    EXPECT_EQ(section["UARFCN"], "5780");
    EXPECT_EQ(section.part(), before);
}

TEST(LTEServingCellInfo, KeepsItsValuesWhenACellArrayHasNoServingLteCell) {
    Fed<LTEServingCellInfo> section(Record(0xB0C2, 38).u16(14, 301).u32(22, 99).u16(26, 4566));
    section.feed(cellArray({cell("LTE", "Serving", {{"kPLCellMonitorUARFCN", 5780}})}));
    ASSERT_EQ(section["UARFCN"], "5780");
    const Value before = section.part().copy();
    section.clearLog();
    section.feed(cellArray({cell("LTE", "Neighbor", {{"kPLCellMonitorTAC", 1}, {"kPLCellMonitorUARFCN", 2}}),
                            cell("UMTS", "Serving", {{"kPLCellMonitorTAC", 1}, {"kPLCellMonitorUARFCN", 2}})}));
    EXPECT_EQ(section.part(), before);
    EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"}}));
}

TEST(LTEServingCellInfo, SaysWhatACellLacksEvenWithoutAPlaceOnTheScreen) {
    Fed<LTEServingCellInfo> section{Value()};
    section.feed(cellArray({cell("LTE", "Serving")}));
    EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"},
                                    {3, "Serving Cell Info: Failed to retrieve TAC\n"},
                                    {3, "Serving Cell Info: Failed to retrieve Cell ID\n"},
                                    {3, "Serving Cell Info: Failed to retrieve Physical Cell ID\n"},
                                    {3, "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
                                    {3, "Serving Cell Info: Failed to retrieve UARFCN\n"}}));
}

TEST(LTEServingCellInfo, IgnoresAnArrayWithoutAServingLteCell) {
    for (const Record& record : {cellArray({}), cellArray({cell("LTE", "Neighbor")}),
                                 cellArray({cell("UMTS", "Serving")}), cellArray({"cell", 1})}) {
        Fed<LTEServingCellInfo> section(record);
        EXPECT_TRUE(section.part().dictionary()->empty());
        EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"}}));
    }
}

TEST(LTEServingCellInfo, SaysThatACellArrayDoesNotParse) {
    for (const Record& record : {Record(0xFF0001, 13), Record(0xFF0001, 13).text(13, "<plist><array>"),
                                 Record(0xFF0001, 20), Record(0xFF0001, 13).text(13, "bplist00")}) {
        Fed<LTEServingCellInfo> section(record);
        EXPECT_EQ(section.log(), (Lines{{4, "LTE Serving Cell Info"},
                                        {3, "Cell Info Array data could not be constructed"},
                                        {3, "Failed to get Cell Array\n"}}));
    }
}

}  // namespace
}  // namespace kelvo
