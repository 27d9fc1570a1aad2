#include <gtest/gtest.h>

#include "LogGenerator/LogGenerator.h"
#include "LogGenerator/ShowFields.h"
#include "platform/system/Environment.h"
#include "tests/support/ManualClock.h"

namespace kelvo {
namespace {

constexpr auto kCell = entry(1, {{0, u8, "ID", decimal}});

class History : public testing::Test {
protected:
    void fill(int snapshots) {
        for (int i = 0; i < snapshots; ++i) history()->append(Dictionary::make({{"Description", std::to_string(i)}}));
    }
    ArrayRef history() {
        if (!state.find("History")) state.set("History", Array::make());
        return state["History"].array();
    }
    std::string description(std::size_t index) {
        const Value& text = (*(*history())[index].dictionary())["Description"];
        return text.string() != nullptr ? *text.string() : "";
    }

    test::ManualClock clock{1299230102, 60};  // 2011-03-04 09:15:02 UTC, seen from one hour east
    Environment::Scope environment{{.clock = &clock}};
    Dictionary state;
};

TEST_F(History, TakesACopyOfWhatTheScreensShowWithItsDate) {
    const DictionaryRef display = Dictionary::make({{"Cell ID", "1"}});
    state.set("DisplayState", Bytes{1, 2, 3});
    state.set("Display", display);
    state.set("ExtraInfo", Dictionary::make());
    LogGenerator::updateHistoryInState(state);
    display->set("Cell ID", "2");

    const Value expected = Dictionary::make({{"DisplayState", Bytes{1, 2, 3}},
                                             {"Display", Dictionary::make({{"Cell ID", "1"}})},
                                             {"ExtraInfo", Dictionary::make()},
                                             {"Date", "2011-03-04 10:15:02 +0100"},
                                             {"Description", "Snapshot (2011-03-04 10:15:02 +0100)"}});
    ASSERT_EQ(history()->size(), 1U);
    EXPECT_EQ((*history())[0], expected);
}

TEST_F(History, KeepsTheRowsThatNobodyHasReadYet) {
    const ArrayRef list = Array::make();
    showRows(list, Bytes{7}, 0, 1, kCell);
    state.set("DisplayState", Bytes{1});
    state.set("Display", Dictionary::make({{"Cells", list}}));
    state.set("ExtraInfo", Dictionary::make());
    LogGenerator::updateHistoryInState(state);
    showRows(list, Bytes{8}, 0, 1, kCell);

    const DictionaryRef snapshot = (*history())[0].dictionary();
    EXPECT_EQ((*(*snapshot)["Display"].dictionary())["Cells"], Value(Array::make({Dictionary::make({{"ID", "7"}})})));
    EXPECT_EQ(Value(list), Value(Array::make({Dictionary::make({{"ID", "8"}})})));
}

TEST_F(History, EndsASnapshotAtTheFirstValueThatIsAbsent) {
    LogGenerator::updateHistoryInState(state);
    state.set("DisplayState", Bytes{1});
    LogGenerator::updateHistoryInState(state);
    state.set("Display", Dictionary::make());
    LogGenerator::updateHistoryInState(state);

    ASSERT_EQ(history()->size(), 3U);
    EXPECT_EQ((*history())[0], Value(Dictionary::make()));
    EXPECT_EQ((*history())[1], Value(Dictionary::make({{"DisplayState", Bytes{1}}})));
    EXPECT_EQ((*history())[2], Value(Dictionary::make({{"DisplayState", Bytes{1}}, {"Display", Dictionary::make()}})));
}

TEST_F(History, GrowsToFive) {
    fill(4);
    LogGenerator::updateHistoryInState(state);
    EXPECT_EQ(history()->size(), 5U);
    EXPECT_EQ(description(0), "0");
}

TEST_F(History, DropsTheOldestOfFive) {
    fill(5);
    LogGenerator::updateHistoryInState(state);
    EXPECT_EQ(history()->size(), 5U);
    EXPECT_EQ(description(0), "1");
}

TEST_F(History, DropsThreeOfSeven) {
    fill(7);
    state.set("DisplayState", Bytes{1});
    LogGenerator::updateHistoryInState(state);
    ASSERT_EQ(history()->size(), 5U);
    EXPECT_EQ(description(0), "3");
    EXPECT_EQ(description(3), "6");
    EXPECT_EQ((*history())[4], Value(Dictionary::make({{"DisplayState", Bytes{1}}})));  // the newest
}

}  // namespace
}  // namespace kelvo
