#include "model/Trends.h"

#include <gtest/gtest.h>

#include <limits>

#include "LogGenerator/IFX/GSMLogGenerator.h"
#include "platform/encodings/PropertyList.h"
#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using Changes = std::vector<TrendChange>;

/// Steps of a quarter dBm from -140 on; 999 stands for no number.
class QuarterDbm final : public Quantity {
public:
    void print(std::string& text, std::int64_t raw) const override {
        text = raw == 999 ? "Not Present" : std::to_string(raw / 4 - 140) + " dBm";
    }
    std::optional<Measurement> measure(std::int64_t raw) const override {
        if (raw == 999) return std::nullopt;
        return Measurement{static_cast<double>(raw) / 4 - 140, "dBm"};
    }
};
/// Plain whole numbers.
class Whole final : public Quantity {
public:
    void print(std::string& text, std::int64_t raw) const override { text = std::to_string(raw); }
    std::optional<Measurement> measure(std::int64_t raw) const override {
        return Measurement{static_cast<double>(raw), ""};
    }
};
const QuarterDbm kLevel;
const Whole kWhole;

Value reading(std::int64_t raw, std::uint64_t record = 0, const Quantity& quantity = kLevel) {
    Value value;
    value.set(Reading{raw, &quantity}, record);
    return value;
}

Value cell(std::int64_t pci, std::int64_t level) {
    return Dictionary::make({{"Physical Cell ID", reading(pci, 0, kWhole)}, {"Filtered RSRP", reading(level)}});
}

class TrendsTest : public testing::Test {
protected:
    void note(const Value& display) {
        now += 2s;
        trends.note(display, now);
    }
    void noteLevel(std::int64_t raw, std::uint64_t record = 0) {
        note(Dictionary::make({{"Serving", Dictionary::make({{"RSRP", reading(raw, record)}})}}));
    }
    /// What serves, and its level, as a section of its own.
    void noteServing(const char* section, std::int64_t pci) {
        serving->set(section, Dictionary::make({{"Physical Cell ID", reading(pci, 0, kWhole)}}));
        note(serving);
    }
    void noteNeighbors(std::int64_t channel, std::vector<Value> cells) {
        const ArrayRef list = Array::make();
        for (Value& each : cells) list->append(std::move(each));
        const char* section = "Connected mode LTE Intra-frequency Measurement";
        note(Dictionary::make({{section, Dictionary::make({{"E-ARFCN", reading(channel, 0, kWhole)}})},
                               {"Measured Neighbor Cells", list}}));
    }
    std::vector<std::pair<Trends::Time, double>> points(std::string_view name) const {
        std::vector<std::pair<Trends::Time, double>> all;
        for (const Trend::Point& point : trends.trend(name).points) all.emplace_back(point.at, point.number);
        return all;
    }
    using Points = std::vector<std::pair<Trends::Time, double>>;

    Trends trends;
    Trends::Time now = 1000s;
    DictionaryRef serving = Dictionary::make();
};

TEST_F(TrendsTest, KeepsEachRefreshsReadingWithTimeUnitAndText) {
    noteLevel(180);
    noteLevel(179);
    noteLevel(179);
    noteLevel(2000);
    const Trend trend = trends.trend("/Serving/RSRP");
    EXPECT_EQ(trend.unit, "dBm");
    EXPECT_EQ(points("/Serving/RSRP"), (Points{{1002s, -95}, {1004s, -95.25}, {1006s, -95.25}, {1008s, 360}}));
    EXPECT_EQ(trend.points[0].text(), "-95 dBm");
    EXPECT_TRUE(trends.trend("/Serving/RSRQ").points.empty());
    EXPECT_EQ(trends.names(), std::vector<std::string>{"/Serving/RSRP"});
}

TEST_F(TrendsTest, LeavesOutRefreshesAtWhichNoRecordHadWrittenTheValue) {
    noteLevel(180, 1);
    noteLevel(180, 1);
    noteLevel(180, 1);
    noteLevel(180, 7);
    noteLevel(184, 7);  // cannot be: a record writes a value once
    noteLevel(184, 8);
    EXPECT_EQ(points("/Serving/RSRP"), (Points{{1002s, -95}, {1008s, -95}, {1012s, -94}}));
}

