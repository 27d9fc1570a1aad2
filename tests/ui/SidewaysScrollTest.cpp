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

    bool fades() { return scene->row(text("State"))->findChild<QQuickItem*>(text("fade"))->isVisible(); }
    /// How wide a window is whose row is as wide as key and value need by their measured, bold widths.
    static int windowFor(const QString& key, const QString& value) {
        const TextMeasure& measure = TextMeasure::system();
        const double row = measure.boldSize(key).width() + 10 + 50 + measure.boldSize(value).width();
        return static_cast<int>(row) + 22;  // of them 22 are margins
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

TEST_F(SidewaysScroll, ComesBackToItsStartForAShorterValueThatStillScrolls) {
    startWith(tooLong + tooLong);
    scene->lift(drag());
    EXPECT_TRUE(QTest::qWaitFor([this] { return !strip(text("State"))->property("moving").toBool(); }));
    EXPECT_GT(contentX(), 40);
    showState(tooLong);
    EXPECT_TRUE(strip(text("State"))->property("interactive").toBool());
    EXPECT_EQ(contentX(), 0);
}

TEST_F(SidewaysScroll, StaysWhereItIsForALongerValue) {
    startWith(tooLong);
    scene->lift(drag());
    EXPECT_TRUE(QTest::qWaitFor([this] { return !strip(text("State"))->property("moving").toBool(); }));
    const double scrolled = contentX();
    EXPECT_GT(scrolled, 40);
    showState(tooLong + "and longer");
    EXPECT_EQ(contentX(), scrolled);
}

TEST_F(SidewaysScroll, FadesOutWhereMoreOfTheValueLiesAndOnlyThere) {
    startWith(tooLong);
    EXPECT_TRUE(fades());
    strip(text("State"))->setProperty("contentX", 4000);
    EXPECT_FALSE(fades());
    showState("short");
    EXPECT_FALSE(fades());
}

// Measured bold, it is too wide for its row, which scrolls; drawn regular, every sign of it is seen.
TEST_F(SidewaysScroll, FadesNothingThatFitsAsItIsDrawn) {
    const QString value = text("+0015550100");
    const int measured = windowFor(text("State"), value);
    start(false, {measured - 1, 640});
    showState(value.toStdString());
    EXPECT_TRUE(strip(text("State"))->property("interactive").toBool());
    EXPECT_FALSE(fades());

    const double drawn = scene->itemWithText(value)->parentItem()->implicitWidth();
    const int flush = measured - static_cast<int>(TextMeasure::system().boldSize(value).width() - drawn);
    scene->view().resize(flush - 10, 640);  // its last sign ends in the margin, of which six are left
    scene->settle();
    EXPECT_FALSE(fades());
    scene->view().resize(flush - 11, 640);
    scene->settle();
    EXPECT_TRUE(fades());
}

TEST_F(SidewaysScroll, FadesNoNameThatFitsWithoutAValue) {
    start(false, {240, 640});
    const std::string key = "Name as long as a row";
    scene->show(Dictionary::make({{key, ""}, {"Cells", Array::make()}}));
    scene->view().resize(windowFor(QString::fromStdString(key), QString()) - 20, 640);
    scene->settle();
    const KelvoCell* row = scene->row(QString::fromStdString(key));
    EXPECT_TRUE(row->findChild<QQuickItem*>(text("strip"))->property("interactive").toBool());
    EXPECT_FALSE(row->findChild<QQuickItem*>(text("fade"))->isVisible());
}

}  // namespace
}  // namespace kelvo
