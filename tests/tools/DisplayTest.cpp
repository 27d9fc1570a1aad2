#include <gtest/gtest.h>

#include <limits>

#include "tools/DisplayJson.h"
#include "tools/DisplayText.h"

namespace kelvo {
namespace {

TEST(DisplayText, IndentsAndAlignsValuesAmongSiblings) {
    const Value display = Dictionary::make({{"Level", "-90 dBm"},
                                            {"Serving Cell", Dictionary::make({{"PCI", "7"}, {"Bandwidth", "10 MHz"}})},
                                            {"Set", Array::make({Dictionary::make({{"PCI", "8"}}), "row"})}});
    EXPECT_EQ(displayText(display),
              "Level  -90 dBm\n"
              "Serving Cell\n"
              "  PCI        7\n"
              "  Bandwidth  10 MHz\n"
              "Set\n"
              "  0\n"
              "    PCI  8\n"
              "  1  row\n");
}

TEST(DisplayText, ShowsOrderAndLabelsAsTheScreensDo) {
    const Value display = Dictionary::make({{"02;Second", "b"}, {"01;First", "a"}, {"_sorted", "yes"}});
    EXPECT_EQ(displayText(display), "First   a\nSecond  b\n");
}

TEST(DisplayText, AlignsByCharactersNotBytes) {
    EXPECT_EQ(displayText(Dictionary::make({{"Größe", "1"}, {"Range", "2"}})), "Größe  1\nRange  2\n");
}

TEST(DisplayText, OneLongNameDoesNotPushTheOthersAway) {
    const std::string name(60, 'n');
    const std::string text = displayText(Dictionary::make({{name, "1"}, {"short", "2"}}));
    EXPECT_EQ(text, name + "  1\nshort" + std::string(35, ' ') + "  2\n");
}

TEST(DisplayText, AnEmptyValueLeavesNoBlanksBehind) {
    EXPECT_EQ(displayText(Dictionary::make({{"Name", ""}, {"Longer", "x"}})), "Name\nLonger  x\n");
}

TEST(DisplayText, ALeafAtTheRootShowsItself) {
    EXPECT_EQ(displayText(Value()), "Kelvo  (unknown)\n");
    EXPECT_EQ(displayText(Value("bare")), "Kelvo  bare\n");
}

TEST(DisplayText, ReplacesWhatATerminalWouldObey) {
    EXPECT_EQ(printable("a\x1b[2J\n\x7f\xc2\x9b z\xff"), "a\uFFFD[2J\uFFFD\uFFFD\uFFFD z\uFFFD");
}

TEST(DisplayJson, KeepsEveryKindAndTheOrder) {
    const Value value = Dictionary::make({{"z", "text"},
                                          {"_sorted", ""},
                                          {"a", Array::make({1, 2.5, true, Value()})},
                                          {"d", Bytes{0xff, 0x00, 0x10, 0x20}},
                                          {"t", Date(std::chrono::seconds(1299230102))}});
    EXPECT_EQ(jsonFrom(value).dump(), R"({"z":"text","_sorted":"","a":[1,2.5,true,null],"d":{"$data":"/wAQIA=="},)"
                                      R"("t":{"$date":"2011-03-04T09:15:02Z"}})");
}

TEST(DisplayJson, ADateNoCalendarHoldsIsNull) {
    EXPECT_EQ(jsonFrom(Date(std::chrono::milliseconds(std::numeric_limits<std::int64_t>::max()))).dump(),
              R"({"$date":null})");
}

TEST(DisplayJson, EscapesWhatATerminalWouldObey) {
    const std::string text = printedJson(jsonFrom(Value("a\x1b[2J\n\x7f\xc2\x9b z\u00a0é")));
    EXPECT_EQ(text, "\"a\\u001b[2J\\n\\u007f\\u009b z\u00a0é\"\n");
}

TEST(DisplayJson, ReplacesBytesThatAreNotUtf8) { EXPECT_EQ(printedJson(jsonFrom(Value("a\xff"))), "\"a\uFFFD\"\n"); }

}  // namespace
}  // namespace kelvo
