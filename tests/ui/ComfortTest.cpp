#include <gtest/gtest.h>

#include <QQuickItem>
#include <QTest>
#include <QWheelEvent>

#include "tests/ui/ScreenFixture.h"
#include "ui/ActivityIndicator.h"
#include "ui/Theme.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::sampleTree;
using test::Scene;
using test::text;

/// What makes the screens pleasant to use, by touch, wheel and key, while readings come in.
class Comfort : public test::ScreenFixture {
protected:
    static Value longTree(int rows, const char* level) {
        const DictionaryRef display = Dictionary::make();
        for (int row = 0; row < rows; ++row) display->set("Row " + std::to_string(row), level);
        return display;
    }
    QQuickItem* showLongList() {
        start();
        scene->show(longTree(60, "-95 dBm"));
        scene->settle();
        return scene->itemOfType("QQuickListView");
    }
    QColor colorOf(const char* shown) { return scene->itemWithText(text(shown))->property("color").value<QColor>(); }
    void turnWheel(int degrees) {
        const QPointF at(180, 300);
        QWheelEvent turn(at, scene->view().mapToGlobal(at.toPoint()), QPoint(), QPoint(0, degrees * 8), Qt::NoButton,
                         Qt::NoModifier, Qt::NoScrollPhase, false);
        QCoreApplication::sendEvent(&scene->view(), &turn);
    }
};

TEST_F(Comfort, GoesOnGlidingWhenAReloadComesDuringAFlick) {
    QQuickItem* list = showLongList();
    scene->touch({180, 560});
    for (int y = 540; y >= 200; y -= 40) scene->move({180, qreal(y)});
    scene->lift({180, 200});
    ASSERT_TRUE(list->property("flicking").toBool());
    const double before = list->property("contentY").toDouble();
    scene->show(longTree(60, "-80 dBm"));
    EXPECT_TRUE(list->property("flicking").toBool());
    EXPECT_GE(list->property("contentY").toDouble(), before);
    EXPECT_TRUE(QTest::qWaitFor([&] { return list->property("contentY").toDouble() > before + 50; }));
}

TEST_F(Comfort, ScrollsByWheel) {
    QQuickItem* list = showLongList();
    turnWheel(-15);
    EXPECT_TRUE(QTest::qWaitFor([&] { return list->property("contentY").toDouble() > 20; }));
}

TEST_F(Comfort, JumpsByKeysAsFarAsTheyReach) {
    QQuickItem* list = showLongList();
    const auto current = [&] { return list->property("currentIndex").toInt(); };
    scene->press(Qt::Key_End);
    EXPECT_EQ(current(), 59);
    scene->press(Qt::Key_Home);
    EXPECT_EQ(current(), 0);
    scene->press(Qt::Key_PageDown);
    const int page = current();
    EXPECT_GT(page, 5);
    scene->press(Qt::Key_PageDown);
    EXPECT_EQ(current(), 2 * page);
    scene->press(Qt::Key_PageUp);
    EXPECT_EQ(current(), page);
}

TEST_F(Comfort, KeepsTheKeyboardsRowWhenARowComesAboveIt) {
    start();
    const auto tree = [](bool more) {
        const DictionaryRef display = Dictionary::make({{"First", "0"}, {"A", "1"}});
        if (more) display->set("B", "2");
        display->set("C", "3");
        return Value(display);
    };
    scene->show(tree(false));
    scene->settle();
    scene->press(Qt::Key_End);
    const KelvoCell* row = scene->row(text("C"));
    EXPECT_TRUE(row->property("marked").toBool());
    scene->show(tree(true));
    scene->settle();
    EXPECT_EQ(scene->row(text("C")), row);
    EXPECT_TRUE(row->property("marked").toBool());
}

TEST_F(Comfort, ColoursAValueThatChangedForAMoment) {
    start();
    scene->tapText(text("Serving Cell"));
    scene->settle();
    const QColor calm = colorOf("-95 dBm");
    scene->show(sampleTree(3, "-80 dBm"));
    EXPECT_NE(colorOf("-80 dBm"), calm);
    EXPECT_EQ(colorOf("7"), calm);  // the same cell as before
    scene->pass(1s);
    EXPECT_TRUE(QTest::qWaitFor([&] { return colorOf("-80 dBm") == calm; }));
}

