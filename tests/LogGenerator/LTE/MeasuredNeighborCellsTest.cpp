#include "LogGenerator/LTE/MeasuredNeighborCells.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "Measured Neighbor Cells";

Fed<MeasuredNeighborCells> emptyList() { return Fed<MeasuredNeighborCells>(Value(Array::make())); }

/// Two measured cells at 29 and 35, with three detected ones behind them.
Record twoCells() {
    return Record(0xB179, 47)
        .u8(27, 2)
        .u8(28, 3)
        .u16(29, 301)
        .u16(31, 123)
        .u16(33, 77)
        .u16(35, 65535)
        .u16(37, 0)
        .u16(39, 160)
        .u16(41, 900);
}

TEST(MeasuredNeighborCells, ShowsOneRowACell) {
    auto section = emptyList();
    section.feed(twoCells());
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(0, "Physical Cell ID"), "301");
    EXPECT_EQ(section.row(0, "Filtered RSRP"), "-109.25 dBm");
    EXPECT_EQ(section.row(0, "Filtered RSRQ"), "-10.38 dB");
    EXPECT_EQ(section.row(1, "Physical Cell ID"), "65535");
    EXPECT_EQ(section.row(1, "Filtered RSRP"), "-140.00 dBm");
    EXPECT_EQ(section.row(1, "Filtered RSRQ"), "0.00 dB");
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
}

TEST(MeasuredNeighborCells, EmptiesTheListForARecordWithoutCells) {
    auto section = emptyList();
    section.feed(twoCells());
    section.feed(Record(0xB179, 35).u8(28, 3));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST(MeasuredNeighborCells, ReplacesTheRowsOfTheRecordBefore) {
    auto section = emptyList();
    section.feed(twoCells());
    section.feed(Record(0xB179, 35).u8(27, 1).u16(29, 7));
    ASSERT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.row(0, "Physical Cell ID"), "7");
}

TEST(MeasuredNeighborCells, KeepsTheRowsWhenARecordIsShortOrOfAnotherCode) {
    auto section = emptyList();
    section.feed(twoCells());
    section.clearLog();
    section.feed(twoCells().cut(28), 0xB179);
    section.feed(Record(0xB180, 60));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}, {3, "Received an unknown log message: 45440"}}));
}

TEST(MeasuredNeighborCells, ShowsWhatTheRecordHoldsOfACountThatLies) {
    auto section = emptyList();
    section.feed(Record(0xB179, 37).u8(27, 255).u16(29, 301).u16(35, 302));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(1, "Physical Cell ID"), "302");
    EXPECT_EQ(section.row(1, "Filtered RSRP"), "-140.00 dBm");  // beyond the end
    section.feed(Record(0xB179, 29).u8(27, 255));
    EXPECT_EQ(section.rowCount(), 0U);
}

}  // namespace
}  // namespace kelvo
