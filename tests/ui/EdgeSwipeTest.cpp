#include <gtest/gtest.h>

#include <QQuickItem>
#include <QTest>

#include "tests/ui/ScreenFixture.h"

namespace kelvo {
namespace {

using test::sampleTree;
using test::text;

/// A swipe that begins at the window's left edge leads back.
class EdgeSwipe : public test::ScreenFixture {
protected:
    void openNeighbors() {
        start(true);
        scene->tapText(text("Neighbor Cells"));
        expectTop("Neighbor Cells");
    }
    void openANeighbor() {
        openNeighbors();
        scene->tap(scene->row(text("2")));
        expectTop("2");
    }
    void swipe(const QPointF& from, const QPointF& to) {
        scene->touch(from);
        for (int step = 1; step <= 10; ++step) scene->move(from + (to - from) * step / 10);
        scene->lift(to);
        scene->settle();
    }
    void drag(const QPoint& from, const QPoint& to) {
        QTest::mousePress(&scene->view(), Qt::LeftButton, Qt::NoModifier, from);
        for (int step = 1; step <= 10; ++step) QTest::mouseMove(&scene->view(), from + (to - from) * step / 10);
        QTest::mouseRelease(&scene->view(), Qt::LeftButton, Qt::NoModifier, to);
        scene->settle();
    }
};

TEST_F(EdgeSwipe, LeadsBackByTouch) {
    openANeighbor();
    swipe({3, 400}, {240, 410});
    expectTop("Neighbor Cells");
    EXPECT_EQ(depth(), 2U);  // one swipe, one step
    swipe({3, 80}, {240, 90});
    expectTop("Kelvo");
    EXPECT_EQ(depth(), 1U);
}

TEST_F(EdgeSwipe, LeadsBackByAMouseThatDrags) {
    openANeighbor();
    drag({3, 400}, {240, 410});
    expectTop("Neighbor Cells");
    drag({3, 80}, {240, 90});
    expectTop("Kelvo");
}

TEST_F(EdgeSwipe, LeadsBackAcrossARowThatScrollsSideways) {
    start();
    scene->show(Dictionary::make(
        {{"Levels", Dictionary::make({{"State", std::string(80, 'x')}, {"B", "1"}})}, {"Registration", "Registered"}}));
    scene->settle();
    scene->tapText(text("Levels"));
    expectTop("Levels");
    QQuickItem* scrolled = strip(text("State"));
    scrolled->setProperty("contentX", 100);
    const double y = scrolled->mapToScene({0, 25}).y();
    swipe({8, y}, {240, y});
    expectTop("Kelvo");
}

TEST_F(EdgeSwipe, DoesNothingThatIsShortOrBeginsElsewhere) {
    openNeighbors();
    swipe({3, 400}, {40, 400});
    expectTop("Neighbor Cells");
    swipe({120, 400}, {340, 400});
    expectTop("Neighbor Cells");
    drag({120, 400}, {340, 400});
    expectTop("Neighbor Cells");
    swipe({340, 400}, {3, 400});
    expectTop("Neighbor Cells");
}

TEST_F(EdgeSwipe, DoesNothingWhereThereIsNoWayBack) {
    start();
    swipe({3, 400}, {240, 400});
    drag({3, 400}, {240, 400});
    expectTop("Kelvo");
    EXPECT_EQ(depth(), 1U);
}

TEST_F(EdgeSwipe, DoesNothingUnderTheSaveScreenOrAnAlert) {
    openNeighbors();
    openSheet();
    swipe({3, 400}, {240, 400});
    EXPECT_EQ(depth(), 2U);
    EXPECT_TRUE(scene->shows(text("Save Snapshot")));
    scene->app().showAlert(text("File Error"), text("Unable to write file to disk"), text("Close"));
    drag({3, 400}, {240, 400});
    EXPECT_EQ(depth(), 2U);
}

TEST_F(EdgeSwipe, LeavesTapsAndSwipesUpAtTheEdgeToTheRows) {
    start();
    scene->show(sampleTree(40));
    scene->settle();
    scene->tapText(text("Neighbor Cells"));
    expectTop("Neighbor Cells");
    const QQuickItem* list = scene->itemOfType("QQuickListView");
    scene->touch({5, 500});
    for (int y = 490; y >= 300; y -= 10) scene->move({5, qreal(y)});
    EXPECT_GT(list->property("contentY").toDouble(), 100);
    scene->lift({5, 300});
    EXPECT_TRUE(QTest::qWaitFor([&] { return !list->property("moving").toBool(); }));
    EXPECT_EQ(depth(), 2U);
    scene->press(Qt::Key_Home);
    scene->settle();
    scene->tap({5, scene->row(text("3"))->mapToScene({0, 25}).y()});
    expectTop("3");
    scene->tap({14, 26});  // the way back
    expectTop("Neighbor Cells");
}

}  // namespace
}  // namespace kelvo
