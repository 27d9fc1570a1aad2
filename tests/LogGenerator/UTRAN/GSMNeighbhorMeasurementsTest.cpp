#include "LogGenerator/UTRAN/GSMNeighbhorMeasurements.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "GSM Neighbor Cell List";

Record twoNeighbors() {
    return Record(0xD00E, 33)
        .u8(16, 2)
        .u16(17, 10000 | 1 << 14)
        .u8(19, 5)
        .u8(20, 6)
        .u16(21, 661)
        .u16(23, 0xFFA9)
        .u16(25, 1 << 15);
}

TEST(GSMNeighbhorMeasurements, EmptiesTheListAndLeavesItSo) {
    Fed<GSMNeighbhorMeasurements> section(Array::make({"row"}));
    section.feed(twoNeighbors());
    EXPECT_EQ(section.rowCount(), 0U);
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
}

TEST(GSMNeighbhorMeasurements, KeepsTheListWhenARecordIsShortOrOfAnotherCode) {
    Fed<GSMNeighbhorMeasurements> section(Array::make({"row"}));
    section.feed(twoNeighbors().cut(16), 0xD00E);
    section.feed(Record(0xD00A, 40));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}}));
}

TEST(GSMNeighbhorMeasurements, ReadsOneRowACell) {
    const Record record = twoNeighbors();
    const ArrayRef made = GSMNeighbhorMeasurements::neighbors(record.bytes());
    const Array& rows = *made;
    ASSERT_EQ(rows.size(), 2U);
    EXPECT_EQ(rows[0], Value(Dictionary::make({{"Cell ID", "10000"},
                                               {"Band Indicator", "1"},
                                               {"BSIC Valid", "0"},
                                               {"NCC", "5"},
                                               {"BCC", "6"},
                                               {"ARFCN", "661"},
                                               {"RSSI", "-87"}})));
    EXPECT_EQ((*rows[1].dictionary())["BSIC Valid"], Value("1"));
    EXPECT_EQ((*rows[1].dictionary())["Band Indicator"], Value("0"));
    EXPECT_EQ((*rows[1].dictionary())["Cell ID"], Value("0"));
}

TEST(GSMNeighbhorMeasurements, ReadsNoRowBeyondTheEnd) {
    const Record record = Record(0xD00E, 26).u8(16, 255);
    EXPECT_EQ(GSMNeighbhorMeasurements::neighbors(record.bytes())->size(), 2U);
}

}  // namespace
}  // namespace kelvo