TEST_F(Comfort, NeverMovesAValueWhoseDigitsChange) {
    start();
    scene->tapText(text("Serving Cell"));
    scene->settle();
    scene->show(sampleTree(3, "-111 dBm"));
    const QRectF frame = scene->row(text("RSRP"))->valueFrame();
    for (const char* level : {"-104 dBm", "-100 dBm", "-118 dBm"}) {
        scene->show(sampleTree(3, level));
        EXPECT_EQ(scene->row(text("RSRP"))->valueFrame(), frame) << level;
    }
}

TEST_F(Comfort, ShowsAHundredNeighborsToTheLast) {
    start();
    scene->show(sampleTree(101));
    scene->tapText(text("Neighbor Cells"));
    expectTop("Neighbor Cells");
    scene->press(Qt::Key_End);
    scene->settle();
    scene->press(Qt::Key_Return);
    expectTop("100");
    EXPECT_TRUE(scene->shows(text("200")));  // its cell
}

TEST_F(Comfort, LetsTheIndicatorRestInAWindowThatNobodySees) {
    Scene fresh;
    const auto* indicator = qobject_cast<ActivityIndicator*>(fresh.itemOfType("kelvo::ActivityIndicator"));
    ASSERT_NE(indicator, nullptr);
    EXPECT_TRUE(indicator->isTurning());
    fresh.view().hide();
    EXPECT_TRUE(QTest::qWaitFor([&] { return !indicator->isTurning(); }));
    fresh.view().show();
    EXPECT_TRUE(QTest::qWaitFor([&] { return indicator->isTurning(); }));
}

TEST_F(Comfort, HoldsTheSaveScreenAndTurnsAnIndicatorWhileTheFileIsWritten) {
    start(true);
    openSheet();
    scene->worker.held = true;
    scene->tapText(text("Save"));
    EXPECT_NE(scene->itemOfType("kelvo::ActivityIndicator"), nullptr);
    scene->tapText(text("Cancel"));
    scene->press(Qt::Key_Escape);
    scene->show(sampleTree(4));  // the panes below go on
    EXPECT_TRUE(scene->shows(text("Save Snapshot")));
    scene->worker.finish();
    scene->queue.run();
    scene->settle();
    EXPECT_FALSE(scene->shows(text("Save Snapshot")));
    EXPECT_EQ(savedFiles().size(), 1U);
}

TEST_F(Comfort, KeepsTheParentsNameBesideALongTitle) {
    start();
    scene->show(
        Dictionary::make({{"First", "0"}, {"Serving Cell Measurements", Dictionary::make({{"A", "1"}, {"B", "2"}})}}));
    scene->settle();
    scene->tapText(text("Serving Cell Measurements"));
    expectTop("Serving Cell Measurements");
    const QQuickItem* title = scene->itemWithText(text("Serving Cell Measurements"));
    const QQuickItem* back = scene->itemWithText(text("Kelvo"));
    EXPECT_LE(back->mapToScene({back->width(), 0}).x(), title->mapToScene({0, 0}).x());
    EXPECT_LE(title->mapToScene({title->width(), 0}).x(), 360);
}

TEST_F(Comfort, GoesBackByTheMousesOwnButton) {
    start();
    scene->tapText(text("Serving Cell"));
    expectTop("Serving Cell");
    QTest::mouseClick(&scene->view(), Qt::BackButton, Qt::NoModifier, {180, 300});
    expectTop("Kelvo");
}

TEST_F(Comfort, ClosesItsWindowByKey) {
    start();
    scene->press(Qt::Key_Q, Qt::ControlModifier);
    EXPECT_FALSE(scene->view().isVisible());
}

TEST_F(Comfort, WearsWhatTheDesktopAsksForAndTheSystemsColoursOtherwise) {
    start();
    const auto isDark = [this] { return scene->view().grabWindow().pixelColor(180, 500).lightness() < 60; };
    Theme::follow(true);
    EXPECT_TRUE(isDark());
    Theme::follow(false);
    EXPECT_FALSE(isDark());
    Theme::follow(true);
    Theme::follow(std::nullopt);
    EXPECT_FALSE(isDark());
}

}  // namespace
}  // namespace kelvo
