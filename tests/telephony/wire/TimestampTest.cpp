#include "telephony/wire/Timestamp.h"

#include <gtest/gtest.h>

namespace kelvo::wire {
namespace {

using namespace std::chrono_literals;
using std::chrono::sys_days;

TEST(Timestamp, SaysWhenARecordWasTaken) {
    const auto time = timeOf(72659535985485082U);
    ASSERT_TRUE(time);
    // 2023-12-06 04:04:26.227324…
    EXPECT_EQ(std::chrono::floor<std::chrono::microseconds>(*time),
              sys_days(2023y / 12 / 6) + 4h + 4min + 26s + 227'324us);
}

TEST(Timestamp, CountsTicksAndChips) {
    // 757,071,360,000 ticks of 1.25 ms lie between the beginning and 2010.
    EXPECT_EQ(timeOf(757'071'360'000ULL << 16), sys_days(2010y / 1 / 1));
    EXPECT_EQ(timeOf(757'071'360'001ULL << 16), sys_days(2010y / 1 / 1) + 1'250us);
    EXPECT_EQ(timeOf(757'071'360'000ULL << 16 | 24'576), sys_days(2010y / 1 / 1) + 625us);
}

TEST(Timestamp, IsNotSetBefore2010AndAfter2050) {
    EXPECT_FALSE(timeOf(0));
    EXPECT_FALSE(timeOf(757'071'359'999ULL << 16 | 49'151));
    EXPECT_EQ(timeOf(1'792'143'359'999ULL << 16), sys_days(2051y / 1 / 1) - 1'250us);
    EXPECT_FALSE(timeOf(1'792'143'360'000ULL << 16));
    EXPECT_FALSE(timeOf(UINT64_MAX));
}

TEST(Timestamp, ComesBackAsItWas) {
    EXPECT_EQ(timestampOf(sys_days(2010y / 1 / 1)), 757'071'360'000ULL << 16);
    EXPECT_EQ(timestampOf(sys_days(1980y / 1 / 6)), 0U);
    EXPECT_EQ(timestampOf(*timeOf(72659535985485082U)), 72659535985485082U);
    for (std::uint64_t chips = 0; chips < 49'152; ++chips) {
        const std::uint64_t timestamp = 1'108'696'532'981ULL << 16 | chips;
        ASSERT_EQ(timestampOf(*timeOf(timestamp)), timestamp);
    }
}

TEST(Timestamp, NeverHasMoreChipsThanATick) {
    EXPECT_EQ(timestampOf(sys_days(2010y / 1 / 1) + 1'249'999ns) & 0xFFFF, 49'151U);
}

}  // namespace
}  // namespace kelvo::wire
