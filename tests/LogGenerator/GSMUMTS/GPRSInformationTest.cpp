#include "LogGenerator/GSMUMTS/GPRSInformation.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

using test::expectNames;

TEST(GPRSInformation, NamesTheControlOrder) {
    expectNames<GPRSInformation>(
        0x51f5, 18, 15, "Network Control Order",
        {{0, "NC0"}, {1, "NC1"}, {2, "NC2"}, {3, "Unknown"}, {254, "Unknown"}, {255, "Not Available"}});
}

TEST(GPRSInformation, CallsFlowContextsAvailableWhereOthersAreNot) {
    expectNames<GPRSInformation>(0x51f5, 18, 13, "PFC Supported",
                                 {{0, "Not Supported"}, {1, "Supported"}, {2, "Unknown"}, {255, "Available"}});
}

TEST(GPRSInformation, NamesTheAccessThreshold) {
    expectNames<GPRSInformation>(0x51f5, 18, 14, "Priority Access Threshold",
                                 {{0, "Barred (PKT access not allowed in the Cell)"},
                                  {1, "Barred"},
                                  {2, "Barred"},
                                  {3, "1 Only"},
                                  {4, "1 to 2"},
                                  {5, "1 to 3"},
                                  {6, "1 to 4"},
                                  {7, "Allowed"},
                                  {8, "Unknown"},
                                  {254, "Unknown"},
                                  {255, "Not Available"}});
}

TEST(GPRSInformation, NamesTheWaitAfterADownlinkTransfer) {
    expectNames<GPRSInformation>(0x51f6, 24, 15, "T3192",
                                 {{0, "500 ms"},
                                  {1, "1000 ms"},
                                  {2, "1500 ms"},
                                  {3, "0 ms"},
                                  {4, "80 ms"},
                                  {5, "120 ms"},
                                  {6, "160 ms"},
                                  {7, "200 ms"},
                                  {8, "?? ms"},
                                  {9, "?? ms"},
                                  {255, "?? ms"}});
}

TEST(GPRSInformation, ShowsTheCellOptions) {
    Fed<GPRSInformation> section(Record(0x51f6, 24).u8(16, 255).u8(17, 2));
    EXPECT_EQ(section["DRX Timer Max"], "255");
    EXPECT_EQ(section["Access Burst Type"], "11-bit format");
    EXPECT_EQ(test::keysOf(section.part()), (std::vector<std::string>{"T3192", "Access Burst Type", "DRX Timer Max"}));
    section.feed(Record(0x51f6, 24));
    EXPECT_EQ(section["Access Burst Type"], "8-bit format");
    EXPECT_EQ(section.log(), (Lines(2, {4, "GPRSInformation"})));
}

TEST(GPRSInformation, ShowsChannelsAndSystemInformation) {
    Fed<GPRSInformation> section(Record(0x51fb, 34).u8(13, 200));
    section.feed(Record(0x51fd, 35).u8(13, 1).u8(14, 2).u8(15, 3).u8(16, 4).u8(33, 5));
    EXPECT_EQ(section["PBCCH Present"], "200");
    EXPECT_EQ(section["Packet PSI Status"], "1");
    EXPECT_EQ(section["Count LR"], "2");
    EXPECT_EQ(section["Count HR"], "3");
    EXPECT_EQ(section["Ext Measurement Order"], "4");
    EXPECT_EQ(section["Packet SI Status"], "Supported");
    EXPECT_EQ(test::keysOf(section.part()),
              (std::vector<std::string>{"PBCCH Present", "Ext Measurement Order", "Packet PSI Status",
                                        "Packet SI Status", "Count LR", "Count HR"}));
    section.feed(Record(0x51fd, 35));
    EXPECT_EQ(section["Packet SI Status"], "Not Supported");
}

TEST(GPRSInformation, NamesPositionHysteresisAndOperatingMode) {
    expectNames<GPRSInformation>(0x51f4, 15, 14, "SI13 Position",
                                 {{0, "Located on BCCH"},
                                  {1, "Located on Extended BCCH"},
                                  {2, "Unknown"},
                                  {254, "Unknown"},
                                  {255, "Not Available"}});
    expectNames<GPRSInformation>(0x5137, 29, 26, "Cell Reselect Hysteresis",
                                 {{0, "Not Applied"}, {1, "Applied"}, {255, "Applied"}});
    expectNames<GPRSInformation>(0x7135, 32, 13, "Network Operating Mode",
                                 {{0, "Class 1"}, {1, "Class 2"}, {2, "Class 3"}, {3, "Unknown"}, {255, "Unknown"}});
}

TEST(GPRSInformation, WritesTheControlKeysInTheirOrder) {
    Fed<GPRSInformation> section(Record(0x51f5, 18));
    EXPECT_EQ(test::keysOf(section.part()),
              (std::vector<std::string>{"Network Control Order", "PFC Supported", "Priority Access Threshold"}));
}

TEST(GPRSInformation, IgnoresShortRecords) {
    Fed<GPRSInformation> section;
    const std::pair<LogCode, std::size_t> tooShort[] = {{0x51f5, 17}, {0x51f6, 23}, {0x51fb, 33}, {0x51fd, 34},
                                                        {0x51f4, 14}, {0x5137, 28}, {0x7135, 31}};
    for (const auto& [code, size] : tooShort) section.feed(Record(code, size));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines(7, {4, "GPRSInformation"})));
}

TEST(GPRSInformation, ReportsTheRelatedCodesThatItDoesNotRead) {
    const std::pair<LogCode, const char*> others[] = {{0x51f7, "Received an unknown log message: 20983"},
                                                      {0x51f8, "Received an unknown log message: 20984"},
                                                      {0x51f9, "Received an unknown log message: 20985"},
                                                      {0x51fa, "Received an unknown log message: 20986"},
                                                      {0x51fc, "Received an unknown log message: 20988"}};
    for (const auto& [code, line] : others) {
        Fed<GPRSInformation> section(Record(code, 60));
        EXPECT_EQ(section.log(), (Lines{{4, "GPRSInformation"}, {3, line}}));
        EXPECT_TRUE(section.part().dictionary()->empty());
    }
}

}  // namespace
}  // namespace kelvo
