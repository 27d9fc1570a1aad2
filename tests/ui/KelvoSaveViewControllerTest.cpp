#include "ui/KelvoSaveViewController.h"

#include <gtest/gtest.h>

#include <QAbstractItemModelTester>
#include <QSignalSpy>
#include <fstream>
#include <iterator>

#include "platform/encodings/PropertyList.h"
#include "platform/system/Environment.h"
#include "tests/support/ManualClock.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/ManualWorker.h"
#include "tests/support/RecordingLog.h"
#include "tests/ui/AppWorld.h"
#include "tests/ui/FakeHost.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;

class SaveScreen : public testing::Test {
protected:
    KelvoSaveViewController& open(const ArrayRef& history) {
        screen = std::make_unique<KelvoSaveViewController>(
            history, KelvoSaveViewController::Services{queue, host, worker, folder.path().string()});
        return *screen;
    }
    static ArrayRef twoEntries() {
        return Array::make({Dictionary::make({{"Description", "Snapshot (2011-03-04 09:15:00 +0000)"}}),
                            Dictionary::make({{"Description", "DLF binary (161 bytes)"}, {"DLF", Bytes{1, 2}}})});
    }
    std::string pathAt(long long seconds) const {
        return (folder.path() / ("KelvoSnapshot-" + std::to_string(seconds) + ".kelvo")).string();
    }
    static std::string textOfFile(const std::string& path) {
        std::ifstream file(path, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
    }
    static Value contents(const std::string& path) {
        const std::string text = textOfFile(path);
        const Result<Value> value = readPropertyList(bytesOf(text));
        return value ? *value : Value();
    }
    std::ptrdiff_t files() const {
        return std::distance(std::filesystem::directory_iterator(folder.path()), std::filesystem::directory_iterator());
    }

    test::ManualClock clock{1299230102, 120};  // 2011-03-04 09:15:02 UTC, seen from two hours east
    test::RecordingLog log;
    Environment::Scope environment{{.log = &log, .clock = &clock}};
    test::ManualQueue queue;
    test::ManualWorker worker;
    test::FakeHost host;
    test::TemporaryDirectory folder;
    std::unique_ptr<KelvoSaveViewController> screen;
};

TEST_F(SaveScreen, ListsTheEntriesByTheirDescriptions) {
    KelvoSaveViewController& save = open(twoEntries());
    const QAbstractItemModelTester tester(&save, QAbstractItemModelTester::FailureReportingMode::Warning);
    ASSERT_EQ(save.rowCount(), 2);
    const int role = KelvoSaveViewController::DescriptionRole;
    EXPECT_EQ(save.data(save.index(0), role).toString(), QStringLiteral("Snapshot (2011-03-04 09:15:00 +0000)"));
    EXPECT_EQ(save.data(save.index(1), role).toString(), QStringLiteral("DLF binary (161 bytes)"));
}

TEST_F(SaveScreen, ListsNothingForAnEmptyHistory) { EXPECT_EQ(open(Array::make()).rowCount(), 0); }

TEST_F(SaveScreen, ShowsAnEntryWithoutADescriptionAsAnEmptyRow) {
    KelvoSaveViewController& save = open(Array::make({Dictionary::make()}));
    EXPECT_TRUE(save.data(save.index(0), KelvoSaveViewController::DescriptionRole).toString().isEmpty());
}

TEST_F(SaveScreen, WritesTheTimeItWasOpenedTheHistoryAndTheDescription) {
    KelvoSaveViewController& save = open(twoEntries());
    clock.advance(58s);
    save.setSaveDescription(QStringLiteral("Håkon's drive <1>"));
    save.savePressed();

    const Value expected = Dictionary::make(
        {{"Timestamp", "2011-03-04 09:15:02 +0000"}, {"Data", twoEntries()}, {"Description", "Håkon's drive <1>"}});
    EXPECT_EQ(contents(pathAt(1299230160)), expected);
    EXPECT_EQ(files(), 1);
    EXPECT_TRUE(textOfFile(pathAt(1299230160)).starts_with("<?xml"));
    EXPECT_TRUE(host.alerts.isEmpty());
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(SaveScreen, WritesTheThreePartsInTheirOrder) {
    open(Array::make()).savePressed();
    const std::string text = textOfFile(pathAt(1299230102));
    EXPECT_LT(text.find("Timestamp"), text.find("Data"));
    EXPECT_LT(text.find("Data"), text.find("Description"));
}

TEST_F(SaveScreen, WritesAnEmptyListAndAnEmptyDescription) {
    open(Array::make()).savePressed();
    const Value expected =
        Dictionary::make({{"Timestamp", "2011-03-04 09:15:02 +0000"}, {"Data", Array::make()}, {"Description", ""}});
    EXPECT_EQ(contents(pathAt(1299230102)), expected);
}

TEST_F(SaveScreen, LeavesOutADescriptionThatIsAbsent) {
    KelvoSaveViewController& save = open(Array::make());
    save.clearSaveDescription();
    save.savePressed();
    const Value expected = Dictionary::make({{"Timestamp", "2011-03-04 09:15:02 +0000"}, {"Data", Array::make()}});
    EXPECT_EQ(contents(pathAt(1299230102)), expected);
}

TEST_F(SaveScreen, WritesTheTimeAloneWhenThereIsNoHistoryAtAll) {
    KelvoSaveViewController& save = open(nullptr);
    EXPECT_EQ(save.rowCount(), 0);
    save.savePressed();
    EXPECT_EQ(contents(pathAt(1299230102)), Value(Dictionary::make({{"Timestamp", "2011-03-04 09:15:02 +0000"}})));
}

TEST_F(SaveScreen, KeepsWhatItWasHandedWhenTheHistoryMovesOn) {
    const ArrayRef history = twoEntries();
    KelvoSaveViewController& save = open(history);
    history->clear();
    EXPECT_EQ(save.rowCount(), 2);
}

TEST_F(SaveScreen, ReplacesASnapshotOfTheSameSecondInPlace) {
    KelvoSaveViewController& first = open(twoEntries());
    first.setSaveDescription(QStringLiteral("a long description that a shorter file must not keep"));
    first.savePressed();
    std::filesystem::create_hard_link(pathAt(1299230102), folder.path() / "other-name");
    KelvoSaveViewController& second = open(Array::make());
    second.setSaveDescription(QStringLiteral("second"));
    second.savePressed();

    const Value expected = Dictionary::make(
        {{"Timestamp", "2011-03-04 09:15:02 +0000"}, {"Data", Array::make()}, {"Description", "second"}});
    EXPECT_EQ(contents(pathAt(1299230102)), expected);
    EXPECT_EQ(contents((folder.path() / "other-name").string()), expected);  // the same file, written over
}

TEST_F(SaveScreen, LogsAlertsAndClosesAllTheSameWhenTheFileCannotBeWritten) {
    KelvoSaveViewController& save = open(twoEntries());
    std::filesystem::remove(folder.path());
    save.savePressed();

    const std::vector<test::RecordingLog::Line> expected = {{3, "Unable to write snapshot to " + pathAt(1299230102)}};
    EXPECT_EQ(log.lines(), expected);
    EXPECT_EQ(host.alerts, QStringList(QStringLiteral("File Error|Unable to write file to disk|Close")));
    EXPECT_FALSE(std::filesystem::exists(folder.path()));
    queue.run();
    EXPECT_EQ(host.saveViewsClosed, 1);
}

TEST_F(SaveScreen, ClosesOnlyOnceItsButtonHasReturned) {
    open(Array::make()).savePressed();
    EXPECT_EQ(host.saveViewsClosed, 0);
    queue.run();
    EXPECT_EQ(host.saveViewsClosed, 1);
}

TEST_F(SaveScreen, StaysAsItIsUntilTheFileIsWritten) {
    worker.held = true;
    KelvoSaveViewController& save = open(twoEntries());
    const QSignalSpy changes(&save, &KelvoSaveViewController::savingChanged);
    save.setSaveDescription(QStringLiteral("at the door"));
    save.savePressed();
    EXPECT_TRUE(save.isSaving());
    EXPECT_EQ(changes.count(), 1);
    save.setSaveDescription(QStringLiteral("too late"));
    save.savePressed();
    save.cancelPressed();
    queue.run();
    EXPECT_EQ(host.saveViewsClosed, 0);
    EXPECT_EQ(files(), 0);

    clock.advance(9s);  // the file keeps the second in which Save was pressed
    worker.finish();
    EXPECT_EQ(host.saveViewsClosed, 0);
    queue.run();
    EXPECT_EQ(host.saveViewsClosed, 1);
    ASSERT_EQ(files(), 1);
    EXPECT_EQ((*contents(pathAt(1299230102)).dictionary())["Description"], Value("at the door"));
}

TEST_F(SaveScreen, LogsAFailureThatComesAfterItHasGoneAndAsksNobody) {
    worker.held = true;
    open(twoEntries()).savePressed();
    screen.reset();
    std::filesystem::remove(folder.path());
    worker.finish();
    queue.run();
    EXPECT_EQ(log.lines().size(), 1U);
    EXPECT_TRUE(host.alerts.isEmpty());
    EXPECT_EQ(host.saveViewsClosed, 0);
}

TEST_F(SaveScreen, WritesNothingWhenItIsCancelled) {
    open(twoEntries()).cancelPressed();
    EXPECT_EQ(host.saveViewsClosed, 0);
    queue.run();
    EXPECT_EQ(host.saveViewsClosed, 1);
    EXPECT_EQ(files(), 0);
}

TEST_F(SaveScreen, GivesTheKeyboardUpOnReturnOnATouchElsewhereAndOnARow) {
    KelvoSaveViewController& save = open(twoEntries());
    const QSignalSpy resigned(&save, &KelvoSaveViewController::resignFirstResponder);
    EXPECT_TRUE(save.textFieldShouldReturn());
    EXPECT_EQ(resigned.count(), 1);
    save.backgroundTouched();
    EXPECT_EQ(resigned.count(), 2);
    save.didSelectRow(1);
    EXPECT_EQ(resigned.count(), 3);
    queue.run();
    EXPECT_EQ(host.saveViewsClosed, 0);
}

}  // namespace
}  // namespace kelvo
