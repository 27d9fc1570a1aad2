#include "ui/AxisSteps.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

TEST(AxisSteps, AreOneTwoOrFiveTimesAPowerOfTen) {
    EXPECT_DOUBLE_EQ(axisStep(10, 5), 2);
    EXPECT_DOUBLE_EQ(axisStep(11, 5), 5);
    EXPECT_DOUBLE_EQ(axisStep(26, 5), 10);
    EXPECT_DOUBLE_EQ(axisStep(5, 5), 1);
    EXPECT_DOUBLE_EQ(axisStep(0.9, 5), 0.2);
    EXPECT_DOUBLE_EQ(axisStep(4000, 5), 1000);
}

void expectAxis(double least, double most, double low, double high, double step) {
    const AxisRange axis = axisFor(least, most, 5);
    EXPECT_DOUBLE_EQ(axis.low, low) << least << " to " << most;
    EXPECT_DOUBLE_EQ(axis.high, high) << least << " to " << most;
    EXPECT_DOUBLE_EQ(axis.step, step) << least << " to " << most;
}

TEST(AxisSteps, HoldWhatIsSeen) {
    expectAxis(-101, -88, -105, -85, 5);
    expectAxis(-95.25, -94.75, -95.5, -94.5, 0.5);
    expectAxis(0, 40, 0, 40, 10);
}

TEST(AxisSteps, ShowHowPartsOfOneChange) {
    const AxisRange axis = axisFor(0.0625, 0.21875, 5);
    EXPECT_DOUBLE_EQ(axis.low, 0.05);
    EXPECT_DOUBLE_EQ(axis.high, 0.25);
    EXPECT_DOUBLE_EQ(axisFor(0, 0, 5).high - axisFor(0, 0, 5).low, 1);
    EXPECT_LE(axisFor(0.125, 0.125, 5).high, 0.25);
}

TEST(AxisSteps, LeaveAStandingLevelInTheMiddle) {
    expectAxis(-95, -95, -95.5, -94.5, 0.5);
    expectAxis(0, 0, -0.5, 0.5, 0.5);
}

}  // namespace
}  // namespace kelvo
