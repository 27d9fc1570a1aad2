#include "LogGenerator/UTRAN/TRCHBLERMeasurement.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "TRCH BLER Measurement";

Fed<TRCHBLERMeasurement> emptyList() { return Fed<TRCHBLERMeasurement>(Value(Array::make())); }

TEST(TRCHBLERMeasurement, ShowsOneRowAChannel) {
    auto section = emptyList();
    section.feed(Record(0xD00C, 21).u16(14, 2 << 6 | 0xF03F).u8(17, 4).u8(18, 255).u8(19, 5).u8(20, 12));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(0, "TRCH ID"), "4");
    EXPECT_EQ(section.row(0, "TRCH BLER Measurement"), "255");
    EXPECT_EQ(section.row(1, "TRCH ID"), "5");
    EXPECT_EQ(section.row(1, "TRCH BLER Measurement"), "12");
    EXPECT_EQ(section.log(), (Lines{{5, kTitle}}));
}

TEST(TRCHBLERMeasurement, EmptiesTheListForARecordWithoutChannels) {
    auto section = emptyList();
    section.feed(Record(0xD00C, 19).u16(14, 1 << 6));
    ASSERT_EQ(section.rowCount(), 1U);
    section.feed(Record(0xD00C, 17).u16(14, 0xF03F));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST(TRCHBLERMeasurement, KeepsTheRowsWhenARecordIsShortOrOfAnotherCode) {
    auto section = emptyList();
    section.feed(Record(0xD00C, 19).u16(14, 1 << 6));
    section.clearLog();
    section.feed(Record(0xD00C, 16));
    section.feed(Record(0xD00E, 40));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log(), (Lines{{5, kTitle}, {5, kTitle}}));
}

TEST(TRCHBLERMeasurement, ShowsWhatTheRecordHoldsOfACountThatLies) {
    auto section = emptyList();
    section.feed(Record(0xD00C, 20).u16(14, 63 << 6).u8(19, 5));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(1, "TRCH ID"), "5");
    EXPECT_EQ(section.row(1, "TRCH BLER Measurement"), "0");
}

}  // namespace
}  // namespace kelvo
