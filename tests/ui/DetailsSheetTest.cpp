#include <gtest/gtest.h>

#include <QAccessible>
#include <QClipboard>
#include <QGuiApplication>

#include "tests/ui/DetailsFixture.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::text;

class DetailsSheet : public test::DetailsFixture {
protected:
    bool isOpen() { return scene->app().details() != nullptr; }
    QString title() { return scene->app().details()->title(); }
    QPointF middleOf(const char* key) {
        QQuickItem* row = scene->row(text(key));
        return row->mapToScene({row->width() / 2, row->height() / 2});
    }
    void click(QPointF at, Qt::MouseButton button) {
        QTest::mouseClick(&scene->view(), button, Qt::NoModifier, at.toPoint());
        scene->settle();
    }
};

TEST_F(DetailsSheet, OpensWhereAValueIsPressedLong) {
    startLte();
    openSection();
    const QPointF at = middleOf("Serving Filtered RSRP");
    scene->touch(at);
    EXPECT_TRUE(QTest::qWaitFor([this] { return isOpen(); }));
    scene->lift(at);
    scene->settle();
    ASSERT_TRUE(isOpen());
    EXPECT_EQ(title(), text("Serving Filtered RSRP"));
    EXPECT_EQ(textOf("place"), text(kSection));
    EXPECT_EQ(textOf("largeValue"), text("-95.00 dBm"));
    EXPECT_EQ(depth(), 2U);
}

TEST_F(DetailsSheet, OpensWithTheRightButtonTheMenuKeyAndCtrlReturn) {
    startLte();
    openSection();
    click(middleOf("Serving Filtered RSRQ"), Qt::RightButton);
    ASSERT_TRUE(isOpen());
    EXPECT_EQ(title(), text("Serving Filtered RSRQ"));
    scene->press(Qt::Key_Escape);
    scene->settle();
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(depth(), 2U);

    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Menu);
    scene->settle();
    ASSERT_TRUE(isOpen());
    EXPECT_EQ(title(), text("E-ARFCN"));
    scene->press(Qt::Key_Back);
    scene->settle();
    EXPECT_FALSE(isOpen());

    scene->press(Qt::Key_Return, Qt::ControlModifier);
    scene->settle();
    EXPECT_TRUE(isOpen());
}

TEST_F(DetailsSheet, StaysAwayFromATapAndFromRowsThatOpen) {
    startLte();
    click(middleOf(kSection), Qt::RightButton);
    EXPECT_FALSE(isOpen());
    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Return, Qt::ControlModifier);
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(depth(), 1U);
    QObject* handler = scene->row(text(kSection))->findChild<QObject*>(text("tap"));
    ASSERT_NE(handler, nullptr);
    QMetaObject::invokeMethod(handler, "longPressed");
    EXPECT_FALSE(isOpen());
    openSection();
    scene->tapText(text("Serving Filtered RSRP"));
    scene->settle();
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(depth(), 2U);
}

TEST_F(DetailsSheet, SaysWhatTheValueMeans) {
    startLte();
    openDetails();
    EXPECT_TRUE(textOf("meaning").endsWith(text(".")));
    EXPECT_TRUE(textOf("standard").startsWith(text("3GPP TS 36.")));
}

TEST_F(DetailsSheet, FollowsTheValue) {
    startLte();
    openDetails();
    measure(-80.25);
    EXPECT_EQ(textOf("largeValue"), text("-80.25 dBm"));
}

TEST_F(DetailsSheet, StaysWithTheCellWhoseRowItWas) {
    startLte();
    measure(-95, {{366, -100}, {144, -102}});
    openSection("Measured Neighbor Cells");
    scene->tapText(text("0"));
    expectTop("0");
    askAt(1);
    ASSERT_TRUE(isOpen());
    EXPECT_EQ(textOf("place"), QString::fromUtf8("Measured Neighbor Cells › PCI 366, EARFCN 1300"));
    measure(-95, {{144, -90}, {366, -101.5}});
    EXPECT_EQ(textOf("largeValue"), text("-101.50 dBm"));
    measure(-95, {{144, -90}});
    EXPECT_EQ(textOf("largeValue"), text("-101.50 dBm"));  // what it was last
    EXPECT_EQ(scene->app().details()->trend().points.size(), 2U);
}

TEST_F(DetailsSheet, HasTheLevelOfAListsEntry) {
    startLte();
    measure(-95, {{366, -100}});
    openSection("Measured Neighbor Cells");
    click(middleOf("0"), Qt::RightButton);
    ASSERT_TRUE(isOpen());
    EXPECT_EQ(title(), text("Filtered RSRP"));
    EXPECT_EQ(textOf("largeValue"), text("-100.00 dBm"));
}

TEST_F(DetailsSheet, CopiesTheValue) {
    startLte();
    openDetails();
    scene->tapText(text("Copy"));
    EXPECT_EQ(QGuiApplication::clipboard()->text(), text("-95.00 dBm"));
}

