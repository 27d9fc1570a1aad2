#include <gtest/gtest.h>

#include <vector>

#include "telephony/adaptation/StandIns.h"

namespace kelvo::adaptation {
namespace {

std::vector<LogCode> standIns(LogCode code) {
    const auto codes = standInsFor(code);
    return {codes.begin(), codes.end()};
}

TEST(StandIns, NameWhatNewerModemsSendInstead) {
    EXPECT_EQ(standIns(0xB17F), (std::vector<LogCode>{0xB193}));
    EXPECT_EQ(standIns(0x5134), (std::vector<LogCode>{0x5B34}));
    EXPECT_EQ(standIns(0x5137), (std::vector<LogCode>{0x51FC, 0x5B37, 0x5BFC}));
    EXPECT_EQ(standIns(0x512C), (std::vector<LogCode>{0x5B2C}));
    EXPECT_TRUE(standIns(0xB0C2).empty());
    EXPECT_TRUE(standIns(0xFF0001).empty());
}

TEST(StandIns, KnowTheCodesOfTwoSims) {
    EXPECT_EQ(withoutSim(0x5B34), 0x5134U);
    EXPECT_EQ(withoutSim(0x5A72), 0x5072U);
    EXPECT_EQ(withoutSim(0x5BFC), 0x51FCU);
    EXPECT_EQ(withoutSim(0x5134), 0x5134U);
    EXPECT_EQ(withoutSim(0x5B35), 0x5B35U);
    EXPECT_EQ(withoutSim(0xBB7F), 0xBB7FU);
}

}  // namespace
}  // namespace kelvo::adaptation
