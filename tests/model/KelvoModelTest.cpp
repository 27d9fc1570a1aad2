#include "model/KelvoModel.h"

#include "tests/model/MonitoredModel.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;

class KelvoModelTest : public test::MonitoredModel {};

TEST_F(KelvoModelTest, ShowsNothingWithoutAGenerator) {
    EXPECT_EQ(model->topLevelNodes(), nullptr);
    EXPECT_EQ(model->nodeAtPath("/"), nullptr);
    EXPECT_EQ(model->getSaveContents(), nullptr);
}

TEST_F(KelvoModelTest, HandsAMessageToTheGeneratorAndReturnsNoReply) {
    startLte();
    EXPECT_EQ(deliver(servingCell(301)), Bytes());
    EXPECT_EQ(shown(), "301");
    EXPECT_EQ(shown("/Serving Cell Info"), "(children)");
}

TEST_F(KelvoModelTest, IgnoresAMessageOfAnotherId) {
    startLte();
    EXPECT_EQ(deliver(servingCell(301), 7), Bytes());
    EXPECT_EQ(deliver(servingCell(302), -1), Bytes());
    EXPECT_TRUE(log.lines().empty());
    queue.advance(2s);
    EXPECT_EQ(updates, 0);
}

TEST_F(KelvoModelTest, TellsTheScreensAtTheNextTickOnly) {
    startLte();
    queue.advance(1s);
    deliver(servingCell(301));
    deliver(servingCell(302));
    queue.advance(1s - 1ns);
    EXPECT_EQ(updates, 0);
    queue.advance(1ns);
    EXPECT_EQ(updates, 1);
    queue.advance(60s);
    EXPECT_EQ(updates, 1);
}

TEST_F(KelvoModelTest, TellsTheScreensFromTheQueueNotFromTheTick) {
    model->updateWithData({});
    model->refresh();
    EXPECT_EQ(updates, 0);
    queue.run();
    EXPECT_EQ(updates, 1);
}

TEST_F(KelvoModelTest, CountsDataAsNewEvenWithoutAGenerator) {
    model->updateWithData(servingCell(301));
    model->refresh(Value("anything"));
    queue.run();
    EXPECT_EQ(updates, 1);
    model->refresh(Value());
    queue.run();
    EXPECT_EQ(updates, 1);
}

TEST_F(KelvoModelTest, KeepsTheTreeUntilATickFindsNewData) {
    startLte();
    deliver(servingCell(301));
    const NodeRef first = model->topLevelNodes();
    EXPECT_EQ(model->topLevelNodes(), first);
    queue.advance(2s);
    const NodeRef second = model->topLevelNodes();
    EXPECT_NE(second, first);

    deliver(servingCell(302));
    EXPECT_EQ(model->topLevelNodes(), second);
    EXPECT_EQ(shown(), "301");
    queue.advance(2s);
    EXPECT_NE(model->topLevelNodes(), second);
    EXPECT_EQ(shown(), "302");

    const NodeRef third = model->topLevelNodes();
    queue.advance(60s);
    EXPECT_EQ(model->topLevelNodes(), third);
}

TEST_F(KelvoModelTest, LeavesAnOlderTreeToWhoeverStillHoldsIt) {
    startLte();
    deliver(servingCell(301));
    const NodeRef held = model->nodeAtPath(kCellPath);
    deliver(servingCell(302));
    queue.advance(2s);
    ASSERT_EQ(shown(), "302");
    EXPECT_EQ(*held->value(), "301");
}

TEST_F(KelvoModelTest, BuildsTheTreeWhenAPathIsAskedForFirst) {
    startLte();
    deliver(servingCell(301));
    EXPECT_NE(model->nodeAtPath("/"), nullptr);
    EXPECT_EQ(model->nodeAtPath("/"), model->topLevelNodes());
    EXPECT_EQ(shown("/Serving Cell Info/Nothing"), "(no node)");
    EXPECT_EQ(shown(""), "(no node)");
}

TEST_F(KelvoModelTest, ShowsADisplayThatIsNotThereYetAsAnUnknownLeaf) {
    startLte();
    EXPECT_EQ(model->topLevelNodes()->displayName(), "Kelvo");
    EXPECT_EQ(shown("/"), "(unknown)");
}

TEST_F(KelvoModelTest, RecordsOneSnapshotARebuild) {
    startLte();
    const auto snapshots = [this] {  // the last element is the raw log, not a snapshot
        return model->getSaveContents()->size() - 1;
    };
    deliver(servingCell(301));
    model->topLevelNodes();
    model->topLevelNodes();
    model->nodeAtPath("/");
    EXPECT_EQ(snapshots(), 1U);
    deliver(servingCell(302));
    model->topLevelNodes();
    EXPECT_EQ(snapshots(), 1U);
    queue.advance(2s);
    model->topLevelNodes();
    EXPECT_EQ(snapshots(), 2U);
}

TEST_F(KelvoModelTest, RestartsAtTheTickAfterTheServiceHasDied) {
    startLte();
    queue.advance(1s);
    ports.killPeer();
    EXPECT_TRUE(model->isConnected());
    EXPECT_TRUE(log.lines().empty());
    queue.advance(1s);
    EXPECT_FALSE(model->isConnected());
    EXPECT_EQ(errors(), (Texts{" ***** INVALIDATED %p *****", "Could not create the remote port!",
                               "Could not create the ports necessary"}));

    ports.listening.insert("service");
    queue.advance(5s);
    EXPECT_TRUE(model->isConnected());
    EXPECT_EQ(errors().back(), "Starting the display update timer");
    deliver(servingCell(301));
    queue.advance(2s - 1ns);
    EXPECT_EQ(updates, 0);
    queue.advance(1ns);
    EXPECT_EQ(updates, 1);
}

