#include "LogGenerator/GSMUMTS/BLER.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

Value channel(const char* id, const char* received, const char* inError) {
    return Dictionary::make(
        {{"Transport Channel ID", id}, {"CRC Received", received}, {"CRC Received in Error", inError}});
}

TEST(BLER, ShowsTheCountsOfEveryChannel) {
    Fed<BLER> section(Record(0x4116, 34)
                          .u8(13, 2)
                          .u16(14, 65535)
                          .u8(16, 31)
                          .u32(17, 100000)
                          .u32(21, 12)
                          .u8(25, 255)
                          .u32(26, 0xFFFFFFFF)
                          .u32(30, 0x80000000));
    EXPECT_EQ(section["Window Size"], "65535");
    EXPECT_EQ((*section.part().dictionary())["Transport Channels"],
              Value(Array::make({channel("31", "100000", "12"), channel("255", "-1", "-2147483648")})));
    EXPECT_EQ(section.log(), (Lines{{4, "BLER"}}));
    section.feed(Record(0x4116, 16));
    EXPECT_EQ((*section.part().dictionary())["Transport Channels"], Value(Array::make()));
}

TEST(BLER, MakesUpNoChannelsBeyondTheEnd) {
    Fed<BLER> section(Record(0x4116, 26).u8(13, 255).u8(16, 1).u8(25, 2));
    EXPECT_EQ((*section.part().dictionary())["Transport Channels"],
              Value(Array::make({channel("1", "0", "0"), channel("2", "0", "0")})));
}

TEST(BLER, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<BLER> section(Record(0x4116, 15));
    section.feed(Record(0x4125, 40));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, "BLER"}, {4, "BLER"}, {3, "Received an unknown log message: 16677"}}));
}

}  // namespace
}  // namespace kelvo
