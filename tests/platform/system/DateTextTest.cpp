#include "platform/system/DateText.h"

#include <gtest/gtest.h>

#include "platform/system/Environment.h"
#include "tests/support/ManualClock.h"

namespace kelvo {
namespace {

using std::chrono::seconds;
using std::chrono::sys_seconds;

constexpr long long kMarch = 1299229502;  // 2011-03-04 09:05:02 UTC

TEST(DateText, DescribesADateInTheLocalZone) {
    const Clock::TimePoint time{seconds(kMarch)};
    const test::ManualClock berlin(kMarch, 60);
    const Environment::Scope inBerlin({.clock = &berlin});
    EXPECT_EQ(dateDescription(time), "2011-03-04 10:05:02 +0100");
    const test::ManualClock newfoundland(kMarch, -210);
    const Environment::Scope inNewfoundland({.clock = &newfoundland});
    EXPECT_EQ(dateDescription(time), "2011-03-04 05:35:02 -0330");
    EXPECT_EQ(utcDateDescription(time), "2011-03-04 09:05:02 +0000");
}

TEST(DateText, ReadsADateInAnyZone) {
    for (const char* text : {"2011-03-04 09:05:02 +0000", "2011-03-04 10:05:02 +0100", "2011-03-04 05:35:02 -0330"}) {
        EXPECT_EQ(dateFromDescription(text), sys_seconds(seconds(kMarch))) << text;
    }
    EXPECT_EQ(dateFromDescription("1969-12-31 23:59:59 +0000"), sys_seconds(seconds(-1)));
    EXPECT_EQ(dateFromDescription("9999-12-31 23:59:59 +0000"), sys_seconds(seconds(253402300799)));
}

TEST(DateText, ReadsNothingElse) {
    for (const char* text : {"", "yesterday", "2011-03-04", "2011-13-04 09:05:02 +0000", "2011-03-04T09:05:02Z"}) {
        EXPECT_EQ(dateFromDescription(text), std::nullopt) << text;
    }
}

}  // namespace
}  // namespace kelvo
