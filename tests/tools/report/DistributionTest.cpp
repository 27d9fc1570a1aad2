#include "tools/report/Distribution.h"

#include <gtest/gtest.h>

#include <limits>

namespace kelvo::report {
namespace {

Distribution of(std::initializer_list<double> values) {
    Distribution distribution;
    for (const double value : values) distribution.add(value);
    return distribution;
}

TEST(ReportDistribution, BetweenTwoReadingsTheStraightLineCounts) {
    const Distribution levels = of({-80, -110, -90, -100, -80});
    EXPECT_EQ(levels.count(), 5U);
    EXPECT_DOUBLE_EQ(levels.minimum(), -110);
    EXPECT_DOUBLE_EQ(levels.percentile(0.05), -108);  // a fifth of the way from the first to the second
    EXPECT_DOUBLE_EQ(levels.median(), -90);
    EXPECT_DOUBLE_EQ(levels.percentile(0.95), -80);
    EXPECT_DOUBLE_EQ(levels.maximum(), -80);
    EXPECT_DOUBLE_EQ(of({1, 2, 3, 4}).median(), 2.5);
    EXPECT_DOUBLE_EQ(of({1, 1, 3, 4}).median(), 2);
    EXPECT_DOUBLE_EQ(of({0, 10}).percentile(0.95), 9.5);
}

TEST(ReportDistribution, OfOneReadingEverythingIsThatOne) {
    const Distribution one = of({-97.25});
    EXPECT_DOUBLE_EQ(one.minimum(), -97.25);
    EXPECT_DOUBLE_EQ(one.percentile(0.05), -97.25);
    EXPECT_DOUBLE_EQ(one.maximum(), -97.25);
}

TEST(ReportDistribution, OfNoneItIsEmpty) {
    const Distribution none = of({});
    EXPECT_TRUE(none.isEmpty());
    EXPECT_DOUBLE_EQ(none.median(), 0);
}

TEST(ReportDistribution, LeavesOutWhatIsNoNumber) {
    const double infinite = std::numeric_limits<double>::infinity();
    const Distribution some = of({infinite, -infinite, std::numeric_limits<double>::quiet_NaN(), 7});
    EXPECT_EQ(some.count(), 1U);
    EXPECT_DOUBLE_EQ(some.maximum(), 7);
}

TEST(ReportDistribution, CountsFromAFloorOn) {
    const Distribution levels = of({-80, -110, -90, -100, -80});
    EXPECT_EQ(levels.countFrom(-80), 2U);
    EXPECT_EQ(levels.countFrom(-90), 3U);
    EXPECT_EQ(levels.countFrom(-95), 3U);
    EXPECT_EQ(levels.countFrom(0), 0U);
}

}  // namespace
}  // namespace kelvo::report
