#include "tools/export/WrittenValues.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

/// A text that the record with this number has written.
Value by(std::uint64_t record, const char* text) {
    Value value = text;
    value.setRecord(record);
    return value;
}

Value cell(std::uint64_t record, const char* pci, const char* level) {
    return Dictionary::make({{"Physical Cell ID", by(record, pci)}, {"Level", by(record, level)}});
}

struct WrittenValuesTest : testing::Test {
    /// "path = text" for what the record has written.
    std::vector<std::string> written(std::uint64_t record, const Value& display) {
        std::vector<std::string> lines;
        for (const auto& [series, value] : values.by(record, display)) {
            lines.push_back(series->path + " = " + *value->string());
        }
        return lines;
    }
    using Lines = std::vector<std::string>;

    WrittenValues values{Technology::LTE, [](const std::string& path) { return path.find("Secret") == path.npos; }};
};

TEST_F(WrittenValuesTest, AreThoseThatBearTheRecordsNumber) {
    const Value display = Dictionary::make(
        {{"A", Dictionary::make({{"One", by(1, "1")}, {"Two", by(2, "2")}, {"Template", "–"}})}, {"B", by(2, "b")}});
    EXPECT_EQ(written(1, display), Lines{"/A/One = 1"});
    EXPECT_EQ(written(2, display), (Lines{"/A/Two = 2", "/B = b"}));
    EXPECT_EQ(written(3, display), Lines{});
}

TEST_F(WrittenValuesTest, KeepTheirSeriesWhenTheirNeighborsComeAndGo) {
    const DictionaryRef section = Dictionary::make({{"One", by(1, "1")}, {"Two", by(1, "2")}, {"Three", by(1, "3")}});
    const Value display = Dictionary::make({{"A", section}});
    const Series* two = values.by(1, display)[1].series;
    section->remove("One");
    section->set("Four", by(2, "4"));
    section->set("Two", by(2, "II"));
    section->set("Three", by(2, "III"));
    EXPECT_EQ(written(2, display), (Lines{"/A/Two = II", "/A/Three = III", "/A/Four = 4"}));
    EXPECT_EQ(values.by(2, display)[0].series, two);
    section->set("One", by(3, "I"));
    EXPECT_EQ(written(3, display), Lines{"/A/One = I"});
}

TEST_F(WrittenValuesTest, RowsAreCalledAfterTheirCellWhereverItStands) {
    const ArrayRef list = Array::make({cell(1, "7", "-80"), cell(1, "9", "-90")});
    const Value display = Dictionary::make({{"Cells", list}});
    EXPECT_EQ(written(1, display), (Lines{"/Cells/PCI 7/Physical Cell ID = 7", "/Cells/PCI 7/Level = -80",
                                          "/Cells/PCI 9/Physical Cell ID = 9", "/Cells/PCI 9/Level = -90"}));
    const Series* nine = values.by(1, display)[3].series;
    (*list)[0] = cell(2, "9", "-91");
    (*list)[1] = cell(2, "11", "-95");
    EXPECT_EQ(written(2, display), (Lines{"/Cells/PCI 9/Physical Cell ID = 9", "/Cells/PCI 9/Level = -91",
                                          "/Cells/PCI 11/Physical Cell ID = 11", "/Cells/PCI 11/Level = -95"}));
    EXPECT_EQ(values.by(2, display)[1].series, nine);
}

TEST_F(WrittenValuesTest, RowsAreCalledAfterTheChannelThatAllOfThemAreOn) {
    const DictionaryRef measured = Dictionary::make({{"E-ARFCN", by(1, "1300")}});
    const Value display = Dictionary::make({{"Connected mode LTE Intra-frequency Measurement", measured},
                                            {"Measured Neighbor Cells", Array::make({cell(2, "7", "-80")})}});
    EXPECT_EQ(written(2, display)[1], "/Measured Neighbor Cells/PCI 7, EARFCN 1300/Level = -80");
    measured->set("E-ARFCN", by(3, "100"));  // the same row is another cell now
    EXPECT_EQ(written(2, display)[1], "/Measured Neighbor Cells/PCI 7, EARFCN 100/Level = -80");
}

