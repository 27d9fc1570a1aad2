#include <gtest/gtest.h>

#include <QPointer>
#include <QQuickItem>
#include <QTest>

#include "tests/ui/ScreenFixture.h"
#include "ui/Glyph.h"

namespace kelvo {
namespace {

using test::sampleTree;
using test::Scene;
using test::text;

using SaveSheet = test::ScreenFixture;

TEST_F(SaveSheet, OpensTheSaveScreenAndAllItsPartsByTheTabKey) {
    start(true);
    tabTo("Save");
    EXPECT_TRUE(scene->view().activeFocusItem()->property("visualFocus").toBool());
    scene->press(Qt::Key_Return);
    scene->settle();
    ASSERT_TRUE(scene->shows(text("Save Snapshot")));
    for (const char* part : {"Cancel", "Save", "Description", "Cancel"}) {  // round again, and not to the pane below
        scene->press(Qt::Key_Tab);
        EXPECT_EQ(focused(), text(part));
    }
    scene->press(Qt::Key_Return);
    scene->queue.run();
    scene->settle();
    EXPECT_FALSE(scene->shows(text("Save Snapshot")));
    EXPECT_TRUE(savedFiles().empty());
}

TEST_F(SaveSheet, SavesByKeysAlone) {
    start(true);
    tabTo("Save");
    scene->press(Qt::Key_Return);
    scene->settle();
    tabTo("Description");
    scene->type("by hand");
    tabTo("Cancel");
    tabTo("Save");
    scene->press(Qt::Key_Return);
    scene->queue.run();
    scene->settle();
    EXPECT_FALSE(scene->shows(text("Save Snapshot")));
    ASSERT_EQ(savedFiles().size(), 1U);
    EXPECT_EQ(savedDescription(), "by hand");
}

TEST_F(SaveSheet, SaysThatThereIsNothingToSaveYet) {
    scene = std::make_unique<Scene>(true);
    scene->telephony.reachable = false;
    scene->connect();
    scene->settle();
    openSheet();
    EXPECT_TRUE(scene->shows(text("Nothing recorded yet")));
    EXPECT_FALSE(scene->shows(text("In this snapshot")));
}

TEST_F(SaveSheet, ListsEachEntryInItsFontWithACheckMark) {
    start(true);
    openSheet();
    const QQuickItem* entry = scene->itemWithText(text("Snapshot (2011-03-04 09:15:04 +0000)"));
    const auto font = entry->property("font").value<QFont>();
    EXPECT_EQ(font.family(), text("Helvetica"));
    EXPECT_EQ(font.pixelSize(), 13);
    const auto* mark = entry->parentItem()->findChild<Glyph*>();
    ASSERT_NE(mark, nullptr);
    EXPECT_TRUE(mark->isVisible());
    EXPECT_EQ(mark->shape(), Glyph::Shape::Check);
}

TEST_F(SaveSheet, MakesTheListOfEntriesAsHighAsTheyAre) {
    start(true);
    openSheet();
    const auto expectEntries = [this](int entries) {
        const QQuickItem* list = scene->itemOfType("QQuickListView");  // the sheet's, which lies on top
        EXPECT_EQ(list->property("count").toInt(), entries);
        EXPECT_EQ(list->height(), entries * 44);
    };
    expectEntries(1);
    scene->tapText(text("Cancel"));
    scene->queue.run();
    scene->settle();
    scene->show(sampleTree(3));
    openSheet();
    expectEntries(2);
}

TEST_F(SaveSheet, LetsGoOfASaveScreenThatWasClosed) {
    start(true);
    openSheet();
    const QPointer<KelvoSaveViewController> screen(scene->app().saveViewController());
    scene->tapText(text("Cancel"));
    scene->queue.run();
    scene->settle();
    EXPECT_TRUE(QTest::qWaitFor([&screen] { return screen.isNull(); }));
}

TEST_F(SaveSheet, SavesWithTheDescriptionThatWasTyped) {
    start(true);
    openSheet();
    EXPECT_TRUE(scene->shows(text("Snapshot (2011-03-04 09:15:04 +0000)")));
    scene->tapText(text("Description"));
    scene->type("drive home");
    QQuickItem* field = scene->itemOfType("QQuickTextField");
    ASSERT_NE(field, nullptr);
    EXPECT_TRUE(field->hasActiveFocus());
    scene->press(Qt::Key_Return);
    EXPECT_FALSE(field->hasActiveFocus());
    scene->tapText(text("Save"));  // the sheet's own, which lies on top
    scene->queue.run();
    scene->settle();
    EXPECT_FALSE(scene->shows(text("Save Snapshot")));
    ASSERT_EQ(savedFiles().size(), 1U);
    EXPECT_EQ(savedDescription(), "drive home");
}

TEST_F(SaveSheet, GivesTheKeyboardUpForATouchElsewhereAndForARow) {
    start(true);
    openSheet();
    QQuickItem* field = scene->itemOfType("QQuickTextField");
    scene->tap(field);
    EXPECT_TRUE(field->hasActiveFocus());
    scene->tap(QPointF(180, 600));
    EXPECT_FALSE(field->hasActiveFocus());
    scene->tap(field);
    EXPECT_TRUE(field->hasActiveFocus());
    scene->tapText(text("Snapshot (2011-03-04 09:15:04 +0000)"));
    EXPECT_FALSE(field->hasActiveFocus());
    EXPECT_NE(scene->app().saveViewController(), nullptr);
}

TEST_F(SaveSheet, WritesNothingWhenSavingIsCancelledByTouchOrByKey) {
    start(true);
    openSheet();
    scene->tapText(text("Cancel"));
    scene->queue.run();
    scene->settle();
    EXPECT_FALSE(scene->shows(text("Save Snapshot")));
    openSheet();
    scene->press(Qt::Key_Escape);
    scene->queue.run();
    scene->settle();
    EXPECT_FALSE(scene->shows(text("Save Snapshot")));
    EXPECT_TRUE(savedFiles().empty());
    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Return);  // the panes have the keyboard again
    expectTop("Serving Cell");
}

TEST_F(SaveSheet, KeepsThePanesOutOfReachWhileTheSaveScreenIsUp) {
    start(true);
    openSheet();
    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Return);
    scene->press(Qt::Key_Backspace);
    scene->tap(QPointF(180, 12));
    EXPECT_EQ(depth(), 1U);
    EXPECT_NE(scene->app().saveViewController(), nullptr);
}

}  // namespace
}  // namespace kelvo
