#include "LogGenerator/GSMUMTS/NeighboringCells.h"

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

Record neighbors(std::uint32_t count) { return Record(0x5137, 29 + 14 * count).u8(28, count); }
constexpr std::size_t at(std::size_t index) { return 29 + 14 * index; }

TEST(NeighboringCells, ShowsTheMeasuredCells) {
    Fed<NeighboringCells> section(Array::make({"row"}));
    section.feed(neighbors(2)
                     .u16(at(0), 975)
                     .u8(at(0) + 2, 60)
                     .u32(at(0) + 3, 65541)
                     .u16(at(1), 65535)
                     .u8(at(1) + 2, 255)
                     .u32(at(1) + 3, 0xFFFFFFFF));
    EXPECT_EQ(section.part(),
              Value(Array::make({Dictionary::make({{"ARFCN", "975"}, {"RSSI", "60"}, {"C1 Value", "65541"}}),
                                 Dictionary::make({{"ARFCN", "65535"}, {"RSSI", "255"}, {"C1 Value", "-1"}})})));
    EXPECT_EQ(section.log(), (Lines{{4, "NeighboringCells"}}));
}

TEST(NeighboringCells, AddsTheIdentityOfCellsThatTheLastIdentityRecordNamed) {
    Fed<NeighboringCells> section(Array::make());
    section.feed(Record(0x51ff, 27).u8(14, 3).u16(15, 975).u8(17, 1).u16(19, 512).u8(21, 63).u16(23, 975).u8(25, 42));
    EXPECT_EQ(section.rowCount(), 0U);
    section.feed(neighbors(3).u16(at(0), 512).u16(at(1), 700).u16(at(2), 975));
    EXPECT_EQ(section.row(0, "BSIC"), "63");
    EXPECT_EQ(section.row(1, "BSIC"), "(absent)");
    EXPECT_EQ(section.row(2, "BSIC"), "42");  // the last of two
    EXPECT_EQ(test::keysOf((*section.part().array())[0]),
              (std::vector<std::string>{"ARFCN", "RSSI", "C1 Value", "BSIC"}));
}

TEST(NeighboringCells, ForgetsTheIdentitiesOfEarlierRecords) {
    Fed<NeighboringCells> section(Array::make());
    section.feed(Record(0x51ff, 19).u8(14, 1).u16(15, 975).u8(17, 42));
    section.feed(Record(0x51ff, 14));  // too short: kept
    section.feed(neighbors(1).u16(at(0), 975));
    EXPECT_EQ(section.row(0, "BSIC"), "42");
    section.feed(Record(0x51ff, 15));
    EXPECT_EQ(section.row(0, "BSIC"), "42");  // the list on the screen stays until it is measured again
    section.feed(neighbors(1).u16(at(0), 975));
    EXPECT_EQ(section.row(0, "BSIC"), "(absent)");
}

TEST(NeighboringCells, IsEmptiedByAMeasurementWithoutNeighbors) {
    Fed<NeighboringCells> section(Array::make({"row"}));
    section.feed(neighbors(0));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST(NeighboringCells, MakesUpNothingBeyondTheEnd) {
    Fed<NeighboringCells> section(Array::make());
    section.feed(Record(0x51ff, 19).u8(14, 255).u16(15, 975).u8(17, 42));
    section.feed(Record(0x5137, 29 + 15).u8(28, 255).u16(29, 975));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(0, "BSIC"), "42");
    EXPECT_EQ(section.row(1, "ARFCN"), "0");
    EXPECT_EQ(section.row(1, "BSIC"), "(absent)");
}

TEST(NeighboringCells, ShowsGsmNeighborsOfTheCellArrayWithTheDoubledLevel) {
    Fed<NeighboringCells> section(Array::make({"row"}));
    section.feed(Record(0x51ff, 19).u8(14, 1).u16(15, 975).u8(17, 42));
    section.clearLog();
    section.feed(cellArray({
        cell("GSM", "Serving", {{"kPLCellMonitorARFCN", 1}, {"kPLCellMonitorRSSI", -1}}),
        cell("GSM", "Neighbor", {{"kPLCellMonitorARFCN", 975}, {"kPLCellMonitorRSSI", -50}}),
        cell("UMTS", "Neighbor", {{"kPLCellMonitorARFCN", 2}, {"kPLCellMonitorRSSI", -2}}),
        cell("GSM", "Neighbor", {{"kPLCellMonitorARFCN", 976}, {"kPLCellMonitorRSSI", 32767}}),
        cell("GSM", "Neighbor"),
    }));
    EXPECT_EQ(section.part(),
              Value(Array::make({Dictionary::make({{"ARFCN", "975"}, {"RSSI", "-100 dBm"}}),
                                 Dictionary::make({{"ARFCN", "976"}, {"RSSI", ""}}), Dictionary::make()})));
    EXPECT_EQ(section.log(), (Lines{{4, "NeighboringCells"},
                                    {3, "NeighboringCells: Failed to retrieve ARFCN\n"},
                                    {3, "NeighboringCells: Failed to retrieve RSSI\n"}}));
}

TEST(NeighboringCells, IsEmptyAfterADamagedCellArrayOrOneWithoutNeighbors) {
    for (const Record& record : {Record(0xff0001, 20), cellArray({}), cellArray({cell("GSM", "Serving")})}) {
        Fed<NeighboringCells> section(Array::make({"row"}));
        section.feed(record);
        EXPECT_EQ(section.rowCount(), 0U);
    }
    Fed<NeighboringCells> section(Array::make({"row"}));
    section.feed(Record(0xff0001, 20));
    EXPECT_EQ(section.log(), (Lines{{4, "NeighboringCells"},
                                    {3, "Cell Info Array data could not be constructed"},
                                    {3, "Failed to get Cell Array\n"}}));
}

TEST(NeighboringCells, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<NeighboringCells> section(Array::make({"row"}));
    section.feed(Record(0x5137, 28));
    section.feed(Record(0x5134, 40));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log(),
              (Lines{{4, "NeighboringCells"}, {4, "NeighboringCells"}, {3, "Received an unknown log message: 20788"}}));
}

}  // namespace
}  // namespace kelvo
