#include "LogGenerator/RowWriter.h"

#include <gtest/gtest.h>

#include <algorithm>

#include "LogGenerator/GSMUMTS/NeighboringCells.h"
#include "LogGenerator/ShowFields.h"
#include "tests/support/CellArray.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

constexpr ValueTable kStatus({{0, "A"}, {1, "B"}}, "Unknown");
constexpr auto kCell = entry(2, {{0, u8, "Status", label(kStatus).absentAt(3)}, {1, u8, "ID", decimal}});

ArrayRef shown(const ArrayRef& list, const Bytes& bytes) {
    showRows(list, bytes, 0, bytes.size() / 2, kCell);
    return list;
}

TEST(RowWriter, WritesARowOverWhereItStands) {
    const ArrayRef list = shown(Array::make(), {0, 7});
    const Dictionary* row = (*list)[0].dictionary().get();
    shown(list, {1, 8});
    EXPECT_EQ((*list)[0].dictionary().get(), row);
    EXPECT_EQ(Value(list), Value(Array::make({Dictionary::make({{"Status", "B"}, {"ID", "8"}})})));
}

TEST(RowWriter, LeavesARowThatSomebodyHoldsAsItIs) {
    const ArrayRef list = shown(Array::make(), {0, 7});
    const DictionaryRef held = (*list)[0].dictionary();
    shown(list, {1, 8});
    EXPECT_EQ(Value(held), Value(Dictionary::make({{"Status", "A"}, {"ID", "7"}})));
    EXPECT_EQ(Value((*list)[0]), Value(Dictionary::make({{"Status", "B"}, {"ID", "8"}})));
}

TEST(RowWriter, DropsTheRowsThatAreNotWrittenAgain) {
    const ArrayRef list = shown(Array::make(), {0, 7, 0, 8, 0, 9});
    EXPECT_EQ(shown(list, {1, 1})->size(), 1U);
    EXPECT_TRUE(shown(list, {})->empty());
}

TEST(RowWriter, KeepsTheOrderOfTheTableWhenAKeyComesBack) {
    const ArrayRef list = shown(Array::make(), {0, 7});
    EXPECT_EQ(test::keysOf((*shown(list, {3, 7}))[0]), (std::vector<std::string>{"ID"}));
    EXPECT_EQ(test::keysOf((*shown(list, {1, 7}))[0]), (std::vector<std::string>{"Status", "ID"}));
}

TEST(RowWriter, ReplacesWhatTheTemplateHasAsRows) {
    const ArrayRef list = Array::make({"row", Dictionary::make({{"Placeholder", "–"}})});
    EXPECT_EQ(Value(shown(list, {0, 1, 1, 2})), Value(Array::make({Dictionary::make({{"Status", "A"}, {"ID", "1"}}),
                                                                   Dictionary::make({{"Status", "B"}, {"ID", "2"}})})));
}

TEST(RowWriter, WritesNowhereWithoutAList) { showRows(nullptr, Bytes{0, 1}, 0, 1, kCell); }

TEST(OwnArray, IsANewOneWhenSomebodyHoldsTheOld) {
    Value value;
    const ArrayRef first = ownArray(value);
    EXPECT_EQ(value.array(), first);
    EXPECT_NE(ownArray(value), first);  // held here
    const Array* second = value.array().get();
    EXPECT_EQ(ownArray(value).get(), second);
}

TEST(CellInfo, ReadsAnArrayAnewWhenItsBytesChangeInPlace) {
    test::Fed<NeighboringCells> section(Array::make());
    Bytes bytes = test::cellArray({test::cell("GSM", "Neighbor", {{"kPLCellMonitorARFCN", 512}})}).bytes();
    section.feed(bytes, 0xff0001);
    EXPECT_EQ(section.row(0, "ARFCN"), "512");
    const auto digits = std::search(bytes.begin(), bytes.end(), std::begin("512"), std::end("512") - 1);
    ASSERT_NE(digits, bytes.end());
    *digits = '6';
    section.feed(bytes, 0xff0001);
    EXPECT_EQ(section.row(0, "ARFCN"), "612");
}

}  // namespace
}  // namespace kelvo
