#include "LogGenerator/GSMUMTS/GSMRRInfo.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

TEST(GSMRRInfo, NamesEveryState) {
    test::expectNames<GSMRRInfo>(0x512c, 17, 13, "RR State",
                                 {{0, "RR_INACTIVE"},
                                  {1, "RR_GOING_ACTIVE"},
                                  {2, "RR_GOING_INACTIVE"},
                                  {3, "RR_CELL_SELECTION"},
                                  {4, "RR_PLMN_LIST_CONSTRUCTION"},
                                  {5, "RR_IDLE"},
                                  {6, "RR_CELL_RESELECTION"},
                                  {7, "RR_CONNECTION_PENDING"},
                                  {8, "RR_CHOOSE_CELL"},
                                  {9, "RR_DATA_TRANSFER"},
                                  {10, "RR_NO_CHANNELS"},
                                  {11, "RR_CONNECTION_RELEASE"},
                                  {12, "RR_EARLY_CAMPED_WAIT_FOR_SI"},
                                  {13, "RR_W2G_INTERRAT_HANDOVER_ PROGRESS"},
                                  {14, "RR_W2G_INTERRAT_RESELECTION_PROGRESS"},
                                  {15, "RR_WAIT_FOR_EARLY_PSCAN"},
                                  {16, "GRR51"},
                                  {17, "GRR52"},
                                  {18, "RR_G2W_INTERRAT_RESELECTION_PROGRESS"},
                                  {19, "RR_G2W_INTERRAT_HANDOVER_ PROGRESS"},
                                  {20, "RR_CELL_REEST"},
                                  {21, "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS"},
                                  {22, "Unknown"},
                                  {255, "Unknown"}});
}

TEST(GSMRRInfo, ShowsSubStateStatusAndMode) {
    Fed<GSMRRInfo> section(Record(0x512c, 17).u8(14, 200).u8(15, 7).u8(16, 9));
    EXPECT_EQ(section["RR Sub State"], "200");
    EXPECT_EQ(section["RR Status"], "7");
    EXPECT_EQ(section["RR Mode"], "Data");
    EXPECT_EQ(test::keysOf(section.part()),
              (std::vector<std::string>{"RR State", "RR Sub State", "RR Status", "RR Mode"}));
    section.feed(Record(0x512c, 17));
    EXPECT_EQ(section["RR Mode"], "Voice");
    EXPECT_EQ(section.log(), (Lines(2, {4, "GSMRRInfo"})));
}

TEST(GSMRRInfo, ShowsTheMeasurementsWhole) {
    Fed<GSMRRInfo> section(Record(0x5137, 29).u8(15, 200).u32(16, 65541).u32(20, 0xFFFFFFFF));
    EXPECT_EQ(section["Serving Rx Level"], "200");
    EXPECT_EQ(section["Rx Quality Full"], "65541");
    EXPECT_EQ(section["Rx Quality Sub"], "-1");
}

TEST(GSMRRInfo, ShowsDiscontinuousTransmissionAndReception) {
    test::expectNames<GSMRRInfo>(0x5072, 20, 19, "DTX Used", {{0, "OFF"}, {1, "ON"}, {255, "ON"}});
    test::expectNames<GSMRRInfo>(0x51f6, 24, 16, "DRX Used", {{0, "0 sec"}, {4, "4 sec"}, {255, "255 sec"}});
}

TEST(GSMRRInfo, IgnoresShortRecordsAndReportsACodeOfOthers) {
    Fed<GSMRRInfo> section(Record(0x512c, 16));
    section.feed(Record(0x5137, 28));
    section.feed(Record(0x5072, 19));
    section.feed(Record(0x51f6, 23));
    EXPECT_EQ(section.log(), (Lines(4, {4, "GSMRRInfo"})));
    section.feed(Record(0x5134, 40));
    EXPECT_EQ(section.log().back(), Lines::value_type(3, "Received an unknown log message: 20788"));
    EXPECT_TRUE(section.part().dictionary()->empty());
}

}  // namespace
}  // namespace kelvo
