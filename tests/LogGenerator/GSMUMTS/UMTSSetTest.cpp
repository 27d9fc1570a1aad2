#include "LogGenerator/GSMUMTS/UMTSSet.h"

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

TEST(UMTSSet, ShowsTheRanking) {
    Fed<UMTSSet> section(Array::make());
    section.feed(Record(0x4005, 35)
                     .u8(13, 2)
                     .u16(15, 10562)
                     .u16(17, 301)
                     .u8(19, 0xB0)  // -80
                     .u16(20, 0xFF9C)
                     .u8(22, 0xF1)  // -15
                     .u16(23, 0xFFFB)
                     .u16(25, 0xFFFE)
                     .u16(27, 0xFFFF)
                     .u8(29, 10)
                     .u16(30, 12)
                     .u8(32, 127)
                     .u16(33, 6));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(0, "Downlink Frequency"), "10562");
    EXPECT_EQ(section.row(0, "Scrambling Code"), "301");
    EXPECT_EQ(section.row(0, "RSCP"), "-101 dB");
    EXPECT_EQ(section.row(0, "Rank Cell RSCP"), "-100 dB");
    EXPECT_EQ(section.row(0, "Energy Per Chip"), "-7.500000 dB");
    EXPECT_EQ(section.row(0, "Ranking Value"), "-5");
    EXPECT_EQ(section.row(1, "Downlink Frequency"), "-2");  // signed
    EXPECT_EQ(section.row(1, "Scrambling Code"), "65535");  // not
    EXPECT_EQ(section.row(1, "RSCP"), "-11 dB");
    EXPECT_EQ(section.row(1, "Rank Cell RSCP"), "12 dB");
    EXPECT_EQ(section.row(1, "Energy Per Chip"), "63.500000 dB");
    EXPECT_EQ(section.row(1, "Ranking Value"), "6");
    EXPECT_EQ(test::keysOf((*section.part().array())[0]),
              (std::vector<std::string>{"Scrambling Code", "RSCP", "Energy Per Chip", "Downlink Frequency",
                                        "Ranking Value", "Rank Cell RSCP"}));
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSSet"}}));
}

TEST(UMTSSet, ShowsTheEnergyInSignedHalves) {
    Fed<UMTSSet> section(Array::make());
    section.feed(Record(0x4005, 25).u8(13, 1).u8(22, 0xFF));
    EXPECT_EQ(section.row(0, "Energy Per Chip"), "-0.500000 dB");
    section.feed(Record(0x4005, 25).u8(13, 1).u8(22, 0x00));
    EXPECT_EQ(section.row(0, "Energy Per Chip"), "0.000000 dB");
    section.feed(Record(0x4005, 25).u8(13, 1).u8(22, 0x80));
    EXPECT_EQ(section.row(0, "Energy Per Chip"), "-64.000000 dB");
}

TEST(UMTSSet, IsEmptiedByARankingWithoutUmtsCells) {
    Fed<UMTSSet> section(Array::make({"row"}));
    section.feed(Record(0x4005, 40).u8(14, 3));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST(UMTSSet, MakesUpNoRowsBeyondTheEnd) {
    Fed<UMTSSet> section(Array::make());
    section.feed(Record(0x4005, 26).u8(13, 255));
    EXPECT_EQ(section.rowCount(), 2U);
}

TEST(UMTSSet, ShowsUmtsNeighborsOfTheCellArray) {
    Fed<UMTSSet> section(Array::make({"row"}));
    section.feed(cellArray({
        cell("UMTS", "Serving", {{"kPLCellMonitorSCN", 1}}),
        cell("UMTS", "Neighbor",
             {{"kPLCellMonitorUARFCN", 10562},
              {"kPLCellMonitorSCN", 301},
              {"kPLCellMonitorRSCP", -98},
              {"kPLCellMonitorECN0", -11}}),
        cell("GSM", "Neighbor", {{"kPLCellMonitorSCN", 2}}),
        Dictionary::make({{"kPLCellMonitorCellType", "kPLCellMonitorCellTypeNeighbor"}}),
        cell("UMTS", "Neighbor",
             {{"kPLCellMonitorUARFCN", 10563},
              {"kPLCellMonitorSCN", 32767},
              {"kPLCellMonitorRSCP", 32767},
              {"kPLCellMonitorECN0", 32767}}),
    }));
    EXPECT_EQ(
        section.part(),
        Value(Array::make(
            {Dictionary::make(
                 {{"UARFCN", "10562"}, {"Scrambling Code", "301"}, {"RSCP", "-98 dBm"}, {"Energy Per Chip", "-11 dB"}}),
             Dictionary::make(
                 {{"UARFCN", "10563"}, {"Scrambling Code", "32767"}, {"RSCP", ""}, {"Energy Per Chip", ""}})})));
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSSet"}}));
}

TEST(UMTSSet, AddsANeighborWithoutTheValuesThatItLacks) {
    Fed<UMTSSet> section(Array::make());
    section.feed(cellArray({cell("UMTS", "Neighbor"), cell("UMTS", "Neighbor", {{"kPLCellMonitorSCN", 5}})}));
    EXPECT_EQ(section.part(), Value(Array::make({Dictionary::make(), Dictionary::make({{"Scrambling Code", "5"}})})));
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSSet"},
                                    {3, "UMTSSet: Failed to retrieve UARFCN\n"},
                                    {3, "UMTSSet: Failed to retrieve Scrambling Code\n"},
                                    {3, "UMTSSet: Failed to retrieve RSCP\n"},
                                    {3, "UMTSSet: Failed to retrieve Energy Per Chip\n"},
                                    {3, "UMTSSet: Failed to retrieve UARFCN\n"},
                                    {3, "UMTSSet: Failed to retrieve RSCP\n"},
                                    {3, "UMTSSet: Failed to retrieve Energy Per Chip\n"}}));
}

TEST(UMTSSet, IsEmptiedByACellArrayWithoutUmtsNeighbors) {
    Fed<UMTSSet> section(Array::make({"row"}));
    section.feed(cellArray({cell("GSM", "Neighbor")}));
    EXPECT_EQ(section.rowCount(), 0U);
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSSet"}}));
}

/// Notes how many rows a list holds when each error is reported.
class Watch final : public SystemLog {
public:
    explicit Watch(ArrayRef list) : _list(std::move(list)) {}
    bool wants(Level level) const override { return level == Level::Error; }
    void write(Level, std::string_view) override { rows.push_back(_list->size()); }
    std::vector<std::size_t> rows;

private:
    ArrayRef _list;
};

TEST(UMTSSet, IsEmptyWhenItReportsADamagedCellArray) {
    const ArrayRef list = Array::make({"row"});
    Fed<UMTSSet> section{Value(list)};
    Watch watch(list);
    {
        const Environment::Scope environment({.log = &watch});
        section.section().updateWithData(Record(0xff0001, 20).bytes(), 0xff0001);
    }
    EXPECT_EQ(watch.rows, (std::vector<std::size_t>{0, 0}));

    section.feed(Record(0xff0001, 20));
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSSet"},
                                    {3, "Cell Info Array data could not be constructed"},
                                    {3, "Failed to get Cell Array\n"}}));
}

TEST(UMTSSet, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<UMTSSet> section(Array::make({"row"}));
    section.feed(Record(0x4005, 14));
    section.feed(Record(0x417a, 40));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSSet"}, {4, "UMTSSet"}, {3, "Received an unknown log message: 16762"}}));
}

}  // namespace
}  // namespace kelvo
