#include "LogGenerator/GSMUMTS/ProcessPS.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

TEST(ProcessPS, NamesEveryState) {
    test::expectNames<ProcessPS>(0x7130, 16, 13, "MM State",
                                 {{0, "GMM_NULL"},
                                  {1, "GMM_DEREGISTERED"},
                                  {2, "GMM_REGISTERED_INITIATED"},
                                  {3, "GMM_REGISTERED"},
                                  {4, "GMM_DEREGISTERED_INITIATED"},
                                  {5, "GMM_ROUTING_AREA_UPDATE_INITIATED"},
                                  {6, "GMM_SERVICE_REQUEST_INITIATED"},
                                  {7, "Unknown"},
                                  {255, "Unknown"}});
}

TEST(ProcessPS, NamesEverySubState) {
    test::expectNames<ProcessPS>(0x7130, 16, 14, "MM Sub State",
                                 {{0, "GMM_NORMAL_SERVICE"},
                                  {1, "GMM_LIMITED_SERVICE"},
                                  {2, "GMM_ATTACH_NEEDED"},
                                  {3, "GMM_ATTEMPTING_TO_ATTACH"},
                                  {4, "GMM_NO_IMSI"},
                                  {5, "GMM_NO_CELL_AVAILABLE"},
                                  {6, "GMM_PLMN_SEARCH"},
                                  {7, "GMM_SUSPENDED"},
                                  {8, "GMM_UPDATE_NEEDED"},
                                  {9, "GMM_ATTEMPING_TO_UPDATE"},
                                  {10, "GMM_ATTEMPTING_TO_UPDATE_MM"},
                                  {11, "GMM_IMSI_DETACH_INITIATED"},
                                  {12, "GMM_NULL_SUBSTATE"},
                                  {13, "Unknown"},
                                  {255, "Unknown"}});
}

TEST(ProcessPS, NamesEveryUpdateStatus) {
    test::expectNames<ProcessPS>(0x7130, 16, 15, "Attach Reject Cause",
                                 {{0, "GMM_GU1_UPDATED"},
                                  {1, "GMM_GU2_NOT_UPDATED"},
                                  {2, "GMM_GU3_PLMN_NOT_ALLOWED"},
                                  {3, "GMM_GU3_ROUTING_AREA_NOT_ALLOWED"},
                                  {4, "Unknown"},
                                  {255, "Unknown"}});
}

TEST(ProcessPS, ShowsTheRegistrationStateBesideItsOwn) {
    Fed<ProcessPS> section(Record(0x7130, 16).u8(13, 3));
    section.feed(Record(0x7132, 16).u8(13, 6));
    EXPECT_EQ(section["MM Service State"], "REG_STATE_OFFLINE");
    EXPECT_EQ(test::keysOf(section.part()),
              (std::vector<std::string>{"MM State", "MM Sub State", "Attach Reject Cause", "MM Service State"}));
    EXPECT_EQ(section.log(), (Lines{{4, "ProcessPS"}, {4, "ProcessPS"}}));
}

TEST(ProcessPS, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<ProcessPS> section(Record(0x7130, 15));
    section.feed(Record(0x7131, 16));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(),
              (Lines{{4, "ProcessPS"}, {4, "ProcessPS"}, {3, "Received an unknown log message: 28977"}}));
}

}  // namespace
}  // namespace kelvo
