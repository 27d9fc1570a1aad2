#include "overview/Words.h"

#include <gtest/gtest.h>

namespace kelvo::overview {
namespace {

using namespace std::chrono_literals;

std::optional<Measure> level(const char* name, double number, const char* unit) {
    return Measure{.name = name, .figure = {.text = "", .number = number, .unit = unit, .record = 1}, .grade = ""};
}

TEST(OverviewWords, AnAgeIsInSecondsThenMinutesThenHoursThenDays) {
    const Time then{};
    EXPECT_EQ(ageText(then, then + 3s), "3 s ago");
    EXPECT_EQ(ageText(then, then + 119s), "119 s ago");
    EXPECT_EQ(ageText(then, then + 120s), "2 min ago");
    EXPECT_EQ(ageText(then, then + 2h), "2 h ago");
    EXPECT_EQ(ageText(then, then + 48h), "2 days ago");
    EXPECT_EQ(ageText(then + 5s, then), "0 s ago");
}

TEST(OverviewWords, ADifferenceIsOfLevelsOfOneKind) {
    EXPECT_EQ(differenceText(level("RSRP", -92.25, "dBm"), level("RSRP", -95.5, "dBm")), "+3.25 dB");
    EXPECT_EQ(differenceText(level("RSCP", 0.125, ""), level("RSCP", 0.25, "")), "-0.12");
    EXPECT_EQ(differenceText(level("RSCP", 0.125, ""), level("RSCP", 0.12890625, "")), "+0.00");
    EXPECT_EQ(differenceText(level("RSCP", -92, "dBm"), level("RSRP", -95, "dBm")), "");
    EXPECT_EQ(differenceText(level("RSRP", -92, "dBm"), std::nullopt), "");
}

TEST(OverviewWords, AChangeWithoutABeforeOrAnAfterIsTheOther) {
    EXPECT_EQ(changeText("idle", "connected", "->"), "idle -> connected");
    EXPECT_EQ(changeText("", "internet (5)", "->"), "internet (5)");
    EXPECT_EQ(changeText("internet (5)", "", "->"), "internet (5)");
}

}  // namespace
}  // namespace kelvo::overview
