#include "LogGenerator/GSMUMTS/ProcessCS.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

TEST(ProcessCS, NamesEveryMobilityManagementState) {
    test::expectNames<ProcessCS>(0x7131, 16, 13, "MM State",
                                 {{0, "MM_NULL"},
                                  {1, "Unknown"},
                                  {2, "Unknown"},
                                  {3, "MM_LOCATION_UPDATE_INITIATED"},
                                  {4, "Unknown"},
                                  {5, "MM_WAIT_FOR_OUTGOING_MM_CONNECTION"},
                                  {6, "MM_CONNECTION_ACTIVE"},
                                  {7, "MM_IMSI_DETACH_INITIATED"},
                                  {8, "MM_PROCESS_CM_SERVICE_PROMPT"},
                                  {9, "MM_WAIT_FOR_NETWORK_COMMAND"},
                                  {10, "MM_LOCATION_UPDATE_REJECTED"},
                                  {11, "Unknown"},
                                  {12, "Unknown"},
                                  {13, "MM_WAIT_FOR_RR_CONNECTION_LU"},
                                  {14, "MM_WAIT_FOR_RR_CONNECTION_MM"},
                                  {15, "MM_WAIT_FOR_RR_CONNECTION_IMSI_DETACH"},
                                  {16, "Unknown"},
                                  {17, "MM_REESTABLISHMENT_INITIATED"},
                                  {18, "MM_WAIT_FOR_RR_ACTIVE"},
                                  {19, "MM_IDLE"},
                                  {20, "MM_WAIT_FOR_ADDITIONAL_OUTGOING_MM_ CONNECTION"},
                                  {21, "MM_WAIT_FOR_RR_CONNECTION_ REESTABLISHMENT"},
                                  {22, "MM_WAIT_FOR_REESTABLISH_DECISION"},
                                  {23, "MM_LOCATION_UPDATING_PENDING"},
                                  {24, "Unknown"},
                                  {25, "MM_RR_CONNECTION_RELEASE_NOT_ALLOWED"},
                                  {26, "Unknown"},
                                  {200, "Unknown"},
                                  {255, "Unknown"}});
}

TEST(ProcessCS, NamesEverySubState) {
    test::expectNames<ProcessCS>(0x7131, 16, 14, "MM Sub State",
                                 {{0, "MM_NULL_SUBSTATE"},
                                  {1, "MM_NO_IMSI"},
                                  {2, "MM_PLMN_SEARCH"},
                                  {3, "MM_LIMITED_SERVICE"},
                                  {4, "MM_ATTEMPTING_TO_UPDATE"},
                                  {5, "MM_LOCATION_UPDATE_NEEDED"},
                                  {6, "MM_NO_CELL_AVAILABLE"},
                                  {7, "MM_PLMN_SEARCH_NORMAL_SERVICE"},
                                  {8, "MM_NORMAL_SERVICE"},
                                  {9, "Unknown"},
                                  {255, "Unknown"}});
}

TEST(ProcessCS, NamesEveryUpdateStatus) {
    test::expectNames<ProcessCS>(0x7131, 16, 15, "LU Reject Cause",
                                 {{0, "UPDATED"},
                                  {1, "NOT_UPDATED"},
                                  {2, "ROAMING_NOT_ALLOWED"},
                                  {3, "LOCATION_AREA_NOT_ALLOWED"},
                                  {4, "Unknown"},
                                  {255, "Unknown"}});
}

TEST(ProcessCS, NamesEveryRegistrationState) {
    test::expectNames<ProcessCS>(0x7132, 16, 13, "MM Service State",
                                 {{0, "REG_STATE_INACTIVE"},
                                  {1, "REG_STATE_IDLE"},
                                  {2, "REG_STATE_REGISTERING"},
                                  {3, "REG_STATE_DEREGISTERING"},
                                  {4, "REG_STATE_MANUAL_SEARCH"},
                                  {5, "REG_STATE_AUTOMATIC_SEARCH"},
                                  {6, "REG_STATE_OFFLINE"},
                                  {7, "Unknown"},
                                  {255, "Unknown"}});
}

TEST(ProcessCS, WritesTheKeysInTheirOrderAndKeepsThoseOfTheOtherRecord) {
    Fed<ProcessCS> section(Record(0x7131, 16).u8(13, 19));
    section.feed(Record(0x7132, 16).u8(13, 1));
    EXPECT_EQ(test::keysOf(section.part()),
              (std::vector<std::string>{"MM State", "MM Sub State", "LU Reject Cause", "MM Service State"}));
    EXPECT_EQ(section["MM State"], "MM_IDLE");
    EXPECT_EQ(section.log(), (Lines{{4, "ProcessCS"}, {4, "ProcessCS"}}));
}

TEST(ProcessCS, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<ProcessCS> section(Record(0x7131, 15));
    section.feed(Record(0x7132, 15));
    section.feed(Record(0x7130, 16));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log().back(), Lines::value_type(3, "Received an unknown log message: 28976"));
    EXPECT_EQ(section.log().size(), 4U);
}

}  // namespace
}  // namespace kelvo