TEST_F(DetailsSheet, ComparesWithTheBestNeighborFirst) {
    startLte();
    measure(-95, {{366, -104}, {144, -99}});
    openDetails();

    scene->tapText(QString::fromUtf8("Compare with…"));
    scene->settle();
    const QStringList& titles = scene->app().details()->candidateTitles();
    const QStringList& places = scene->app().details()->candidatePlaces();
    ASSERT_GE(titles.size(), 3);
    EXPECT_EQ(titles[0], text("Filtered RSRP"));
    EXPECT_EQ(places[0], QString::fromUtf8("Measured Neighbor Cells › PCI 144, EARFCN 1300"));
    EXPECT_EQ(places[1], QString::fromUtf8("Measured Neighbor Cells › PCI 366, EARFCN 1300"));
    scene->press(Qt::Key_Return);
    EXPECT_EQ(scene->app().details()->comparison().points.size(), 1U);
    EXPECT_EQ(chart()->otherStatistics(), text("min -99   mean -99   max -99"));
    EXPECT_TRUE(chart()->summary().contains(QString::fromUtf8("PCI 144, EARFCN 1300: -99 dBm")))
        << chart()->summary().toStdString();
    scene->settle();
    scene->tapText(text("Stop comparing"));
    EXPECT_EQ(chart()->otherStatistics(), QString());
}

TEST_F(DetailsSheet, GoesBackFromTheChoiceBeforeItGoes) {
    startLte();
    openDetails();
    scene->tapText(QString::fromUtf8("Compare with…"));
    scene->press(Qt::Key_Escape);
    scene->settle();
    EXPECT_TRUE(isOpen());
    EXPECT_EQ(focused(), text("Done"));
    scene->press(Qt::Key_Return);
    scene->settle();
    EXPECT_FALSE(isOpen());
    EXPECT_TRUE(scene->itemOfType("QQuickListView")->hasActiveFocus());
}

TEST_F(DetailsSheet, KeepsTheKeyboardWithinItself) {
    startLte();
    openDetails();
    QStringList visited;
    for (int i = 0; i < 4; ++i) {
        const QQuickItem* item = scene->view().activeFocusItem();
        visited.append(item == chart() ? text("chart") : focused());
        scene->press(Qt::Key_Tab);
    }
    EXPECT_EQ(visited, (QStringList{text("Done"), text("chart"), QString::fromUtf8("Compare with…"), text("Copy")}));
}

TEST_F(DetailsSheet, IsHeardAsADialogAndSilencesWhatItCovers) {
    startLte();
    openDetails();
    QAccessibleInterface* sheet = QAccessible::queryAccessibleInterface(scene->itemOfType("DetailsSheet"));
    ASSERT_NE(sheet, nullptr);
    EXPECT_EQ(sheet->role(), QAccessible::Dialog);
    EXPECT_EQ(sheet->text(QAccessible::Name), text("Serving Filtered RSRP"));
    EXPECT_FALSE(scene->row(text(kSection))->isEnabled());
}

TEST_F(DetailsSheet, GoesWithATapBesideIt) {
    startLte();
    openDetails();
    scene->tap(QPointF(200, 75));  // on a row that would open
    scene->settle();
    EXPECT_FALSE(isOpen());
    EXPECT_EQ(depth(), 1U);
}

TEST_F(DetailsSheet, StandsBelowOnAPhoneAndBesideTheRowInAWideWindow) {
    startLte();
    openDetails();
    const QQuickItem* panel = named("detailsPanel");
    EXPECT_EQ(panel->width(), 412);
    EXPECT_EQ(panel->mapToScene({0, panel->height()}).y(), 915);

    startLte({1000, 1300});
    openSection();
    askAt(2);
    panel = named("detailsPanel");
    const QQuickItem* row = scene->row(text("Serving Filtered RSRP"));
    EXPECT_EQ(panel->width(), 440);
    EXPECT_GE(panel->mapToScene({0, 0}).y(), row->mapToScene({0, row->height() / 2}).y());
    EXPECT_LE(panel->mapToScene({0, panel->height()}).y(), 1300);
}

TEST_F(DetailsSheet, StaysInAWindowThatBecomesWide) {
    startLte();
    openDetails();
    scene->view().resize(900, 640);
    scene->settle();
    const QQuickItem* panel = named("detailsPanel");
    EXPECT_EQ(panel->width(), 440);
    EXPECT_GE(panel->mapToScene({0, 0}).x(), 12);
    EXPECT_LE(panel->mapToScene({440, 0}).x(), 900);
}

TEST_F(DetailsSheet, FitsTheSmallestWindow) {
    startLte({240, 240});
    openDetails();
    const QQuickItem* panel = named("detailsPanel");
    EXPECT_GE(panel->mapToScene({0, 0}).y(), 0);
    EXPECT_EQ(panel->width(), 240);
    EXPECT_TRUE(named("detailsScroll")->property("interactive").toBool());
}

TEST_F(DetailsSheet, TellsTheChangesOfAText) {
    startLte();
    measure(-95, {}, 17);
    openSection();
    askAt(1);
    ASSERT_TRUE(isOpen());
    EXPECT_EQ(title(), text("Serving Physical Cell ID"));
    EXPECT_FALSE(scene->app().details()->hasTrend());
    EXPECT_EQ(scene->app().details()->changes(),
              (QStringList{text("17, since 0 seconds"), text("301, since 2 seconds")}));
}

TEST_F(DetailsSheet, GoesWithTheProgram) {
    startLte();
    openDetails();
    scene->app().applicationWillTerminate();
    EXPECT_FALSE(isOpen());
}

}  // namespace
}  // namespace kelvo
