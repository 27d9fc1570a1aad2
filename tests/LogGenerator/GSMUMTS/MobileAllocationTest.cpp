#include "LogGenerator/GSMUMTS/MobileAllocation.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

TEST(MobileAllocation, ShowsTheHoppingSequence) {
    Fed<MobileAllocation> section(Record(0x51f8, 21).u8(13, 63).u8(14, 3).u16(15, 975).u16(17, 0).u16(19, 65535));
    EXPECT_EQ(section["HSN"], "63");
    EXPECT_EQ((*section.part().dictionary())["ARFCNs"], Value(Array::make({"975", "0", "65535"})));
    EXPECT_EQ(section.log(), (Lines{{4, "MobileAllocation"}}));
    section.feed(Record(0x51f8, 15));
    EXPECT_EQ(section["HSN"], "0");
    EXPECT_EQ((*section.part().dictionary())["ARFCNs"], Value(Array::make()));
}

TEST(MobileAllocation, MakesUpNoChannelsBeyondTheEnd) {
    Fed<MobileAllocation> section(Record(0x51f8, 18).u8(14, 255).u16(15, 975).u8(17, 9));
    EXPECT_EQ((*section.part().dictionary())["ARFCNs"], Value(Array::make({"975", "9"})));
}

TEST(MobileAllocation, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<MobileAllocation> section(Record(0x51f8, 14));
    section.feed(Record(0x51f6, 40));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(),
              (Lines{{4, "MobileAllocation"}, {4, "MobileAllocation"}, {3, "Received an unknown log message: 20982"}}));
}

}  // namespace
}  // namespace kelvo
