#include <gtest/gtest.h>

#include <QQuickItem>
#include <QTest>

#include "tests/ui/ScreenFixture.h"

namespace kelvo {
namespace {

using test::text;

/// A finger on a row whose value is too long for it.
class SidewaysScroll : public test::ScreenFixture {
protected:
    void startWith(const std::string& state) {
        start();
        showState(state);
    }
    void showState(const std::string& state) {
        scene->show(Dictionary::make({{"State", state}, {"Cells", Array::make()}}));
        scene->settle();
    }
    double contentX() { return strip(text("State"))->property("contentX").toDouble(); }
    /// Scrolls the row to the left; the finger stays on it, where the returned point is.
    QPointF drag() {
        const QPointF from = scene->row(text("State"))->mapToScene({300, 25});
        scene->touch(from);
        for (int x = 10; x <= 120; x += 10) scene->move(from - QPointF(x, 0));
        return from - QPointF(120, 0);
    }

    const std::string tooLong = "a value that is much too long for the width of one row of this telephone ";
};

TEST_F(SidewaysScroll, StaysUnderTheFingerWhenTheValueItselfChanges) {
    startWith(tooLong + "ab");
    const QPointF finger = drag();
    const double scrolled = contentX();
    EXPECT_GT(scrolled, 40);
    scene->show(Dictionary::make({{"State", tooLong + "ba"}, {"Cells", Array::make()}}));
    EXPECT_TRUE(scene->shows(QString::fromStdString(tooLong + "ba")));
    EXPECT_EQ(contentX(), scrolled);
    EXPECT_TRUE(strip(text("State"))->property("dragging").toBool());
    scene->move(finger - QPointF(20, 0));
    EXPECT_EQ(contentX(), scrolled + 20);
    scene->lift(finger - QPointF(20, 0));
}

TEST_F(SidewaysScroll, ComesBackToItsStartForAValueThatBecomesShort) {
    startWith(tooLong);
    scene->lift(drag());
    EXPECT_TRUE(QTest::qWaitFor([this] { return !strip(text("State"))->property("moving").toBool(); }));
    EXPECT_GT(contentX(), 40);
    showState("short");
    EXPECT_TRUE(scene->shows(text("short")));
    EXPECT_TRUE(QTest::qWaitFor([this] { return contentX() == 0; }));
}

TEST_F(SidewaysScroll, ComesBackToItsStartForAValueThatBecomesShortWhileItGlides) {
    startWith(tooLong);
    scene->lift(drag());
    EXPECT_GT(contentX(), 40);
    showState("short");
    EXPECT_TRUE(QTest::qWaitFor([this] { return contentX() == 0; }));
}

}  // namespace
}  // namespace kelvo
