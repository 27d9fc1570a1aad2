#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "CCTRCH SIR Measurement";

Fed<CCTRCHSIRMeasurement> emptyList() { return Fed<CCTRCHSIRMeasurement>(Value(Array::make())); }

/// Reports one channel behind `transportChannels` transport channels.
Record oneChannel(std::uint32_t transportChannels) {
    const std::size_t at = 289 + 34 * transportChannels;
    return Record(0xD00C, 400)
        .u16(14, transportChannels << 6 | 1 << 12)
        .u8(at, 3)
        .u8(at + 1, 4)
        .u32(at + 2, 0xFF030201)
        .u16(at + 6, 0x0605);
}

TEST(CCTRCHSIRMeasurement, ShowsOneRowAChannelWithItsSixTimeslots) {
    const Value expected =
        Dictionary::make({{"CCTRCH ID", "3"}, {"TSNUM", "4"}, {"SIR", Array::make({"1", "2", "3", "255", "5", "6"})}});
    auto section = emptyList();
    section.feed(oneChannel(0));
    ASSERT_EQ(section.rowCount(), 1U);
    EXPECT_EQ((*section.part().array())[0], expected);
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
}

TEST(CCTRCHSIRMeasurement, ReadsBehindTheTransportChannels) {
    auto section = emptyList();
    Record record = oneChannel(2);
    ASSERT_EQ(record.bytes()[357], 3);  // 289 + 2 x 34
    section.feed(record);
    ASSERT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.row(0, "CCTRCH ID"), "3");
}

TEST(CCTRCHSIRMeasurement, ShowsEightBytesAChannel) {
    auto section = emptyList();
    section.feed(Record(0xD00C, 409).u16(14, 15 << 12).u8(289 + 14 * 8, 77).u8(289 + 14 * 8 + 7, 78));
    ASSERT_EQ(section.rowCount(), 15U);
    EXPECT_EQ(section.row(14, "CCTRCH ID"), "77");
    EXPECT_EQ((*(*(*section.part().array())[14].dictionary())["SIR"].array())[5], Value("78"));
}

TEST(CCTRCHSIRMeasurement, EmptiesTheListForARecordWithoutChannels) {
    auto section = emptyList();
    section.feed(oneChannel(0));
    section.feed(Record(0xD00C, 17).u16(14, 0x0FFF));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST(CCTRCHSIRMeasurement, KeepsTheRowsWhenARecordIsShortOrOfAnotherCode) {
    auto section = emptyList();
    section.feed(oneChannel(0));
    section.clearLog();
    section.feed(Record(0xD00C, 16));
    section.feed(Record(0xD00E, 40));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}}));
}

TEST(CCTRCHSIRMeasurement, ShowsWhatTheRecordHoldsOfACountThatLies) {
    auto section = emptyList();
    section.feed(Record(0xD00C, 298).u16(14, 0xF000).u8(297, 9));
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(1, "CCTRCH ID"), "9");
    EXPECT_EQ((*(*(*section.part().array())[1].dictionary())["SIR"].array()).size(), 6U);
    section.feed(Record(0xD00C, 17).u16(14, 0xFFFF));
    EXPECT_EQ(section.rowCount(), 0U);
}

}  // namespace
}  // namespace kelvo