TEST_F(KelvoModelTest, TellsOfALostConnectionAlsoWhenNothingNewHasCome) {
    startLte();
    deliver(servingCell(301));
    queue.advance(2s);
    const NodeRef shownBefore = model->topLevelNodes();
    ports.killPeer();
    told.clear();
    queue.advance(2s);
    EXPECT_EQ(told, Texts{"The telephony service does not answer"});
    EXPECT_FALSE(model->isConnected());
    queue.advance(60s);
    EXPECT_EQ(told.size(), 1U);
    EXPECT_EQ(updates, 1);
    EXPECT_EQ(model->topLevelNodes(), shownBefore);
}

TEST_F(KelvoModelTest, RecordsNoSnapshotForAConnectionLostBeforeTheFirstRecord) {
    startLte();
    ports.killPeer();
    queue.advance(60s);
    EXPECT_FALSE(model->isConnected());
    EXPECT_EQ(updates, 0);
    EXPECT_EQ(model->getSaveContents()->size(), 1U);  // the raw log alone
}

TEST_F(KelvoModelTest, RestartsAtOnceWhenAnotherServiceIsThere) {
    startLte();
    ports.killPeer();
    ports.listening.insert("service");
    queue.advance(2s);
    EXPECT_TRUE(model->isConnected());
    EXPECT_EQ(queries(), 1U);
    queue.advance(60s);
    EXPECT_EQ(queries(), 1U);
}

TEST_F(KelvoModelTest, ShowsAtTheTickOfADeadServiceWhatCameBefore) {
    startLte();
    deliver(servingCell(301));
    ports.killPeer();
    queue.advance(2s);
    EXPECT_EQ(updates, 1);
    EXPECT_EQ(shown(), "301");
}

TEST_F(KelvoModelTest, RestartsWhenItsOwnPortBecomesInvalid) {
    startLte();
    ports.local(kLocalPort)->invalidate();
    EXPECT_TRUE(model->isConnected());
    EXPECT_EQ(errors().front(), " ***** INVALIDATED %p *****");
    EXPECT_EQ(queries(), 1U);
    EXPECT_EQ(ports.openLocals(), 1U);
    EXPECT_EQ(ports.openRemotes(), 1U);
}

TEST_F(KelvoModelTest, TearsItsPortsDownQuietlyWhenToldToRestart) {
    startLte();
    model->restartMonitor();
    const Texts texts = errors();
    EXPECT_EQ(std::count(texts.begin(), texts.end(), " ***** INVALIDATED %p *****"), 0);
    EXPECT_EQ(ports.openLocals(), 1U);
    EXPECT_EQ(ports.openRemotes(), 1U);
    EXPECT_EQ(queries(), 1U);
}

TEST_F(KelvoModelTest, KeepsValuesAndHistoryAcrossARestart) {
    startLte();
    deliver(servingCell(301));
    model->topLevelNodes();
    model->restartMonitor();
    EXPECT_EQ(shown(), "301");
    deliver(servingCell(302));
    queue.advance(2s);
    EXPECT_EQ(shown(), "302");
    EXPECT_EQ(model->getSaveContents()->size(), 3U);  // two snapshots and the raw log
}

TEST_F(KelvoModelTest, RefreshesOnWhateverTheServerConnectionAnnounces) {
    model->updateWithData(servingCell(301));
    telephony.announces = true;
    startLte();
    queue.run();
    EXPECT_EQ(updates, 1);
    telephony.lastCallback("something else");
    queue.run();
    EXPECT_EQ(updates, 1);  // nothing has come since
    deliver(servingCell(302));
    telephony.lastCallback("something else");
    queue.run();
    EXPECT_EQ(updates, 2);
}

TEST_F(KelvoModelTest, KeepsItsMemoryWithinBoundsUnderAFlood) {
    startLte();
    const Bytes longest = test::Record(0xB0C2, kMaxMessageSize).u16(14, 7).bytes();
    for (int refresh = 0; refresh < 7; ++refresh) {
        for (int i = 0; i < 100; ++i) deliver(longest);  // 13 megabytes
        queue.advance(2s);
        model->topLevelNodes();
    }
    deliver(servingCell(302));
    queue.advance(2s);
    EXPECT_EQ(shown(), "302");
    std::size_t kept = 0;
    const ArrayRef contents = model->getSaveContents();
    for (const Value& entry : *contents) {
        const Value& raw = (*entry.dictionary())["DisplayState"];
        if (raw.data() != nullptr) kept += raw.data()->size();
    }
    EXPECT_LE(kept, 5U * 4 * 1024 * 1024);
    EXPECT_GT(kept, 4U * 3 * 1024 * 1024);
}

TEST_F(KelvoModelTest, EndsQuietlyAndLeavesNothingBehind) {
    startLte();
    deliver(servingCell(301));
    model->refresh();  // the screens' update is on the queue now
    model.reset();
    EXPECT_EQ(errors(), Texts());
    EXPECT_EQ(ports.openLocals(), 0U);
    EXPECT_EQ(ports.openRemotes(), 0U);
    queue.advance(60s);
    telephony.lastCallback("late");
    EXPECT_EQ(updates, 0);
    EXPECT_TRUE(ports.sent.empty());
}

}  // namespace
}  // namespace kelvo
