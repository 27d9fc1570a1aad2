#include <gtest/gtest.h>

#include "tools/report/Lane.h"
#include "tools/report/RecordedTime.h"
#include "tools/report/ThinnedSeries.h"

namespace kelvo::report {
namespace {

using namespace std::chrono_literals;

overview::Time at(std::chrono::microseconds time) { return overview::Time(time); }

TEST(ReportRecordedTime, GoesWithTheRecordsTimes) {
    RecordedTime time;
    EXPECT_EQ(time.note(at(1000s)), 0s);
    EXPECT_EQ(time.note(at(1002s)), 2s);
    EXPECT_EQ(time.note(at(1302s)), 302s);  // five minutes are no pause yet
    EXPECT_EQ(time.pauses(), 0U);
    EXPECT_EQ(time.stretches().size(), 1U);
}

TEST(ReportRecordedTime, LeavesPausesOut) {
    RecordedTime time;
    time.note(at(1000s));
    time.note(at(1010s));
    EXPECT_EQ(time.note(at(9000s)), 10s);
    EXPECT_EQ(time.note(at(9003s)), 13s);
    EXPECT_EQ(time.pauses(), 1U);
    ASSERT_EQ(time.stretches().size(), 2U);
    EXPECT_EQ(time.stretches()[1].at, 10s);
    EXPECT_EQ(time.stretches()[1].time, at(9000s));
    EXPECT_EQ(time.latest(), at(9003s));
}

TEST(ReportRecordedTime, ATimeThatGoesBackBeginsAnewAndALittleDisorderDoesNot) {
    RecordedTime time;
    time.note(at(1000s));
    time.note(at(1010s));
    EXPECT_EQ(time.note(at(1009s)), 10s);
    EXPECT_EQ(time.note(at(1011s)), 11s);
    EXPECT_EQ(time.pauses(), 0U);
    EXPECT_EQ(time.note(at(500s)), 11s);
    EXPECT_EQ(time.note(at(501s)), 12s);
    EXPECT_EQ(time.pauses(), 1U);
    EXPECT_EQ(time.earliest(), at(500s));
}

TEST(ReportRecordedTime, TimesAtBothEndsOfTheNumbersAreAPause) {
    RecordedTime time;
    time.note(overview::Time::min());
    EXPECT_EQ(time.note(overview::Time::max()), 0s);
    EXPECT_EQ(time.note(overview::Time::min()), 0s);
    EXPECT_EQ(time.pauses(), 2U);
    EXPECT_FALSE(time.isTimeless());
}

TEST(ReportThinnedSeries, KeepsEveryReadingWhileThereIsRoom) {
    ThinnedSeries series;
    for (int i = 0; i < 2048; ++i) series.add(i * 1ms, i);
    const auto points = series.points();
    ASSERT_EQ(points.size(), 2048U);
    EXPECT_EQ(points[2047].at, 2047ms);
    EXPECT_DOUBLE_EQ(points[2047].mean, 2047);
}

TEST(ReportThinnedSeries, OfEachStepTheSmallestAndTheLargestStay) {
    ThinnedSeries series;
    for (int i = 0; i < 100'000; ++i) series.add(i * 1ms, i == 34'567 ? -200 : i == 70'001 ? 55 : -100);
    const auto points = series.points();
    EXPECT_LE(points.size(), 2048U);
    EXPECT_GE(points.size(), 1024U);
    int low = 0;
    int high = 0;
    for (const Point& point : points) {
        if (point.low == -200 && point.at > 34s && point.at < 35s) ++low;
        if (point.high == 55 && point.at > 69s && point.at < 71s) ++high;
        EXPECT_LE(point.low, point.mean);
        EXPECT_LE(point.mean, point.high);
    }
    EXPECT_EQ(low, 1);
    EXPECT_EQ(high, 1);
}

TEST(ReportThinnedSeries, WiderStepsHaveTheMeanOfTheirReadings) {
    ThinnedSeries series;
    series.add(0s, 1);
    series.add(1s, 2);
    series.add(2s, 6);
    series.add(10s, 5);
    const auto points = series.points(5s);
    ASSERT_EQ(points.size(), 2U);
    EXPECT_EQ(points[0].at, 1s);
    EXPECT_DOUBLE_EQ(points[0].low, 1);
    EXPECT_DOUBLE_EQ(points[0].mean, 3);
    EXPECT_DOUBLE_EQ(points[0].high, 6);
    EXPECT_DOUBLE_EQ(points[1].mean, 5);
}

TEST(ReportThinnedSeries, SaysWhereItWasInterrupted) {
    ThinnedSeries series;
    series.add(0s, 1);
    series.interrupt();
    series.add(1s, 2);
    series.add(2s, 3);
    const auto points = series.points();
    ASSERT_EQ(points.size(), 3U);
    EXPECT_TRUE(points[1].begins);
    EXPECT_FALSE(points[2].begins);
}

TEST(ReportLane, CountsHowLongEachTextWasTheCase) {
    Lane lane;
    lane.note(0s, "idle");
    lane.note(3s, "idle");
    lane.note(4s, "connected");
    lane.note(9s, "");
    lane.note(10s, "idle");
    lane.end(12s);
    EXPECT_EQ(lane.times().at("idle"), 6s);
    EXPECT_EQ(lane.times().at("connected"), 5s);
    EXPECT_EQ(lane.changes(), 1U);  // from and to nothing is no change
    ASSERT_EQ(lane.segments().size(), 3U);
    EXPECT_EQ(lane.segments()[1].from, 4s);
    EXPECT_EQ(lane.segments()[1].to, 9s);
    EXPECT_EQ(lane.segments()[2].text, "idle");
}

TEST(ReportLane, PutsShortSegmentsTogetherUnderTheOneThatLastedLongest) {
    Lane lane;
    for (int i = 0; i < 10'000; ++i) {
        lane.note(i * 10s, "long");
        lane.note(i * 10s + 7s, "short");
    }
    lane.note(100'000s, "end");
    lane.end(200'000s);
    EXPECT_LE(lane.segments().size(), 1500U);
    EXPECT_GE(lane.segments().size(), 100U);
    EXPECT_EQ(lane.segments().front().text, "long");
    EXPECT_TRUE(lane.segments().front().isBusy);
    EXPECT_EQ(lane.segments().back().text, "end");
    EXPECT_FALSE(lane.segments().back().isBusy);
    EXPECT_EQ(lane.times().at("long"), 70'000s);
    EXPECT_EQ(lane.times().at("short"), 30'000s);
}

}  // namespace
}  // namespace kelvo::report
