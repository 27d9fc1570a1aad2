#include "LogGenerator/GSMUMTS/ProcessCO.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

TEST(ProcessCO, ShowsTheMobilityManagementStateAlone) {
    Fed<ProcessCO> section(Record(0x7131, 16).u8(13, 19).u8(14, 8).u8(15, 1));
    EXPECT_EQ(section["MM State"], "MM_IDLE");
    EXPECT_EQ(test::keysOf(section.part()), std::vector<std::string>{"MM State"});
    section.feed(Record(0x7131, 16).u8(13, 2));
    EXPECT_EQ(section["MM State"], "Unknown");
    section.feed(Record(0x7131, 16).u8(13, 200));
    EXPECT_EQ(section["MM State"], "Unknown");
}

TEST(ProcessCO, ShowsTheRegistrationState) {
    Fed<ProcessCO> section(Record(0x7132, 16).u8(13, 2).u8(14, 1));
    EXPECT_EQ(section["MM Service State"], "REG_STATE_REGISTERING");
    EXPECT_EQ(test::keysOf(section.part()), std::vector<std::string>{"MM Service State"});
}

TEST(ProcessCO, WritesTheTraceWordOfProcessCS) {
    Fed<ProcessCO> section(Record(0x7131, 16));
    EXPECT_EQ(section.log(), (Lines{{4, "ProcessCS"}}));
}

TEST(ProcessCO, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<ProcessCO> section(Record(0x7131, 15));
    section.feed(Record(0x7132, 15));
    section.feed(Record(0x7130, 16));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(
        section.log(),
        (Lines{{4, "ProcessCS"}, {4, "ProcessCS"}, {4, "ProcessCS"}, {3, "Received an unknown log message: 28976"}}));
}

}  // namespace
}  // namespace kelvo