TEST_F(TrendsTest, LeavesOutWhatIsNoNumber) {
    noteLevel(180);
    noteLevel(999);
    noteLevel(184);
    EXPECT_EQ(points("/Serving/RSRP"), (Points{{1002s, -95}, {1006s, -94}}));
    EXPECT_EQ(trends.changes("/Serving/RSRP"), (Changes{{1004s, "Not Present"}}));
}

TEST_F(TrendsTest, KeepsEveryNumberWhateverItsSize) {
    constexpr std::int64_t kMost = std::numeric_limits<std::int64_t>::max();
    const std::vector<std::int64_t> raws = {0, kMost, -kMost - 1, -1, 63, -64, 64, 1 << 20, kMost, kMost};
    for (const std::int64_t raw : raws) note(Dictionary::make({{"n", reading(raw, 0, kWhole)}}));
    const Trend trend = trends.trend("/n");
    ASSERT_EQ(trend.points.size(), raws.size());
    for (std::size_t i = 0; i < raws.size(); ++i) EXPECT_EQ(trend.points[i].raw, raws[i]) << i;
}

TEST_F(TrendsTest, ForgetsWhatIsOlderThanHalfAnHour) {
    for (int i = 0; i < 2000; ++i) noteLevel(i % 300);
    const Trend trend = trends.trend("/Serving/RSRP");
    ASSERT_EQ(trend.points.size(), 901U);  // every two seconds for 1800, both ends included
    EXPECT_EQ(trend.points.front().at, now - 1800s);
    for (std::size_t i = 0; i < 901; ++i) ASSERT_EQ(trend.points[i].raw, (1099 + static_cast<int>(i)) % 300) << i;
}

TEST_F(TrendsTest, ForgetsAValueThatIsNoLongerWritten) {
    noteLevel(180, 1);
    for (int i = 0; i < 900; ++i) noteLevel(180, 1);
    EXPECT_EQ(points("/Serving/RSRP"), (Points{{1002s, -95}}));
    noteLevel(180, 1);
    EXPECT_TRUE(trends.names().empty());
    noteLevel(180, 1);  // the same record is no new reading
    EXPECT_TRUE(points("/Serving/RSRP").empty());
    noteLevel(184, 2);
    EXPECT_EQ(points("/Serving/RSRP"), (Points{{now, -94}}));
}

TEST_F(TrendsTest, TakesRefreshesWithinASecondAsOne) {
    noteLevel(180);
    now -= 1500ms;
    noteLevel(184);
    EXPECT_EQ(points("/Serving/RSRP"), (Points{{1002s, -95}}));
}

TEST_F(TrendsTest, BeginsAnewWhereTheUnitChanges) {
    noteLevel(180);
    note(Dictionary::make({{"Serving", Dictionary::make({{"RSRP", reading(7, 0, kWhole)}})}}));
    EXPECT_EQ(points("/Serving/RSRP"), (Points{{1004s, 7}}));
}

TEST_F(TrendsTest, FollowsACellOverItsRows) {
    noteNeighbors(1300, {cell(366, 160), cell(144, 150)});
    noteNeighbors(1300, {cell(144, 152), cell(84, 120), cell(366, 158)});
    const std::string name = trends.nameAt("/Measured Neighbor Cells/2/Filtered RSRP");
    EXPECT_EQ(name, "/Measured Neighbor Cells/PCI 366, EARFCN 1300/Filtered RSRP");
    EXPECT_EQ(points(name), (Points{{1002s, -100}, {1004s, -100.5}}));
    EXPECT_EQ(trends.pathOf(name), "/Measured Neighbor Cells/2/Filtered RSRP");
    EXPECT_EQ(trends.nameAt("/Measured Neighbor Cells/0"), "/Measured Neighbor Cells/PCI 144, EARFCN 1300");

    noteNeighbors(1300, {cell(144, 154)});
    EXPECT_EQ(trends.pathOf(name), name);  // it is nowhere now
    noteNeighbors(300, {cell(366, 100)});  // the same code on another channel is another cell
    EXPECT_EQ(points(name).size(), 2U);
    noteNeighbors(1300, {cell(366, 156)});
    EXPECT_EQ(points(name), (Points{{1002s, -100}, {1004s, -100.5}, {1010s, -101}}));
}

