#include "LogGenerator/LTE/NeighborCellsList.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "Neighbor Cells List";

Fed<NeighborCellsList> emptyList() { return Fed<NeighborCellsList>(Value(Array::make())); }

/// A record that holds and reports `cells` neighbors, each of zeros.
Record cells(std::size_t cells) {
    return Record(0xB180, 21 + 20 * cells).u16(19, static_cast<std::uint32_t>(cells - 1) << 6);
}

Record oneCell() {
    return cells(1)
        .u32(21, 301 | 120 << 9 | 89 << 17 | 0x3Fu << 26)
        .u32(25, 90 | 78 << 9 | 80 << 16 | 64 << 23 | 3u << 30)
        .u16(29, 65535)
        .u32(33, 1034 | 300000u << 11 | 3u << 30)
        .u32(37, 7 | 9 << 11);
}

TEST(NeighborCellsList, ShowsEveryFieldOfACell) {
    auto section = emptyList();
    section.feed(oneCell());
    ASSERT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.row(0, "Physical Cell ID"), "301");
    EXPECT_EQ(section.row(0, "Measured RSSI"), "-80.00 dBm");
    EXPECT_EQ(section.row(0, "Average RSRP"), "-95.00 dBm");
    EXPECT_EQ(section.row(0, "Measured RSRQ"), "-10.50 dB");
    EXPECT_EQ(section.row(0, "Average RSRQ"), "-10.00 dB");
    EXPECT_EQ(section.row(0, "Srxlev"), "34 dBm");
    EXPECT_EQ(section.row(0, "Frequency Offset"), "65535");
    EXPECT_EQ(section.row(0, "Ant 0 Frame Offset"), "1034");
    EXPECT_EQ(section.row(0, "Ant 0 Sample Offset"), "300000");
}

TEST(NeighborCellsList, CountsTheNeighborsRsrpInHalves) {
    auto section = emptyList();
    section.feed(oneCell());
    EXPECT_EQ(section.row(0, "Measured RSRP"), "-95.50 dBm");  // 89 halves above -140
}

TEST(NeighborCellsList, ShowsAntenna0ForAntenna1AsWell) {
    auto section = emptyList();
    section.feed(oneCell());  // whose last four bytes say something else
    EXPECT_EQ(section.row(0, "Ant 1 Frame Offset"), "1034");
    EXPECT_EQ(section.row(0, "Ant 1 Sample Offset"), "300000");
}

TEST(NeighborCellsList, WritesTheCountAndSixLinesACell) {
    auto section = emptyList();
    section.feed(cells(2)
                     .u32(21, 301 | 120 << 9 | 89 << 17)
                     .u32(25, 90 | 78 << 9 | 80 << 16)
                     .u32(41, 302 | 1 << 9 | 2 << 17)
                     .u32(45, 3 | 1 << 9 | 2 << 16));
    EXPECT_EQ(section.log(), (Lines{{4, kTitle},
                                    {4, "Number of neighboring cells being reported: 2\n"},
                                    {4, "Physical Cell ID: 301\n"},
                                    {4, "Measured RSSI: -80.000000\n"},
                                    {4, "Measured RSSI: -95.500000\n"},
                                    {4, "Measured RSSI: -95.000000\n"},
                                    {4, "Measured RSSI: -10.500000\n"},
                                    {4, "Measured RSSI: -10.000000\n"},
                                    {4, "Physical Cell ID: 302\n"},
                                    {4, "Measured RSSI: -139.500000\n"},
                                    {4, "Measured RSSI: -139.000000\n"},
                                    {4, "Measured RSSI: -138.500000\n"},
                                    {4, "Measured RSSI: -29.750000\n"},
                                    {4, "Measured RSSI: -29.500000\n"}}));
}

TEST(NeighborCellsList, ReportsOneCellWhenTheCountBitsAreZero) {
    auto section = emptyList();
    section.feed(Record(0xB180, 41).u16(19, 0xF83F).u32(21, 17));  // every bit but those of the count
    ASSERT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.row(0, "Physical Cell ID"), "17");
    EXPECT_EQ(section.log()[1].second, "Number of neighboring cells being reported: 1\n");
}

TEST(NeighborCellsList, ReportsUpTo32Cells) {
    auto section = emptyList();
    section.feed(cells(32).u32(21 + 31 * 20, 503));
    ASSERT_EQ(section.rowCount(), 32U);
    EXPECT_EQ(section.row(31, "Physical Cell ID"), "503");
}

TEST(NeighborCellsList, ReplacesTheRowsOfTheRecordBefore) {
    auto section = emptyList();
    section.feed(cells(3));
    section.feed(oneCell());
    ASSERT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.row(0, "Physical Cell ID"), "301");
}

TEST(NeighborCellsList, KeepsTheRowsWhenARecordIsShortOrOfAnotherCode) {
    auto section = emptyList();
    section.feed(oneCell());
    section.clearLog();
    section.feed(oneCell().cut(20), 0xB180);
    section.feed(Record(0xB179, 60));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}, {3, "Received an unknown log message: 45433"}}));
}

TEST(NeighborCellsList, ShowsWhatTheRecordHoldsOfACountThatLies) {
    auto section = emptyList();
    section.feed(Record(0xB180, 42).u16(19, 31 << 6).u32(21, 17).u8(41, 18));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(1, "Physical Cell ID"), "18");
    EXPECT_EQ(section.row(1, "Srxlev"), "-30 dBm");  // beyond the end
    section.clearLog();
    section.feed(Record(0xB180, 21).u16(19, 31 << 6));
    EXPECT_EQ(section.rowCount(), 0U);
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, "Number of neighboring cells being reported: 32\n"}}));
}

}  // namespace
}  // namespace kelvo
