#include <gtest/gtest.h>

#include <QQuickItem>
#include <QTest>

#include "tests/support/TimeZone.h"
#include "tests/ui/SavedSample.h"
#include "tests/ui/ScreenFixture.h"

namespace kelvo {
namespace {

using test::sampleSnapshot;
using test::savedScreens;
using test::Scene;
using test::text;

/// A saved snapshot in the application's own screens.
class SnapshotWindow : public test::ScreenFixture {
protected:
    const test::TimeZone zone{"UTC"};  // of the reader, in which a snapshot's time is told

    /// On an installation that permits saving.
    void open(std::shared_ptr<const SavedScreens> saved, QSize size = {360, 640}) {
        scene = std::make_unique<Scene>(true, size, std::move(saved));
        scene->settle();
    }
    void openSample(QSize size = {360, 640}) { open(savedScreens(sampleSnapshot()), size); }
    std::string inToolbar(const char* name) {
        const QQuickItem* item = scene->itemOfType("StatusBar")->findChild<QQuickItem*>(text(name));
        return item->isVisible() ? item->property("text").toString().toStdString() : std::string();
    }
    void askFor(const char* key) {
        QQuickItem* row = scene->row(text(key));
        const QPointF middle = row->mapToScene({row->width() / 2, row->height() / 2});
        QTest::mouseClick(&scene->view(), Qt::RightButton, Qt::NoModifier, middle.toPoint());
        scene->settle();
        ASSERT_NE(scene->app().details(), nullptr);
    }
    QString textOf(const char* objectName) {
        return scene->view().rootObject()->findChild<QQuickItem*>(text(objectName))->property("text").toString();
    }
};

TEST_F(SnapshotWindow, ShowsTheSavedRowsInTheOwnScreens) {
    openSample();
    expectTop("Kelvo");
    scene->tapText(text("Serving Cell Measurements"));
    expectTop("Serving Cell Measurements");
    EXPECT_EQ(scene->row(text("Measured RSRP"))->shownValue(), text("-97.50 dBm"));
    scene->press(Qt::Key_Escape);
    expectTop("Kelvo");
    scene->press(Qt::Key_End);
    scene->press(Qt::Key_Return);
    expectTop("Measured Neighbor Cells");
    EXPECT_TRUE(scene->shows(text("0")));
}

TEST_F(SnapshotWindow, SaysOnEveryScreenThatItIsASnapshotAndOfWhen) {
    openSample();
    EXPECT_EQ(inToolbar("status"), "Snapshot of 2011-03-04 at 09:15:02");
    EXPECT_EQ(inToolbar("note"), "at the bridge");
    EXPECT_FALSE(scene->app().navigation()->topViewController().isLoading());
    scene->tapText(text("Serving Cell Measurements"));
    scene->settle();
    EXPECT_EQ(scene->app().navigation()->topViewController().status(), text("Snapshot of 2011-03-04 at 09:15:02"));
    EXPECT_EQ(scene->app().navigation()->topViewController().note(), text("at the bridge"));
}

TEST_F(SnapshotWindow, OffersNothingThatBelongsToALiveWindow) {
    openSample();
    EXPECT_FALSE(scene->shows(text("Save")));
    EXPECT_FALSE(scene->shows(text("Overview")));
    scene->press(Qt::Key_O, Qt::ControlModifier);
    scene->settle();
    expectTop("Kelvo");
    scene->app().showSaveView();
    EXPECT_EQ(scene->app().saveViewController(), nullptr);
}

TEST_F(SnapshotWindow, AsksNobodyAndNeverChanges) {
    openSample();
    scene->tapText(text("Serving Cell Measurements"));
    scene->settle();
    scene->pass(std::chrono::seconds(60));
    scene->settle();
    EXPECT_EQ(scene->ports.openLocals(), 0U);
    EXPECT_EQ(scene->ports.openRemotes(), 0U);
    EXPECT_TRUE(scene->ports.sent.empty());
    EXPECT_EQ(scene->row(text("Measured RSRP"))->shownValue(), text("-97.50 dBm"));
    const auto& pane = scene->app().navigation()->topViewController();
    EXPECT_EQ(pane.data(pane.index(1), KelvoPaneController::AgeRole), QVariant(QString()));
    EXPECT_EQ(pane.status(), text("Snapshot of 2011-03-04 at 09:15:02"));
}

TEST_F(SnapshotWindow, LeavesTheHomeScreensSettingAlone) {
    openSample();
    scene->app().applicationWillTerminate();
    EXPECT_TRUE(scene->events.empty());
}

TEST_F(SnapshotWindow, TellsOfAValueWhatTheFileKnows) {
    openSample();
    scene->tapText(text("Serving Cell Measurements"));
    scene->settle();
    askFor("Measured RSRP");
    EXPECT_EQ(textOf("largeValue"), text("-97.50 dBm"));
    EXPECT_EQ(textOf("written"), text("Snapshot of 2011-03-04 at 09:15:02"));
    EXPECT_EQ(textOf("record"), QString());
    EXPECT_NE(textOf("meaning"), QString());
    EXPECT_FALSE(scene->app().details()->hasTrend());
    EXPECT_TRUE(scene->shows(text("-97.50 dBm, from 09:15:00")));
    EXPECT_TRUE(scene->shows(text("-95.00 dBm, from 09:14:56")));
    scene->press(Qt::Key_Escape);
    scene->settle();
    EXPECT_EQ(scene->app().details(), nullptr);
    askFor("Physical Cell ID");
    EXPECT_EQ(textOf("largeValue"), text("301"));
    EXPECT_TRUE(scene->app().details()->changes().isEmpty());  // it has been that all the time
}

TEST_F(SnapshotWindow, UsesAWideWindowForThePanesAlone) {
    openSample({1200, 800});
    EXPECT_FALSE(scene->shows(text("No serving cell")));
    EXPECT_EQ(scene->itemOfType("QQuickStackView")->width(), 1200);
    EXPECT_EQ(scene->itemOfType("QQuickListView")->width(), 640);
}

TEST_F(SnapshotWindow, SaysCalmlyThatThereIsNothing) {
    open(savedScreens(test::snapshotXml("")));
    EXPECT_TRUE(scene->shows(text("This snapshot holds no readings")));
    EXPECT_EQ(inToolbar("status"), "Snapshot of 2011-03-04 at 09:15:02");
}

TEST_F(SnapshotWindow, SaysCalmlyWhyAFileIsNotShown) {
    open(std::make_shared<const SavedScreens>(SavedScreens::refused("<b>a</b>.kelvo is empty")));
    EXPECT_TRUE(scene->shows(text("<b>a</b>.kelvo is empty")));
    EXPECT_EQ(scene->itemWithText(text("<b>a</b>.kelvo is empty"))->property("textFormat").toInt(), Qt::PlainText);
    EXPECT_EQ(inToolbar("status"), "Nothing to show");
    EXPECT_EQ(inToolbar("note"), "");
    expectTop("Kelvo");
}

}  // namespace
}  // namespace kelvo
