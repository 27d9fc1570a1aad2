#include <gtest/gtest.h>

#include "overview/Tracker.h"
#include "tests/overview/Observations.h"

// The cells around, as a tracker keeps and orders them.
namespace kelvo::overview {
namespace {

using namespace std::chrono_literals;

TEST(Tracker, ACellStaysThirtySecondsAndIsMarkedTenMore) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.cells = {heard("N", -100, 1)};
    tracker.note(seen, kStart);
    tracker.note(seen, kStart + 30s);  // the list stands there unchanged: nobody has heard the cell again
    ASSERT_EQ(tracker.cells().size(), 1u);
    EXPECT_FALSE(tracker.cells()[0].isLost);
    EXPECT_EQ(tracker.cells()[0].lastHeard, kStart);
    tracker.note(servedBy("A", 2), kStart + 31s);
    ASSERT_EQ(tracker.cells().size(), 1u);
    EXPECT_TRUE(tracker.cells()[0].isLost);
    tracker.note(servedBy("A", 3), kStart + 41s);
    EXPECT_TRUE(tracker.cells().empty());
}

TEST(Tracker, ACellThatIsHeardAgainIsLostNoMore) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.cells = {heard("N", -100, 1)};
    tracker.note(seen, kStart);
    seen.cells = {heard("N", -97, 2)};
    tracker.note(seen, kStart + 35s);
    EXPECT_FALSE(tracker.cells()[0].isLost);
    EXPECT_DOUBLE_EQ(tracker.cells()[0].heard.level->figure.number, -97);
}

TEST(Tracker, CarriersDoNotOverwriteEachOther) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.cells = {heard("EARFCN 1300, PCI 5", -100, 1)};
    tracker.note(seen, kStart);
    seen.cells = {heard("EARFCN 2850, PCI 5", -90, 2)};
    tracker.note(seen, kStart + 1s);
    EXPECT_EQ(identities(tracker), (std::vector<std::string>{"EARFCN 2850, PCI 5", "EARFCN 1300, PCI 5"}));
}

TEST(Tracker, RowsDoNotJumpAtADecibel) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.cells = {heard("N", -90, 1), heard("M", -95, 1)};
    tracker.note(seen, kStart);
    seen.cells = {heard("N", -93, 2), heard("M", -91, 2)};  // two more, and not yet enough
    tracker.note(seen, kStart + 1s);
    EXPECT_EQ(identities(tracker), (std::vector<std::string>{"N", "M"}));
    seen.cells = {heard("N", -93.5, 3), heard("M", -91, 3)};
    tracker.note(seen, kStart + 2s);
    EXPECT_EQ(identities(tracker), (std::vector<std::string>{"M", "N"}));
}

TEST(Tracker, NoRowStandsBelowOneThatIsMuchWeaker) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.cells = {heard("K", -94, 1), heard("L", -93, 1), heard("M", -92, 1), heard("N", -90, 1)};
    tracker.note(seen, kStart);
    EXPECT_EQ(identities(tracker), (std::vector<std::string>{"N", "K", "L", "M"}));
}

TEST(Tracker, ACellMeasuredBeforeItsCodeIsReadIsThatCell) {
    Tracker tracker;
    Observation seen = servedBy("ARFCN 21, BSIC 44", 1);
    seen.cells = {heard("ARFCN 23, BSIC 42", -80, 1), heard("ARFCN 2", -70, 1)};
    tracker.note(seen, kStart);
    seen.cells = {heard("ARFCN 23", -81, 2), heard("ARFCN 2, BSIC 7", -71, 2), heard("ARFCN 21", -60, 2)};
    tracker.note(seen, kStart + 1s);
    EXPECT_EQ(identities(tracker), (std::vector<std::string>{"ARFCN 2, BSIC 7", "ARFCN 23, BSIC 42"}));
    EXPECT_DOUBLE_EQ(tracker.cells()[1].heard.level->figure.number, -81);
}

TEST(Tracker, WhileNothingIsNewCellsGetLostAndGo) {
    Tracker tracker;
    Observation seen = servedBy("A", 1);
    seen.cells = {heard("N", -100, 1)};
    tracker.note(seen, kStart);
    tracker.letPass(kStart + 31s);
    EXPECT_TRUE(tracker.cells()[0].isLost);
    tracker.letPass(kStart + 41s);
    EXPECT_TRUE(tracker.cells().empty());
}

}  // namespace
}  // namespace kelvo::overview
