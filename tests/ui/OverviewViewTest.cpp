#include <gtest/gtest.h>

#include <QTest>

#include "tests/ui/OverviewFixture.h"

namespace kelvo {
namespace {

using test::text;

/// How the overview comes and goes, and where it stands.
class OverviewView : public test::OverviewFixture {
protected:
    QQuickItem* button() { return scene->itemOfType("TitleBar")->findChild<QQuickItem*>(text("overview")); }
    static double left(const QQuickItem* item) { return item->mapToScene({0, 0}).x(); }
    static double right(const QQuickItem* item) { return item->mapToScene({item->width(), 0}).x(); }
    /// Every item of the window, whether seen or not.
    qsizetype items() { return scene->view().rootObject()->findChildren<QQuickItem*>().size(); }
    static void forgetDeleted() { QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete); }
};

TEST_F(OverviewView, OpensWithItsButtonAndGoesBack) {
    startLte();
    EXPECT_EQ(overview(), nullptr);
    scene->tap(button());
    scene->settle();
    ASSERT_NE(overview(), nullptr);
    EXPECT_EQ(left(overview()), 0);
    EXPECT_EQ(overview()->width(), 412);
    EXPECT_FALSE(panes()->isEnabled());
    EXPECT_TRUE(hasFocus(overview()));
    scene->tapText(text("Kelvo"));  // the way back bears the pane's name
    scene->settle();
    EXPECT_EQ(overview(), nullptr);
    EXPECT_EQ(left(panes()), 0);
    EXPECT_TRUE(hasFocus(panes()));
}

TEST_F(OverviewView, OpensWithAClickAndGoesWithTheMousesOwnButton) {
    startLte();
    const QPointF middle = button()->mapToScene({button()->width() / 2, button()->height() / 2});
    QTest::mouseClick(&scene->view(), Qt::LeftButton, Qt::NoModifier, middle.toPoint());
    scene->settle();
    ASSERT_NE(overview(), nullptr);
    QTest::mouseClick(&scene->view(), Qt::BackButton, Qt::NoModifier, {200, 300});
    scene->settle();
    EXPECT_EQ(overview(), nullptr);
}

TEST_F(OverviewView, OpensByKeyFromEveryPaneAndReturnsThere) {
    startLte();
    openSection();
    EXPECT_FALSE(button()->isVisible());  // only the root pane has it
    for (const Qt::Key back : {Qt::Key_Escape, Qt::Key_Back, Qt::Key_Backspace}) {
        openOverview();
        EXPECT_TRUE(scene->shows(text(kSection)));  // on the way back
        scene->press(back);
        scene->settle();
        EXPECT_EQ(overview(), nullptr);
        expectTop(kSection);
    }
}

TEST_F(OverviewView, GoesWithASwipeFromTheLeftEdge) {
    startLte();
    openOverview();
    scene->touch({6, 500});
    for (int x = 20; x <= 160; x += 20) scene->move({qreal(x), 500});
    scene->lift({160, 500});
    scene->settle();
    EXPECT_EQ(overview(), nullptr);
    EXPECT_EQ(depth(), 1U);
}

TEST_F(OverviewView, LeavesTheTitleOfTheRootPaneItsPlace) {
    for (const int width : {240, 360, 412, 899}) {
        startLte({width, 600});
        const QQuickItem* title = scene->itemWithText(text("Kelvo"));
        EXPECT_NEAR((left(title) + right(title)) / 2, width / 2.0, 0.51) << width;
        EXPECT_FALSE(title->property("truncated").toBool()) << width;
        EXPECT_LE(title->property("contentWidth").toDouble(), title->width()) << width;  // in its full size
        const QQuickItem* rows = scene->itemOfType("QQuickListView");
        EXPECT_EQ(right(button()), right(rows) - 4) << width;
        EXPECT_EQ(button()->height(), 44) << width;
        EXPECT_LE(right(title), left(scene->itemWithText(text("Overview")))) << width;
    }
}

TEST_F(OverviewView, StandsBesideThePanesFrom900Pixels) {
    startLte({899, 640});
    EXPECT_EQ(overview(), nullptr);
    EXPECT_TRUE(button()->isVisible());
    EXPECT_EQ(panes()->width(), 899);

    startLte({900, 640});
    ASSERT_NE(overview(), nullptr);
    EXPECT_FALSE(button()->isVisible());
    EXPECT_GE(panes()->width(), 400);
    EXPECT_EQ(left(overview()), panes()->width());
    EXPECT_EQ(right(overview()), 900);
    EXPECT_TRUE(panes()->isEnabled());
    EXPECT_TRUE(hasFocus(panes()));
    openSection();
    EXPECT_NE(overview(), nullptr);

    startLte({1200, 640});
    EXPECT_EQ(scene->row(text(kSection))->width(), 640);  // as wide as rows get
    EXPECT_EQ(overview()->width(), 560);
}

TEST_F(OverviewView, OfAWindowThatChangesItsWidthThereIsOne) {
    startLte();
    openOverview();
    scene->view().resize(1000, 640);
    scene->settle();
    EXPECT_EQ(left(overview()), 440);
    EXPECT_EQ(left(panes()), 0);
    EXPECT_TRUE(hasFocus(overview()));
    scene->view().resize(412, 915);
    scene->settle();
    ASSERT_NE(overview(), nullptr);  // the reader is still with it
    EXPECT_EQ(left(overview()), 0);
    scene->press(Qt::Key_Escape);
    scene->settle();
    EXPECT_EQ(overview(), nullptr);

    scene->view().resize(1000, 640);
    scene->settle();
    EXPECT_NE(overview(), nullptr);
    EXPECT_TRUE(hasFocus(panes()));
    scene->view().resize(412, 915);
    scene->settle();
    EXPECT_EQ(overview(), nullptr);
    EXPECT_TRUE(hasFocus(panes()));
    EXPECT_EQ(panes()->width(), 412);
}

TEST_F(OverviewView, InAWideWindowTheKeyMovesTheKeyboardThereAndBack) {
    startLte({1200, 800});
    openSection();
    openOverview();
    EXPECT_TRUE(hasFocus(overview()));
    EXPECT_TRUE(panes()->isEnabled());
    scene->press(Qt::Key_Escape);
    scene->settle();
    EXPECT_TRUE(hasFocus(panes()));
    EXPECT_NE(overview(), nullptr);
    EXPECT_EQ(depth(), 2U);
    scene->press(Qt::Key_Escape);
    expectTop("Kelvo");
}

TEST_F(OverviewView, WaitsBelowAModalScreen) {
    startLte({1200, 800});
    openDetails();
    EXPECT_FALSE(overview()->isEnabled());
    scene->press(Qt::Key_O, Qt::ControlModifier);
    EXPECT_FALSE(isOpen());
    scene->press(Qt::Key_Escape);
    scene->settle();
    EXPECT_TRUE(overview()->isEnabled());
}

TEST_F(OverviewView, LetsTheKeyboardReachEverything) {
    startLte();
    measure(-95, {{366, -100}});
    openOverview();
    QStringList visited;
    for (int i = 0; i < 4; ++i) {
        scene->press(Qt::Key_Tab);
        const QQuickItem* item = scene->view().activeFocusItem();
        visited.append(item->objectName());
    }
    EXPECT_EQ(visited.join(u' ').toStdString(), "back cellRows eventRows back");
}

TEST_F(OverviewView, ScrollsByKey) {
    startLte({412, 412});
    openOverview();
    const QQuickItem* scroll = named("overviewScroll");
    scene->press(Qt::Key_Down);
    EXPECT_GT(scroll->property("contentY").toDouble(), 0);
    scene->press(Qt::Key_End);
    EXPECT_EQ(scroll->property("contentY").toDouble(), scroll->property("contentHeight").toDouble() - scroll->height());
    scene->press(Qt::Key_Home);
    EXPECT_EQ(scroll->property("contentY").toDouble(), 0);
}

TEST_F(OverviewView, SaysWhyThereIsNothingYet) {
    scene = std::make_unique<test::Scene>(false, QSize(412, 915));
    openOverview();
    EXPECT_TRUE(scene->shows(text("Connecting...")) || scene->shows(text("Connecting")));
    EXPECT_EQ(named("overviewScroll")->isVisible(), false);
}

TEST_F(OverviewView, LeavesNothingBehindHoweverOftenItWasOpen) {
    startLte();
    openOverview();
    scene->app().overview()->close();
    scene->settle();
    forgetDeleted();
    const qsizetype before = items();
    for (int times = 0; times < 100; ++times) {
        scene->app().overview()->show();
        EXPECT_EQ(scene->view().rootObject()->findChildren<QQuickItem*>(text("overviewScroll")).size(), 1);
        scene->app().overview()->close();
        forgetDeleted();
    }
    scene->settle();
    EXPECT_EQ(items(), before);
}

}  // namespace
}  // namespace kelvo
