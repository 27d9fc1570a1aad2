#include "LogGenerator/UTRAN/UTRANNeighbhorMeasurements.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "NeighbhorMeasurements List";

Fed<UTRANNeighbhorMeasurements> emptyList() { return Fed<UTRANNeighbhorMeasurements>(Value(Array::make())); }

/// Holds and reports `count` neighbors of zeros; the lowest bit at 16 is not the count's.
Record neighbors(std::uint32_t count) { return Record(0xD00A, 168 + 16 * count).u8(16, count << 1 | 1); }

TEST(UTRANNeighbhorMeasurements, ShowsOneRowACell) {
    auto section = emptyList();
    section.feed(neighbors(2)
                     .u32(168, 10088 | 100 << 14 | 128 << 21 | 1u << 29 | 1u << 31)
                     .u32(172, 0xFFFFFFFF)
                     .u32(184, 16383 | 127 << 14 | 255 << 21));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(0, "UARFCN"), "10088");
    EXPECT_EQ(section.row(0, "Cell ID"), "100");
    EXPECT_EQ(section.row(0, "Filter RSCP"), "0.500000");
    EXPECT_EQ(section.row(0, "Status"), "MSET");
    EXPECT_EQ(section.row(0, "inJDCS"), "TRUE");
    EXPECT_EQ(section.row(1, "UARFCN"), "16383");
    EXPECT_EQ(section.row(1, "Cell ID"), "127");
    EXPECT_EQ(section.row(1, "Filter RSCP"), "0.996094");
    EXPECT_EQ(section.row(1, "Status"), "ASET");
    EXPECT_EQ(section.row(1, "inJDCS"), "FALSE");
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
}

TEST(UTRANNeighbhorMeasurements, LeavesOutTheStatusItDoesNotKnow) {
    auto section = emptyList();
    section.feed(neighbors(2).u32(168, 2u << 29).u32(184, 3u << 29));
    EXPECT_EQ(section.row(0, "Status"), "DSET");
    EXPECT_EQ(section.row(1, "Status"), "(absent)");
    EXPECT_EQ(section.row(1, "inJDCS"), "FALSE");
    EXPECT_EQ(section.row(1, "Filter RSCP"), "0.000000");
}

TEST(UTRANNeighbhorMeasurements, ReplacesTheRowsOfTheRecordBefore) {
    auto section = emptyList();
    section.feed(neighbors(3));
    section.feed(neighbors(1).u32(168, 7));
    ASSERT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.row(0, "UARFCN"), "7");
    section.feed(Record(0xD00A, 21).u8(16, 1));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST(UTRANNeighbhorMeasurements, KeepsTheRowsWhenARecordIsShortOrOfAnotherCode) {
    auto section = emptyList();
    section.feed(neighbors(2));
    section.clearLog();
    section.feed(Record(0xD00A, 20));
    section.feed(Record(0xD00E, 40));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}}));
}

TEST(UTRANNeighbhorMeasurements, ShowsWhatTheRecordHoldsOfACountThatLies) {
    auto section = emptyList();
    section.feed(Record(0xD00A, 185).u8(16, 255).u8(184, 9));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(1, "UARFCN"), "9");
    section.feed(Record(0xD00A, 21).u8(16, 254));
    EXPECT_EQ(section.rowCount(), 0U);
}

}  // namespace
}  // namespace kelvo