TEST_F(WrittenValuesTest, WhatHasTheSameNameIsOneSeries) {
    const Value fingers =
        Dictionary::make({{"_sorted", "_sorted"}, {"00;12", by(1, "-3 dB")}, {"01;12", by(1, "-4 dB")}});
    const Value display = Dictionary::make({{"Fingers", fingers}});
    EXPECT_EQ(written(1, display), (Lines{"/Fingers/12 = -3 dB", "/Fingers/12 = -4 dB"}));
    const auto both = values.by(1, display);
    EXPECT_EQ(both[0].series, both[1].series);
}

TEST_F(WrittenValuesTest, RowsThatNothingNamesAreNumbered) {
    const Value display = Dictionary::make(
        {{"Errors", Array::make({Dictionary::make({{"Count", by(1, "5")}}), by(1, "alone"), by(2, "not yet")})}});
    EXPECT_EQ(written(1, display), (Lines{"/Errors/0/Count = 5", "/Errors/1 = alone"}));
}

TEST_F(WrittenValuesTest, RowsInRowsAreFound) {
    const Value inner = Array::make({by(1, "41"), by(1, "42")});
    const Value row = Dictionary::make({{"TSNUM", by(1, "3")}, {"SIR", inner}});
    const Value display = Dictionary::make({{"List", Array::make({row})}});
    EXPECT_EQ(written(1, display),
              (Lines{"/List/timeslot 3/TSNUM = 3", "/List/timeslot 3/SIR/0 = 41", "/List/timeslot 3/SIR/1 = 42"}));
}

TEST_F(WrittenValuesTest, AnOrdersMarksAreNoPartOfANameAndNoReading) {
    const Value sorted = Dictionary::make({{"_sorted", by(1, "_sorted")}, {"02;RSCP", by(1, "-80")}});
    const Value plain = Dictionary::make({{"02;RSCP", by(1, "-81")}});
    const Value display = Dictionary::make({{"Sorted", sorted}, {"Plain", plain}});
    EXPECT_EQ(written(1, display), (Lines{"/Sorted/RSCP = -80", "/Plain/02;RSCP = -81"}));
}

TEST_F(WrittenValuesTest, ATextMayBecomeAScreenAndATextAgain) {
    const DictionaryRef display = Dictionary::make({{"Active Set", by(1, "(none)")}});
    EXPECT_EQ(written(1, display), Lines{"/Active Set = (none)"});
    display->set("Active Set", Dictionary::make({{"180", by(2, "-9 dB")}}));
    EXPECT_EQ(written(2, display), Lines{"/Active Set/180 = -9 dB"});
    display->set("Active Set", by(3, "(none)"));
    EXPECT_EQ(written(3, display), Lines{"/Active Set = (none)"});
}

TEST_F(WrittenValuesTest, WhatIsNotWantedIsLeftOut) {
    const Value display = Dictionary::make({{"Secret", by(1, "1")}, {"Open", by(1, "2")}});
    EXPECT_EQ(written(1, display), Lines{"/Open = 2"});
}

TEST_F(WrittenValuesTest, ForgetsAStreamOfEverNewNames) {
    for (std::uint64_t record = 1; !values.isFull(); ++record) {
        ASSERT_LT(record, 200'000U);
        const std::string name = std::to_string(record);
        const Value display = Dictionary::make({{"Cells", Array::make({cell(record, name.c_str(), "-80")})}});
        ASSERT_EQ(written(record, display).size(), 2U);
    }
    values.forget();
    EXPECT_FALSE(values.isFull());
    const Value display = Dictionary::make({{"Cells", Array::make({cell(1, "7", "-80")})}});
    EXPECT_EQ(written(1, display)[1], "/Cells/PCI 7/Level = -80");
}

}  // namespace
}  // namespace kelvo