TEST_F(TrendsTest, FollowsPilotsByTheirOffset) {
    const auto pilots = [](const char* first, std::int64_t a, const char* second, std::int64_t b) {
        return Dictionary::make(
            {{"Active Set", Dictionary::make({{"_sorted", "_sorted"}, {first, reading(a)}, {second, reading(b)}})}});
    };
    note(pilots("0;180", 400, "1;240", 404));
    note(pilots("0;240", 408, "1;180", 412));
    EXPECT_EQ(points("/Active Set/180"), (Points{{1002s, -40}, {1004s, -37}}));
    EXPECT_EQ(points("/Active Set/240"), (Points{{1002s, -39}, {1004s, -38}}));
}

TEST_F(TrendsTest, KeepsChangesOfTexts) {
    const auto state = [](const char* text) { return Dictionary::make({{"RRC State", text}}); };
    note(state("–"));
    note(state("Idle"));
    note(state("Idle"));
    note(state("Connected"));
    EXPECT_EQ(trends.changes("/RRC State"), (Changes{{1004s, "Idle"}, {1008s, "Connected"}}));
    for (int i = 0; i < 898; ++i) note(state("Connected"));
    EXPECT_EQ(trends.changes("/RRC State"), (Changes{{1004s, "Idle"}, {1008s, "Connected"}}));
    note(state("Connected"));
    EXPECT_EQ(trends.changes("/RRC State"), (Changes{{now - 1800s, "Idle"}, {1008s, "Connected"}}));
}

TEST_F(TrendsTest, MarksWhereAnotherCellBeganToServe) {
    noteServing("Serving Cell Info", 301);
    noteServing("Serving Cell Info", 301);
    noteServing("Serving Cell Info", 17);
    EXPECT_EQ(trends.servingCells(), (Changes{{1006s, "PCI 17"}}));
    noteServing("Serving Cell Measurements", 17);  // the same, told by another section
    noteServing("Serving Cell Info", 42);
    noteServing("Serving Cell Measurements", 42);
    EXPECT_EQ(trends.servingCells(), (Changes{{1006s, "PCI 17"}, {1010s, "PCI 42"}}));
}

TEST_F(TrendsTest, TakesTheSeveralNamesOfACellAsOneChange) {
    const auto serve = [this](std::int64_t identity, std::int64_t pci) {
        note(Dictionary::make(
            {{"Serving Cell Info", Dictionary::make({{"Cell Identity", reading(identity, 0, kWhole)},
                                                     {"Physical Cell ID", reading(pci, 0, kWhole)}})}}));
    };
    serve(1000, 301);
    serve(1001, 301);
    serve(1001, 17);
    EXPECT_EQ(trends.servingCells(), (Changes{{1004s, "PCI 17"}}));
    serve(1002, 18);
    EXPECT_EQ(trends.servingCells(), (Changes{{1004s, "PCI 17"}, {1008s, "PCI 18"}}));
}

/// What a cell monitor shows after a message with these cells.
Value monitored(const Value& serving, std::initializer_list<Value> neighbors) {
    const ArrayRef list = Array::make({"header"});
    for (const Value& neighbor : neighbors) list->append(neighbor);
    GSMLogGenerator generator;
    Dictionary state;
    const Value tree =
        Dictionary::make({{"Serving", Dictionary::make({{"Cell", serving}})},
                          {"Neighbours", Dictionary::make({{"GSM", list}, {"UMTS", Array::make({"header"})}})}});
    generator.updateState(state, *writeXmlPropertyList(tree));
    return state["Display"];
}

Value monitoredCell(const char* channel, const char* level) {
    return Dictionary::make({{"ARFCN", channel}, {"BSIC", "17"}, {"RSSI", level}});
}

