#include <gtest/gtest.h>

#include <QAccessible>
#include <QFontMetricsF>
#include <QImage>
#include <QPointer>
#include <QQuickItem>
#include <QTest>

#include "platform/telephony/TelephonyProtocol.h"
#include "tests/ui/ScreenFixture.h"
#include "ui/ActivityIndicator.h"
#include "ui/Theme.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::sampleTree;
using test::Scene;
using test::text;

using Screen = test::ScreenFixture;

TEST_F(Screen, ShowsThatItConnectsBeforeAnythingIsThere) {
    Scene fresh;
    EXPECT_TRUE(fresh.shows(text("Kelvo")));
    EXPECT_TRUE(fresh.shows(text("Connecting")));
    EXPECT_FALSE(fresh.shows(text("Save")));
    const auto* indicator = qobject_cast<ActivityIndicator*>(fresh.itemOfType("kelvo::ActivityIndicator"));
    ASSERT_NE(indicator, nullptr);
    EXPECT_TRUE(indicator->isTurning());
}

TEST_F(Screen, StopsTheIndicatorOnceItIsConnected) {
    start();
    EXPECT_TRUE(scene->shows(text("Updated 2011-03-04 at 09:15:04")));
    EXPECT_EQ(scene->itemOfType("kelvo::ActivityIndicator"), nullptr);
}

TEST_F(Screen, GoesOnConnectingUntilASlowServiceAnswers) {
    scene = std::make_unique<Scene>();
    scene->telephony.answer = {.error = {.domain = kPLErrorDomainClient, .error = kPLErrorNoAnswer}, .portName = ""};
    scene->connect();
    scene->settle();
    EXPECT_TRUE(scene->shows(text("Connecting")));
    const QImage drawn = scene->view().grabWindow();
    EXPECT_TRUE(QTest::qWaitFor([&] { return scene->view().grabWindow() != drawn; }));  // the indicator turns on
    bool taskRan = false;
    scene->queue.postAfter(4s, [&taskRan] { taskRan = true; });
    scene->pass(4s);
    EXPECT_TRUE(taskRan);
    EXPECT_EQ(scene->telephony.askedFor.size(), 1U);
    scene->pass(1s);
    EXPECT_EQ(scene->telephony.askedFor.size(), 2U);
    EXPECT_TRUE(scene->shows(text("Connecting")));

    scene->telephony.answer = {.error = {}, .portName = "service"};
    scene->ports.onRequest = [](const test::FakePorts::Sent&) -> test::FakePorts::Answer {
        return RemotePort::Error::ReplyTimedOut;
    };
    scene->pass(5s);
    EXPECT_EQ(scene->ports.sent.size(), 1U);
    EXPECT_FALSE(scene->app().model()->isConnected());
    EXPECT_TRUE(scene->shows(text("Connecting")));

    scene->ports.onRequest = test::speaking(std::string(kPLLogChannelTechnology_IFX));
    scene->pass(5s);
    scene->show(sampleTree(3));
    scene->settle();
    EXPECT_TRUE(scene->shows(text("Registered")));
    EXPECT_TRUE(scene->shows(text("Updated 2011-03-04 at 09:15:19")));
    EXPECT_EQ(scene->itemOfType("kelvo::ActivityIndicator"), nullptr);
}

TEST_F(Screen, DrawsKeysBoldAndValuesRegularWhereTheRowPutsThem) {
    start();
    scene->tapText(text("Serving Cell"));
    scene->settle();
    const auto fontOf = [this](const char* shown) {
        return scene->itemWithText(text(shown))->property("font").value<QFont>();
    };
    EXPECT_EQ(fontOf("RSRP").pixelSize(), 15);
    EXPECT_TRUE(fontOf("RSRP").bold());
    EXPECT_EQ(fontOf("-95 dBm").pixelSize(), 15);
    EXPECT_FALSE(fontOf("-95 dBm").bold());
    EXPECT_EQ(fontOf("Updated 2011-03-04 at 09:15:04").pixelSize(), 14);

    const KelvoCell* row = scene->row(text("RSRP"));
    const QQuickItem* key = scene->itemWithText(text("RSRP"));
    const QQuickItem* value = scene->itemWithText(text("-95 dBm"))->parentItem();  // of the pieces of the text
    EXPECT_EQ(key->position(), row->keyFrame().topLeft());
    EXPECT_EQ(key->x(), 10);
    EXPECT_EQ(value->position(), row->valueFrame().topLeft());
    EXPECT_EQ(value->x() + row->valueFrame().width(), strip(text("RSRP"))->width());  // flush against the right edge
}

