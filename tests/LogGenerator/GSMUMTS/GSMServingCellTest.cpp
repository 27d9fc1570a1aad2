#include "LogGenerator/GSMUMTS/GSMServingCell.h"

#include <gtest/gtest.h>

#include "tests/support/CellArray.h"
#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

using test::cell;
using test::cellArray;

TEST(GSMServingCell, ShowsTheCellsIdentity) {
    Fed<GSMServingCell> section(Record(0x5134, 26).u16(13, 975).u16(15, 42).u16(17, 65535));
    EXPECT_EQ(section["ARFCN"], "975");
    EXPECT_EQ(section["BSIC"], "42");
    EXPECT_EQ(section["Cell ID"], "65535");
    EXPECT_EQ(test::keysOf(section.part()), (std::vector<std::string>{"Cell ID", "ARFCN", "BSIC"}));
    EXPECT_EQ(section.log(), (Lines{{4, "GSMServingCell"}}));
}

TEST(GSMServingCell, ShowsTheLowHalvesOfTheReselectionCriteria) {
    Fed<GSMServingCell> section(Record(0x5137, 29).u8(15, 200).u32(16, 65541).u32(20, 0xFFFFFFFF));
    EXPECT_EQ(section["RSSI"], "200 dBm");  // unsigned
    EXPECT_EQ(section["C1 Value"], "5");
    EXPECT_EQ(section["C2 Value"], "65535");
    EXPECT_EQ(test::keysOf(section.part()), (std::vector<std::string>{"RSSI", "C1 Value", "C2 Value"}));
}

TEST(GSMServingCell, ShowsTheLowByteOfTheDedicatedChannel) {
    Fed<GSMServingCell> section(Record(0x5076, 17).u16(13, 0x0203));
    EXPECT_EQ(section["MA Dedicated ARFCN"], "3");
    section.feed(Record(0x5076, 17).u16(13, 0x02FF));
    EXPECT_EQ(section["MA Dedicated ARFCN"], "255");
}

TEST(GSMServingCell, TakesTheFirstServingGsmCellOfTheCellArray) {
    Fed<GSMServingCell> section(cellArray({
        cell("UMTS", "Serving", {{"kPLCellMonitorCellId", 1}}),
        cell("GSM", "Neighbor", {{"kPLCellMonitorCellId", 2}}),
        cell("GSM", "Serving",
             {{"kPLCellMonitorCellId", 4711}, {"kPLCellMonitorARFCN", 975}, {"kPLCellMonitorRSSI", -50}}),
        cell("GSM", "Serving", {{"kPLCellMonitorCellId", 3}}),
    }));
    EXPECT_EQ(section.part(), Value(Dictionary::make({{"Cell ID", "4711"}, {"ARFCN", "975"}})));
    EXPECT_EQ(section.log(), (Lines{{4, "GSMServingCell"}}));
}

TEST(GSMServingCell, SaysWhichValueTheServingCellLacks) {
    Fed<GSMServingCell> section(Record(0x5134, 26).u16(13, 975));
    section.clearLog();
    section.feed(cellArray({cell("GSM", "Serving")}));
    EXPECT_EQ(section["ARFCN"], "975");
    EXPECT_EQ(section.log(), (Lines{{4, "GSMServingCell"},
                                    {3, "GSMServingCell: Failed to retrieve Cell ID\n"},
                                    {3, "GSMServingCell: Failed to retrieve ARFCN\n"}}));
}

TEST(GSMServingCell, ChangesNothingWithoutAServingGsmCell) {
    Fed<GSMServingCell> section(cellArray({}));
    section.feed(cellArray({cell("GSM", "Neighbor"), cell("UMTS", "Serving")}));
    EXPECT_EQ(section.log(), (Lines{{4, "GSMServingCell"}, {4, "GSMServingCell"}}));
    section.clearLog();
    section.feed(Record(0xff0001, 20));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, "GSMServingCell"},
                                    {3, "Cell Info Array data could not be constructed"},
                                    {3, "Failed to get Cell Array\n"}}));
}

TEST(GSMServingCell, KeepsItsValuesWhenACellArrayHasNoServingGsmCell) {
    Fed<GSMServingCell> section(Record(0x5134, 26).u16(13, 975).u16(15, 42).u16(17, 4711));
    section.feed(cellArray({cell("GSM", "Serving", {{"kPLCellMonitorCellId", 4712}, {"kPLCellMonitorARFCN", 976}})}));
    const Value before = section.part().copy();
    section.clearLog();
    for (const Value& other : {cell("GSM", "Neighbor", {{"kPLCellMonitorCellId", 1}, {"kPLCellMonitorARFCN", 2}}),
                               cell("UMTS", "Serving", {{"kPLCellMonitorCellId", 3}, {"kPLCellMonitorARFCN", 4}})}) {
        section.feed(cellArray({other}));
    }
    EXPECT_EQ(section.part(), before);
    EXPECT_EQ(section.log(), (Lines(2, {4, "GSMServingCell"})));
}

TEST(GSMServingCell, IgnoresShortRecordsAndReportsACodeOfOthers) {
    Fed<GSMServingCell> section(Record(0x5134, 25));
    section.feed(Record(0x5137, 28));
    section.feed(Record(0x5076, 16));
    EXPECT_EQ(section.log(), (Lines(3, {4, "GSMServingCell"})));
    section.feed(Record(0x51ff, 40));
    EXPECT_EQ(section.log().back(), Lines::value_type(3, "Received an unknown log message: 20991"));
    EXPECT_TRUE(section.part().dictionary()->empty());
}

}  // namespace
}  // namespace kelvo
