#include "platform/system/Clock.h"

#include <gtest/gtest.h>

#include "tests/support/TimeZone.h"

namespace kelvo {
namespace {

using test::TimeZone;

/// The local time at a number of seconds since 1970-01-01 00:00 UTC.
std::tm localAt(long long unixSeconds) {
    return SystemClock().local(Clock::TimePoint(std::chrono::seconds(unixSeconds)));
}

TEST(SystemClock, CountsItsZoneInSecondsEastOfUtc) {
    const TimeZone west("EST5");
    const std::tm noon = localAt(43200);  // 12:00 UTC
    EXPECT_EQ(noon.tm_gmtoff, -18000);
    EXPECT_EQ(noon.tm_hour, 7);
    EXPECT_EQ(noon.tm_isdst, 0);
}

TEST(SystemClock, CountsAZoneEastOfUtcUpwards) {
    const TimeZone east("NPT-5:45");
    const std::tm midnight = localAt(0);
    EXPECT_EQ(midnight.tm_gmtoff, 20700);
    EXPECT_EQ(midnight.tm_hour, 5);
    EXPECT_EQ(midnight.tm_min, 45);
}

TEST(SystemClock, KnowsDaylightSavingTime) {
    const TimeZone west("EST5EDT,M3.2.0,M11.1.0");
    const std::tm winter = localAt(1577880000);  // 2020-01-01 12:00 UTC
    EXPECT_EQ(winter.tm_isdst, 0);
    EXPECT_EQ(winter.tm_gmtoff, -18000);
    const std::tm summer = localAt(1593604800);  // 2020-07-01 12:00 UTC
    EXPECT_GT(summer.tm_isdst, 0);
    EXPECT_EQ(summer.tm_gmtoff, -14400);
}

}  // namespace
}  // namespace kelvo