TEST_F(Screen, ShowsMarkupFromTheModemAsItStands) {
    start();
    const char* name = "<h1>Cell</h1>";
    const char* value = "<b>7</b>";
    const char* title = "<img src='http://x/'>";
    scene->show(Dictionary::make({{title, Dictionary::make({{name, value}, {"b", "2"}})}, {"z", "1"}}));
    scene->settle();
    scene->tapText(text(title));
    expectTop(title);
    for (const char* shown : {title, name, value}) {
        const QQuickItem* item = scene->itemWithText(text(shown));
        ASSERT_NE(item, nullptr);
        const QFontMetricsF metrics(item->property("font").value<QFont>());
        EXPECT_GT(item->implicitWidth(), metrics.horizontalAdvance(text(shown)) - 2) << shown;  // every sign of it
        EXPECT_LT(item->implicitHeight(), 2 * metrics.height()) << shown;
    }
}

TEST_F(Screen, OpensAPaneWithATapAndLeavesItByItsWayBack) {
    start();
    scene->tapText(text("Serving Cell"));
    expectTop("Serving Cell");
    EXPECT_TRUE(scene->shows(text("-95 dBm")));
    scene->tapText(text("Kelvo"));
    expectTop("Kelvo");
    EXPECT_EQ(depth(), 1U);
}

TEST_F(Screen, StaysWhereItIsForATapOnALeaf) {
    start();
    scene->tapText(text("Registration"));
    scene->settle();
    EXPECT_EQ(depth(), 1U);
}

TEST_F(Screen, WalksByKeys) {
    start();
    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Return);
    expectTop("Neighbor Cells");
    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Enter);
    expectTop("0");
    scene->press(Qt::Key_Escape);
    expectTop("Neighbor Cells");
    scene->press(Qt::Key_Backspace);
    expectTop("Kelvo");
    scene->press(Qt::Key_Up);
    scene->press(Qt::Key_Space);
    expectTop("Serving Cell");
    scene->press(Qt::Key_Left, Qt::AltModifier);
    expectTop("Kelvo");
    scene->press(Qt::Key_Escape);
    expectTop("Kelvo");
}

TEST_F(Screen, GoesBackByTheTabKey) {
    start(true);
    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Return);
    expectTop("Serving Cell");
    tabTo("Kelvo");
    EXPECT_TRUE(scene->view().activeFocusItem()->property("visualFocus").toBool());
    scene->press(Qt::Key_Return);
    expectTop("Kelvo");
    EXPECT_EQ(depth(), 1U);
}

TEST_F(Screen, GoesBackByItselfWhenAPanesBranchVanishes) {
    start();
    scene->tapText(text("Neighbor Cells"));
    expectTop("Neighbor Cells");
    scene->tap(scene->row(text("2")));
    expectTop("2");
    scene->show(sampleTree(1));
    expectTop("Neighbor Cells");
    EXPECT_FALSE(scene->shows(text("2")));
}

TEST_F(Screen, FindsThePaneThatIsLeftWhenABranchVanishesUnderTheSaveScreen) {
    start(true);
    scene->tapText(text("Neighbor Cells"));
    expectTop("Neighbor Cells");
    scene->tap(scene->row(text("2")));
    expectTop("2");
    openSheet();
    scene->show(sampleTree(1));
    scene->settle();
    EXPECT_TRUE(scene->shows(text("Save Snapshot")));
    scene->tapText(text("Cancel"));
    scene->queue.run();
    expectTop("Neighbor Cells");
    EXPECT_FALSE(scene->shows(text("Save Snapshot")));
    EXPECT_EQ(depth(), 2U);
    EXPECT_EQ(scene->itemOfType("QQuickStackView")->property("depth").toInt(), 2);
    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Return);
    expectTop("0");
    scene->press(Qt::Key_Escape);
    expectTop("Neighbor Cells");
    scene->press(Qt::Key_Escape);
    expectTop("Kelvo");
}

