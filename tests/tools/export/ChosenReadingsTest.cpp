#include "tools/export/ChosenReadings.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

using namespace std::chrono_literals;

/// What was handed on: "second.record path=text …", a line a call.
struct NotedRows final : ReadingRows {
    void write(const Moment& moment, std::span<const Written> readings) override {
        std::string line = std::to_string(moment.time.time_since_epoch() / 1ms) + "#" + std::to_string(moment.record);
        for (const auto& [series, value] : readings) line += " " + series->path + "=" + *value->string();
        if (!readings.empty()) lines.push_back(line);
    }
    void finish() override {}
    std::vector<std::string> lines;
};

struct ChosenReadingsTest : testing::Test {
    using Lines = std::vector<std::string>;
    /// A record at that millisecond writes these texts to A and, unless null, to B.
    void record(ChosenReadings& chosen, int millisecond, const char* textOfA, const char* textOfB = nullptr) {
        const Value valueOfA = textOfA;
        const Value valueOfB = textOfB != nullptr ? Value(textOfB) : Value();
        std::vector<Written> written = {{&a, &valueOfA}};
        if (textOfB != nullptr) written.push_back({&b, &valueOfB});
        chosen.take({.time = CaptureTime(std::chrono::milliseconds(millisecond)), .record = ++number}, written);
    }
    Series a{.path = "A"};
    Series b{.path = "B"};
    std::uint64_t number = 0;
    NotedRows rows;
};

TEST_F(ChosenReadingsTest, AreAllWhenNothingIsSaid) {
    ChosenReadings chosen({}, rows);
    record(chosen, 0, "1", "2");
    record(chosen, 1, "1");
    EXPECT_EQ(rows.lines, (Lines{"0#1 A=1 B=2", "1#2 A=1"}));
}

TEST_F(ChosenReadingsTest, OfTheTimesThatAreAskedFor) {
    ChosenReadings chosen({.from = CaptureTime(10ms), .to = CaptureTime(12ms)}, rows);
    for (int i = 9; i < 14; ++i) record(chosen, i, "1");
    EXPECT_EQ(rows.lines, (Lines{"10#2 A=1", "11#3 A=1"}));
}

TEST_F(ChosenReadingsTest, OfChangesAloneBeginWithTheFirst) {
    ChosenReadings chosen({.changes = true}, rows);
    record(chosen, 0, "1", "x");
    record(chosen, 1, "1", "y");
    record(chosen, 2, "1", "y");
    record(chosen, 3, "2", "y");
    record(chosen, 4, "1");
    EXPECT_EQ(rows.lines, (Lines{"0#1 A=1 B=x", "1#2 B=y", "3#4 A=2", "4#5 A=1"}));
}

TEST_F(ChosenReadingsTest, OfEveryIntervalAreTheLastOnes) {
    ChosenReadings chosen({.every = 1s}, rows);
    record(chosen, 100, "1", "x");
    record(chosen, 900, "2");
    record(chosen, 1000, "3");  // the next interval
    record(chosen, 3999, "4", "z");
    EXPECT_EQ(rows.lines, (Lines{"100#1 B=x", "900#2 A=2", "1000#3 A=3"}));
    chosen.endInterval();
    EXPECT_EQ(rows.lines.back(), "3999#4 A=4 B=z");
    EXPECT_EQ(a.heldAt, Series::kNotHeld);
}

TEST_F(ChosenReadingsTest, OfEveryIntervalBeginAnewWhereTimesGoBack) {
    ChosenReadings chosen({.every = 1s}, rows);
    record(chosen, 5000, "1");
    record(chosen, -1, "2");
    record(chosen, 0, "3");
    chosen.endInterval();
    EXPECT_EQ(rows.lines, (Lines{"5000#1 A=1", "-1#2 A=2", "0#3 A=3"}));
}

TEST_F(ChosenReadingsTest, OfAnIntervalMayStandAtOneMoment) {
    ChosenReadings chosen({.every = 1s, .isOneMoment = true}, rows);
    record(chosen, 100, "1", "x");
    record(chosen, 900, "2");
    chosen.endInterval();
    EXPECT_EQ(rows.lines, Lines{"900#2 B=x A=2"});
}

}  // namespace
}  // namespace kelvo
