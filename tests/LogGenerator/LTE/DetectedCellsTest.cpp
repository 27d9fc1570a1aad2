#include "LogGenerator/LTE/DetectedCells.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "Detected Cells";

Fed<DetectedCells> emptyList() { return Fed<DetectedCells>(Value(Array::make())); }

/// Three detected cells behind two measured ones.
Record threeCells() {
    return Record(0xB179, 47).u8(27, 2).u8(28, 3).u16(29, 900).u16(35, 901).u16(41, 11).u16(43, 12).u16(45, 513);
}

TEST(DetectedCells, FollowTheMeasuredCells) {
    auto section = emptyList();
    section.feed(threeCells());
    ASSERT_EQ(section.rowCount(), 3U);
    EXPECT_EQ(section.row(0, "Physical Cell ID"), "11");
    EXPECT_EQ(section.row(1, "Physical Cell ID"), "12");
    EXPECT_EQ(section.row(2, "Physical Cell ID"), "513");
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
}

TEST(DetectedCells, StartAtOnceWhenNoCellIsMeasured) {
    auto section = emptyList();
    section.feed(Record(0xB179, 33).u8(28, 2).u16(29, 21).u16(31, 22));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(0, "Physical Cell ID"), "21");
    EXPECT_EQ(section.row(1, "Physical Cell ID"), "22");
}

TEST(DetectedCells, EmptiesTheListForARecordWithoutCells) {
    auto section = emptyList();
    section.feed(threeCells());
    section.feed(Record(0xB179, 41).u8(27, 2));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST(DetectedCells, KeepsTheRowsWhenARecordIsShortOrOfAnotherCode) {
    auto section = emptyList();
    section.feed(threeCells());
    section.clearLog();
    section.feed(threeCells().cut(28), 0xB179);
    section.feed(Record(0xB17F, 60));
    EXPECT_EQ(section.rowCount(), 3U);
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}, {3, "Received an unknown log message: 45439"}}));
}

TEST(DetectedCells, ShowsWhatTheRecordHoldsOfACountThatLies) {
    auto section = emptyList();
    section.feed(Record(0xB179, 32).u8(28, 255).u16(29, 21).u8(31, 22));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(1, "Physical Cell ID"), "22");
    section.feed(Record(0xB179, 40).u8(27, 255).u8(28, 255));
    EXPECT_EQ(section.rowCount(), 0U);
}

}  // namespace
}  // namespace kelvo
