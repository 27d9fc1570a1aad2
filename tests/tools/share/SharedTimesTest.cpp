#include "tools/share/SharedTimes.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using Time = SharedTimes::Time;

constexpr std::uint64_t kTicks = 72659535985485082;  // 2023-12-06 04:04:26.2273
constexpr std::uint64_t kSecond = 800ULL << 16;
// 2020-01-01 is 14,605 days after 1980-01-06.
constexpr std::uint64_t kStart = (14'605ULL * 86'400 * 800) << 16;

TEST(SharedTimes, StayUnlessTheyAreToBeShifted) {
    SharedTimes times(false);
    EXPECT_EQ(times.host(Time(5s)), Time(5s));
    EXPECT_EQ(times.modem(kTicks), kTicks);
    EXPECT_EQ(times.modem(~0ULL), ~0ULL);
}

TEST(SharedTimes, BeginWith2020AndKeepTheirIntervals) {
    SharedTimes times(true);
    const Time start = std::chrono::sys_days(std::chrono::year(2020) / 1 / 1);
    EXPECT_EQ(times.host(Time(1'700'000'000s)), start);
    EXPECT_EQ(times.host(Time(1'700'000'007s + 250ms)), start + 7s + 250ms);
    EXPECT_EQ(times.host(Time(1'699'999'990s)), start - 10s);
    EXPECT_EQ(times.modem(kTicks) >> 16, kStart >> 16);
    EXPECT_EQ((times.modem(kTicks + 3 * kSecond) >> 16) - (kStart >> 16), 2400U);
    EXPECT_EQ(times.modem(kTicks) & 0xFFFF, kTicks & 0xFFFF);
}

TEST(SharedTimes, OfAModemWhoseClockIsNotSetStay) {
    SharedTimes times(true);
    EXPECT_EQ(times.modem(90 * kSecond), 90 * kSecond);
    EXPECT_EQ(times.modem(0), 0U);
}

TEST(SharedTimes, ThatNoClockShowsAreGone) {
    SharedTimes times(true);
    EXPECT_EQ(times.modem(0xFFFFFFFFFFFFFFFF), 0U);
}

TEST(SharedTimes, AreNeverBefore1970) {
    SharedTimes times(true);
    times.host(Time(4'000'000'000s));
    EXPECT_EQ(times.host(Time(0s)), Time());
}

}  // namespace
}  // namespace kelvo
