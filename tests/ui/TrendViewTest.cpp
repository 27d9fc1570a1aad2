#include "ui/TrendView.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

using namespace std::chrono_literals;

class TrendViewTest : public testing::Test {
protected:
    TrendViewTest() { view.setNow(10000s); }
    void expectSeen(Trend::Time from, Trend::Time to) {
        EXPECT_EQ(view.from(), from);
        EXPECT_EQ(view.to(), to);
    }
    TrendView view;
};

TEST_F(TrendViewTest, ShowsTheLastFiveMinutesAndGoesOnWithTheTime) {
    expectSeen(9700s, 10000s);
    view.setNow(10002s);
    expectSeen(9702s, 10002s);
    EXPECT_TRUE(view.isLive());
}

TEST_F(TrendViewTest, StaysWhereItWasMovedUntilItComesBack) {
    view.moveBy(0.5);
    expectSeen(9550s, 9850s);
    view.setNow(10002s);
    expectSeen(9550s, 9850s);
    view.moveBy(-0.25);
    expectSeen(9625s, 9925s);
    view.moveBy(-1);
    expectSeen(9702s, 10002s);
    EXPECT_TRUE(view.isLive());
}

TEST_F(TrendViewTest, EndsWithTheLastHalfHour) {
    view.moveBy(100);
    expectSeen(8200s, 8500s);
    view.setNow(10100s);
    expectSeen(8300s, 8600s);
}

TEST_F(TrendViewTest, ZoomsFromHalfAMinuteToHalfAnHour) {
    view.zoomBy(0.5, 1);
    expectSeen(9850s, 10000s);
    view.zoomBy(0.01, 1);
    expectSeen(9970s, 10000s);
    view.zoomBy(100, 1);
    expectSeen(8200s, 10000s);
    EXPECT_TRUE(view.isLive());
}

TEST_F(TrendViewTest, KeepsThePlaceUnderTheFingers) {
    view.moveBy(2);  // 9100 to 9400
    view.zoomBy(0.5, 0.25);
    EXPECT_EQ(view.timeAt(0.25), 9175s);
    EXPECT_EQ(view.span(), 150s);
    EXPECT_DOUBLE_EQ(view.shareOf(9175s), 0.25);
}

}  // namespace
}  // namespace kelvo