TEST_F(Screen, SaysThatAListIsEmpty) {
    start();
    scene->show(sampleTree(0));
    scene->tapText(text("Neighbor Cells"));
    scene->settle();
    EXPECT_TRUE(scene->shows(text("None reported")));
    scene->show(sampleTree(1));
    EXPECT_FALSE(scene->shows(text("None reported")));
}

TEST_F(Screen, ShowsTheAlertOverThePaneUntilItIsClosed) {
    start(true);
    openSheet();
    std::filesystem::remove(scene->snapshotDirectory());
    scene->tapText(text("Save"));
    EXPECT_TRUE(scene->shows(text("File Error")));
    scene->queue.run();
    scene->settle();
    EXPECT_FALSE(scene->shows(text("Save Snapshot")));
    EXPECT_TRUE(scene->shows(text("Unable to write file to disk")));
    scene->tap(QPointF(100, 80));  // a pane's row below the alert
    EXPECT_EQ(depth(), 1U);
    scene->tapText(text("Close"));
    scene->settle();
    EXPECT_FALSE(scene->shows(text("File Error")));
    scene->tapText(text("Serving Cell"));
    expectTop("Serving Cell");
}

TEST_F(Screen, ClosesTheAlertByKey) {
    start();
    scene->app().showAlert(text("File Error"), text("Unable to write file to disk"), text("Close"));
    scene->settle();
    scene->press(Qt::Key_Return);
    EXPECT_FALSE(scene->app().isAlertShown());
}

TEST_F(Screen, LeavesARowAloneThatAFingerScrollsSidewaysDuringAReload) {
    start();
    const std::string state = "a value that is much too long for the width of one row of this telephone";
    const auto tree = [&](const char* level) {
        return Dictionary::make({{"Level", level}, {"State", state}, {"Cells", Array::make()}});
    };
    scene->show(tree("-95 dBm"));
    scene->settle();
    KelvoCell* row = scene->row(text("State"));
    QQuickItem* strip = row->findChild<QQuickItem*>(text("strip"));
    ASSERT_NE(strip, nullptr);

    const QPointF from = row->mapToScene({300, 25});
    scene->touch(from);
    for (int x = 10; x <= 120; x += 10) scene->move(from - QPointF(x, 0));
    const double scrolled = strip->property("contentX").toDouble();
    EXPECT_GT(scrolled, 40);
    scene->show(tree("-80 dBm"));
    EXPECT_TRUE(scene->shows(text("-80 dBm")));
    EXPECT_EQ(scene->row(text("State")), row);
    EXPECT_EQ(strip->property("contentX").toDouble(), scrolled);
    EXPECT_TRUE(strip->property("dragging").toBool());
    scene->move(from - QPointF(140, 0));
    EXPECT_EQ(strip->property("contentX").toDouble(), scrolled + 20);
    scene->lift(from - QPointF(140, 0));
    EXPECT_EQ(depth(), 1U);
}

TEST_F(Screen, KeepsTheScrollPositionAndTheRowsThroughAReload) {
    start();
    const auto tree = [](const char* level, int rows) {
        const DictionaryRef display = Dictionary::make();
        for (int row = 0; row < rows; ++row) display->set("Row " + std::to_string(row), level);
        return Value(display);
    };
    scene->show(tree("-95 dBm", 40));
    scene->settle();
    QQuickItem* list = scene->itemOfType("QQuickListView");
    list->setProperty("contentY", 620);
    scene->settle();
    KelvoCell* row = scene->row(text("Row 15"));
    scene->show(tree("-80 dBm", 42));
    scene->settle();
    EXPECT_EQ(list->property("contentY").toInt(), 620);
    EXPECT_EQ(scene->row(text("Row 15")), row);
    EXPECT_EQ(row->value(), text("-80 dBm"));
}

TEST_F(Screen, ShowsEveryRecycledRowEitherWholeOrByItsNameOnly) {
    startWithRecycledRows();
    int byNameOnly = 0;
    for (int leaf = 22; leaf < 29; ++leaf) {
        const KelvoCell* row = scene->row(text("Leaf ") + QString::number(leaf));
        EXPECT_EQ(row->shownValue(), row->kind() == KelvoCell::Kind::Value ? text("value") : QString());
        byNameOnly += row->kind() == KelvoCell::Kind::Key ? 1 : 0;
    }
    EXPECT_GT(byNameOnly, 0);  // rows that came from the branches, all under one reuse identifier
}

