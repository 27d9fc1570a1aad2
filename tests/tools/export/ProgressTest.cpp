#include "tools/export/Progress.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

using namespace std::chrono_literals;

struct ProgressTest : testing::Test {
    std::chrono::nanoseconds now{0};
    std::string drawn;
    std::function<void(std::string_view)> draw = [this](std::string_view text) { drawn += text; };
    SteadyTime clock = [this] { return now; };
    static std::optional<double> half() { return 0.5; }
    static std::optional<double> unknown() { return std::nullopt; }
};

TEST_F(ProgressTest, OfWhatTakesASecondIsNothing) {
    {
        Progress progress(draw, clock);
        now = 999ms;
        progress.at(256, half);
    }
    EXPECT_EQ(drawn, "");
}

TEST_F(ProgressTest, IsALineThatGoesInTheEnd) {
    {
        Progress progress(draw, clock);
        now = 1s;
        progress.at(1'234'432, half);
        EXPECT_EQ(drawn, "\r[###############...............]  50 %  1,234,432 records\x1B[K");
        drawn.clear();
    }
    EXPECT_EQ(drawn, "\r\x1B[K");
}

TEST_F(ProgressTest, CountsWhereNobodyKnowsTheEnd) {
    Progress progress(draw, clock);
    now = 1s;
    progress.at(256, unknown);
    EXPECT_EQ(drawn, "\r256 records\x1B[K");
}

TEST_F(ProgressTest, IsDrawnFiveTimesASecondAtMost) {
    Progress progress(draw, clock);
    now = 1s;
    progress.at(256, unknown);
    drawn.clear();
    now = 1199ms;
    progress.at(512, unknown);
    EXPECT_EQ(drawn, "");
    now = 1200ms;
    progress.at(768, unknown);
    EXPECT_EQ(drawn, "\r768 records\x1B[K");
}

TEST_F(ProgressTest, WithoutATerminalIsNothing) {
    Progress progress({}, clock);
    now = 10s;
    progress.at(256, half);
    progress.clear();
    EXPECT_EQ(drawn, "");
}

}  // namespace
}  // namespace kelvo