TEST_F(TrendsTest, ReadsTheNumbersOfACellMonitorsTexts) {
    const auto serving = [](const char* area, const char* level) {
        return Dictionary::make({{"MCC", "262"}, {"LAC", area}, {"CellId", "1501"}, {"RSSI", level}});
    };
    note(monitored(serving("2101", "-71 dBm"), {monitoredCell("70", "-80 dBm"), monitoredCell("44", "-91 dBm")}));
    note(monitored(serving("2102", "-68 dBm"), {monitoredCell("44", "-85 dBm"), monitoredCell("70", "-83 dBm")}));
    EXPECT_EQ(points("/Serving/RSSI"), (Points{{1002s, -71}, {1004s, -68}}));
    EXPECT_EQ(trends.trend("/Serving/RSSI").unit, "dBm");
    EXPECT_EQ(trends.trend("/Serving/RSSI").points[1].text(), "-68 dBm");
    EXPECT_EQ(points("/Neighbours/GSM/ARFCN 70, BSIC 17/RSSI"), (Points{{1002s, -80}, {1004s, -83}}));
    EXPECT_EQ(points("/Neighbours/GSM/ARFCN 44, BSIC 17/RSSI"), (Points{{1002s, -91}, {1004s, -85}}));
    // What names an area or a cell is no level: its changes are kept.
    EXPECT_EQ(trends.names().size(), 3U);
    EXPECT_EQ(trends.changes("/Serving/LAC"), (Changes{{1002s, "2101"}, {1004s, "2102"}}));
    EXPECT_EQ(trends.changes("/Serving/CellId"), (Changes{{1002s, "1501"}}));
}

// Three hours of a screen that changes in every value: what is held does not grow after the first half hour.
TEST_F(TrendsTest, HoldsTheSameForHours) {
    std::size_t afterTheFirst = 0;
    for (int refresh = 0; refresh < 3 * 1800; ++refresh) {
        const DictionaryRef section = Dictionary::make();
        for (int i = 0; i < 10; ++i) section->set(std::to_string(i), reading(100 + refresh * (i + 1) % 97));
        note(section);
        if (refresh == 1800) afterTheFirst = trends.bytes();
    }
    EXPECT_LT(trends.bytes(), afterTheFirst * 11 / 10);
    EXPECT_LT(trends.bytes(), 10U * 2048 + 16384);
    EXPECT_EQ(points("/9").size(), 901U);
}

// New names at every refresh, and numbers that take the most room: whatever comes, there is an end to it.
TEST_F(TrendsTest, NeverHoldsMoreThanFourMegabytes) {
    const std::string name(200, 'n');
    for (int refresh = 0; refresh < 15; ++refresh) {
        const DictionaryRef section = Dictionary::make();
        for (std::int64_t i = 0; i < 1000; ++i) {
            section->set(name + std::to_string(i), reading(refresh % 2 == 0 ? -i - (1LL << 60) : 1LL << 60, 0, kWhole));
            section->set(name + std::to_string(refresh * 1000 + i) + " text",
                         std::string(300, 'x') + std::to_string(i));
        }
        note(section);
        ASSERT_LE(trends.bytes(), Trends::kMostBytes) << refresh;
    }
    EXPECT_GT(trends.bytes(), Trends::kMostBytes / 4);
}

// Each reading takes nine bytes: 1,500 such values fill everything within 300 refreshes.
TEST_F(TrendsTest, DropsWhatWasWrittenLeastRecently) {
    DictionaryRef section = Dictionary::make({{"old", reading(1, 1)}});
    note(section);
    EXPECT_EQ(trends.trend("/old").points.size(), 1U);
    for (int refresh = 0; refresh < 300; ++refresh) {
        section = Dictionary::make({{"old", reading(1, 1)}});
        for (int i = 0; i < 1500; ++i) section->set(std::to_string(i), reading(refresh % 2 == 0 ? 1LL << 60 : 0));
        note(section);
        ASSERT_LE(trends.bytes(), Trends::kMostBytes) << refresh;
    }
    EXPECT_TRUE(trends.trend("/old").points.empty());
    EXPECT_GT(trends.names().size(), 1000U);
}

TEST_F(TrendsTest, ShowsNoTrendOfAnEmptyDisplay) {
    note(Value());
    note("text");
    EXPECT_TRUE(trends.names().empty());
}

}  // namespace
}  // namespace kelvo