TEST_F(Screen, ShowsABranchInARecycledRowOfAValueAsInAFreshRow) {
    const auto branch = [](int number) { return "Branch " + std::to_string(number) + " " + std::string(60, 'n'); };
    const auto nameEnds = [this](const QString& key) {
        const QQuickItem* name = scene->itemWithText(key);
        return name->x() + name->width();
    };
    scene = std::make_unique<Scene>();
    scene->connect();
    scene->show(Dictionary::make({{branch(99), Array::make()}, {"z", "1"}}));
    scene->settle();
    const QString first = QString::fromStdString(branch(99));
    ASSERT_EQ(scene->row(first)->kind(), KelvoCell::Kind::Key);
    const double stripWidth = strip(first)->width();
    const double nameEnd = nameEnds(first);

    const DictionaryRef display = Dictionary::make();
    for (int row = 0; row < 30; ++row) display->set("Leaf " + std::to_string(row), std::string(80, 'x'));
    for (int row = 0; row < 30; ++row) display->set(branch(row), Array::make());
    scene->show(display);
    QQuickItem* list = scene->itemOfType("QQuickListView");
    for (int y = 0; y <= 2400; y += 100) {
        list->setProperty("contentY", y);
        scene->settle();
    }
    int recycled = 0;
    for (int row = 20; row < 29; ++row) {
        const QString key = QString::fromStdString(branch(row));
        if (scene->row(key)->kind() != KelvoCell::Kind::Value) continue;
        ++recycled;
        EXPECT_FALSE(strip(key)->property("interactive").toBool());
        EXPECT_EQ(strip(key)->width(), stripWidth);
        EXPECT_EQ(nameEnds(key), nameEnd);
    }
    EXPECT_GT(recycled, 0);
}

TEST_F(Screen, ScrollsALongValueByKeys) {
    start();
    scene->show(Dictionary::make({{"A", std::string(80, 'x')}, {"B", "1"}}));
    scene->settle();
    QQuickItem* strip = scene->row(text("A"))->findChild<QQuickItem*>(text("strip"));
    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Right);
    EXPECT_EQ(strip->property("contentX").toInt(), 80);
    scene->press(Qt::Key_Left);
    EXPECT_EQ(strip->property("contentX").toInt(), 0);
}

TEST_F(Screen, FollowsTheSystemsColoursWhileItRuns) {
    start();
    const auto middle = [this] { return scene->view().grabWindow().pixelColor(180, 500).lightness(); };
    EXPECT_GT(middle(), 200);
    Scene::useDarkColours(true);
    EXPECT_LT(middle(), 60);
    Scene::useDarkColours(false);
    EXPECT_GT(middle(), 200);
}

TEST_F(Screen, NamesItsRowsForAScreenReader) {
    QAccessible::setActive(true);
    start();
    scene->tapText(text("Serving Cell"));
    scene->settle();
    QAccessibleInterface* row = QAccessible::queryAccessibleInterface(scene->row(text("RSRP")));
    ASSERT_NE(row, nullptr);
    EXPECT_EQ(row->text(QAccessible::Name), text("RSRP, -95 dBm"));
    EXPECT_EQ(row->role(), QAccessible::ListItem);
    QAccessible::setActive(false);
}

TEST_F(Screen, KeepsRowsReadableOnAWideScreenAndFitsATinyOne) {
    start(true, {1200, 800});
    EXPECT_EQ(scene->row(text("Registration"))->width(), 640);
    scene->view().resize(240, 240);
    scene->settle();
    EXPECT_EQ(scene->row(text("Registration"))->width(), 240);
    EXPECT_TRUE(scene->shows(text("Save")));
}

TEST_F(Screen, TakesItsWindowAwayAtTheEnd) {
    start(true);
    scene->tapText(text("Serving Cell"));
    scene->settle();
    openSheet();
    const QPointer<QQuickView> view(&scene->view());
    scene->app().applicationWillTerminate();
    EXPECT_TRUE(view.isNull());
    EXPECT_EQ(scene->app().saveViewController(), nullptr);
    EXPECT_EQ(scene->app().model(), nullptr);
    EXPECT_EQ(scene->ports.openLocals(), 0U);
}

}  // namespace
}  // namespace kelvo
