#include "model/TrendWords.h"

#include <gtest/gtest.h>

#include <vector>

#include "model/LevelGrades.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;

/// Readings every two seconds, the last at `end`.
Trend trendOf(const std::vector<double>& numbers, Trend::Time end = 1000s, std::string_view unit = "dBm") {
    Trend trend{.points = {}, .unit = unit};
    for (std::size_t i = 0; i < numbers.size(); ++i) {
        trend.points.push_back({.at = end - 2s * static_cast<int>(numbers.size() - 1 - i), .number = numbers[i]});
    }
    return trend;
}

TEST(TrendWords, SayWhatAChartShows) {
    EXPECT_EQ(trendSummary(trendOf({-88, -89, -92, -97, -101, -95}), 700s, 1000s, 1000s),
              "-95 dBm, between -101 and -88 in the last five minutes, falling");
    EXPECT_EQ(trendSummary(trendOf({-101, -97.5, -88.25}), 940s, 1000s, 1000s),
              "-88.25 dBm, between -101 and -88.25 in the last minute, rising");
    EXPECT_EQ(trendSummary(trendOf({-90, -99, -80, -90}), 970s, 1000s, 1000s),
              "-90 dBm, between -99 and -80 in the last 30 seconds, steady");
    EXPECT_EQ(trendSummary(trendOf({7, 7, 7}, 1000s, ""), 0s, 1000s, 1000s), "7, 7 in the last 17 minutes, steady");
}

TEST(TrendWords, SayThatNothingWasRead) {
    EXPECT_EQ(trendSummary({}, 700s, 1000s, 1000s), "No readings yet");
    EXPECT_EQ(trendSummary(trendOf({-95}, 100s), 700s, 1000s, 1000s), "-95 dBm, no readings in the last five minutes");
}

TEST(TrendWords, SayWhichStretchIsSeen) {
    EXPECT_EQ(trendSummary(trendOf({-95, -95}, 500s), 400s, 700s, 1000s),
              "-95 dBm, -95 from ten minutes to five minutes ago, steady");
}

TEST(TrendWords, CountTheReadingsOfTheStretchAlone) {
    const auto seen = statisticsOf(trendOf({-80, -90, -100, -95, -50}), 994s, 998s);
    ASSERT_TRUE(seen);
    EXPECT_EQ(seen->least, -100);
    EXPECT_EQ(seen->most, -90);
    EXPECT_EQ(seen->mean, -95);
    EXPECT_EQ(seen->change, -5);  // of the first to the last of three
    EXPECT_FALSE(statisticsOf(trendOf({-80}), 1001s, 1002s));
}

TEST(TrendWords, WriteNumbersWithoutEmptyDecimals) {
    EXPECT_EQ(numberText(-95.25), "-95.25");
    EXPECT_EQ(numberText(-95.5), "-95.5");
    EXPECT_EQ(numberText(-100), "-100");
    EXPECT_EQ(numberText(0.1875), "0.19");
    EXPECT_EQ(numberText(-0.001), "0");
    EXPECT_EQ(numberText(27439618), "27439618");
}

TEST(TrendWords, WriteAges) {
    EXPECT_EQ(ageText(40s), "40 seconds old");
    EXPECT_EQ(ageText(1s), "1 second old");
    EXPECT_EQ(ageText(119999ms), "119 seconds old");
    EXPECT_EQ(ageText(120s), "2 minutes old");
    EXPECT_EQ(ageText(7199s), "119 minutes old");
    EXPECT_EQ(ageText(7200s), "2 hours old");
}

std::string gradeOf(const char* name, const char* unit, double number) {
    return std::string(gradeOf(gradesOf(name, unit), number));
}

TEST(LevelGrades, AreThoseOfTheLevel) {
    const char* rsrp = "/Serving Cell Measurements/Measured RSRP";
    EXPECT_EQ(gradeOf(rsrp, "dBm", -80), "excellent");
    EXPECT_EQ(gradeOf(rsrp, "dBm", -80.25), "good");
    EXPECT_EQ(gradeOf(rsrp, "dBm", -90.25), "fair");
    EXPECT_EQ(gradeOf(rsrp, "dBm", -100), "fair");
    EXPECT_EQ(gradeOf(rsrp, "dBm", -100.25), "poor");
    EXPECT_EQ(gradeOf("/Measured Neighbor Cells/PCI 3/Filtered RSRQ", "dB", -12), "good");
    EXPECT_EQ(gradeOf("/UMTS Cells/Active Set/PSC 3/Energy Per Chip", "dB", -11), "fair");
    EXPECT_EQ(gradeOf("/1x/Active Set/180", "dB", -5), "excellent");
    EXPECT_EQ(gradeOf("/GSM Cell and Neighbours/GSM Set/ARFCN 3, BSIC 4/RSSI", "dBm", -86), "fair");
    EXPECT_EQ(gradeOf("/GSM Cell and Neighbours/GSM Serving Cell/RSSI", "dBm", 45), "excellent");
    EXPECT_EQ(gradeOf("/GSM Cell and Neighbours/GSM RR Info/Serving Rx Level", "", 9), "poor");
    EXPECT_EQ(gradeOf("/Serving/RSSI", "dBm", -71), "good");
    EXPECT_EQ(gradeOf("/Neighbours/GSM/ARFCN 70, BSIC 17/RSSI", "dBm", -101), "poor");
    EXPECT_EQ(gradeOf("/Neighbours/UMTS/PSC 9/ECN0", "dB", -10.5), "fair");
}

TEST(LevelGrades, AreNoneForOtherValues) {
    EXPECT_TRUE(gradesOf("/Serving Cell Measurements/Srxlev", "dBm").empty());
    EXPECT_TRUE(gradesOf("/Serving Cell Measurements/Measured RSSI", "dBm").empty());
    EXPECT_TRUE(gradesOf("/1x/Rx0 AGC", "dBm").empty());
    EXPECT_TRUE(gradesOf("/Serving/RSCP", "dBm").empty());
    EXPECT_EQ(gradeOf("/1x/Tx AGC", "dBm", 1), "");
}

}  // namespace
}  // namespace kelvo
