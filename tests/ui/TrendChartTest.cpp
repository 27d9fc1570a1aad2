#include "ui/TrendChart.h"

#include <gtest/gtest.h>

#include <QAccessible>
#include <QImage>

#include "tests/ui/DetailsFixture.h"
#include "ui/Theme.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::text;

/// A chart with five minutes of readings: 150 of them, from -110 dBm on upwards by a quarter dB each.
class TrendChartTest : public test::DetailsFixture {
protected:
    void SetUp() override {
        startLte();
        for (int i = 0; i < 149; ++i) measure(-110 + 0.25 * (i + 1));
        openDetails();
    }
    QPointF at(double share) {
        const QRectF area = chart()->plotArea();
        return chart()->mapToScene({area.left() + share * area.width(), area.center().y()});
    }
    Trend::Time span() { return chart()->view().span(); }
    void drag(QPointF from, qreal by) {
        scene->touch(from);
        for (int step = 1; step <= 10; ++step) scene->move(from + QPointF(by * step / 10, 0));
        scene->lift(from + QPointF(by, 0));
    }
};

TEST_F(TrendChartTest, TellsLeastMeanAndMostOfWhatIsSeen) {
    // -95 at the start, then -109.75 to -72.75: the mean of all 150.
    EXPECT_EQ(chart()->statistics(), text("min -109.75   mean -91.28   max -72.75"));
    chart()->zoomBy(0.1, 1000);
    EXPECT_EQ(span(), 30s);
    EXPECT_EQ(chart()->statistics(), text("min -76.5   mean -74.62   max -72.75"));
}

TEST_F(TrendChartTest, SaysInWordsWhatItShows) {
    QAccessibleInterface* heard = QAccessible::queryAccessibleInterface(chart());
    ASSERT_NE(heard, nullptr);
    EXPECT_EQ(heard->role(), QAccessible::Chart);
    EXPECT_EQ(heard->text(QAccessible::Name), text("Trend"));
    EXPECT_EQ(heard->text(QAccessible::Description),
              text("-72.75 dBm, between -109.75 and -72.75 in the last five minutes, rising"));
}

TEST_F(TrendChartTest, MovesUnderAFingerAndComesBack) {
    EXPECT_FALSE(scene->shows(text("To the latest")));
    drag(at(0.2), 200);
    EXPECT_FALSE(chart()->isLive());
    const Trend::Time ago = chart()->view().now() - chart()->view().to();
    const double perPixel = 300.0 / chart()->plotArea().width();
    EXPECT_NEAR(static_cast<double>(ago.count()) / 1000, 200 * perPixel, 25 * perPixel);  // a drag begins a little late
    scene->tapText(text("To the latest"));
    EXPECT_TRUE(chart()->isLive());
}

TEST_F(TrendChartTest, ZoomsWithTwoFingers) {
    auto touch = QTest::touchEvent(&scene->view(), test::touchScreen(), false);
    const QPoint left = at(0.4).toPoint();
    const QPoint right = at(0.6).toPoint();
    touch.press(0, left).press(1, right).commit();
    for (int step = 5; step <= 60; step += 5) {
        touch.move(0, left - QPoint(step, 0)).move(1, right + QPoint(step, 0)).commit();
        scene->view().grabWindow();
    }
    touch.release(0, left - QPoint(60, 0)).release(1, right + QPoint(60, 0)).commit();
    EXPECT_LT(span(), 250s);
    EXPECT_GT(span(), 60s);
}

TEST_F(TrendChartTest, ZoomsWithTheWheel) {
    const QPointF where = at(1);
    QWheelEvent closer(where, scene->view().mapToGlobal(where), {}, {0, 240}, Qt::NoButton, Qt::NoModifier,
                       Qt::NoScrollPhase, false);
    QCoreApplication::sendEvent(&scene->view(), &closer);
    EXPECT_EQ(span(), 150s);
}

TEST_F(TrendChartTest, ReadsThePointThatIsTapped) {
    EXPECT_EQ(textOf("reading"), text("Tap to read, drag to move, pinch to zoom"));
    scene->tap(at(0.8));  // 60 of 300 seconds ago, 30 readings before the last
    EXPECT_EQ(chart()->cursorText(), text("-80.25 dBm, 60 seconds ago"));
    EXPECT_EQ(textOf("reading"), text("-80.25 dBm, 60 seconds ago"));
}

TEST_F(TrendChartTest, ReadsPointByPointWithTheKeyboard) {
    chart()->forceActiveFocus();
    scene->press(Qt::Key_Left);
    EXPECT_EQ(chart()->cursorText(), text("-72.75 dBm, 0 seconds ago"));
    scene->press(Qt::Key_Left);
    EXPECT_EQ(chart()->cursorText(), text("-73.00 dBm, 2 seconds ago"));
    scene->press(Qt::Key_Right);
    scene->press(Qt::Key_Right);
    EXPECT_EQ(chart()->cursorText(), text("-72.75 dBm, 0 seconds ago"));
    scene->press(Qt::Key_Plus);
    EXPECT_EQ(span(), 150s);
    scene->press(Qt::Key_Minus);
    EXPECT_EQ(span(), 300s);
    scene->press(Qt::Key_PageUp);
    EXPECT_FALSE(chart()->isLive());
    scene->press(Qt::Key_End);
    EXPECT_TRUE(chart()->isLive());
    scene->press(Qt::Key_Escape);
    EXPECT_EQ(chart()->cursorText(), QString());
    EXPECT_NE(scene->app().details(), nullptr);  // Escape took the cursor away first
    scene->press(Qt::Key_Escape);
    scene->settle();
    EXPECT_EQ(scene->app().details(), nullptr);
}

/// Whether the line's colour is anywhere in a column of the plot.
bool isDrawnAt(const QImage& picture, const TrendChart& chart, double x) {
    const QRectF area = chart.plotArea().translated(chart.mapToScene({0, 0}));
    for (int y = static_cast<int>(area.top()); y < static_cast<int>(area.bottom()); ++y) {
        const QColor color = picture.pixelColor(static_cast<int>(x), y);
        if (color.hslSaturation() > 90 && color.alpha() == 255) return true;  // everything else is grey
    }
    return false;
}

TEST_F(TrendChartTest, BreaksWhereNoRecordCame) {
    scene->pass(120s);
    measure(-80);
    for (int i = 0; i < 15; ++i) measure(-80);
    const QImage picture = scene->view().grabWindow();
    // Of 300 seconds the last 32 and those from 152 ago on have readings.
    EXPECT_TRUE(isDrawnAt(picture, *chart(), at(0.45).x()));
    EXPECT_FALSE(isDrawnAt(picture, *chart(), at(0.55).x()));
    EXPECT_FALSE(isDrawnAt(picture, *chart(), at(0.85).x()));
    EXPECT_TRUE(isDrawnAt(picture, *chart(), at(0.95).x()));
}

TEST_F(TrendChartTest, MarksWhereAnotherCellBeganToServe) {
    const QImage before = scene->view().grabWindow();
    measure(-72, {}, 17);
    ASSERT_EQ(scene->app().details()->servingCells().size(), 1U);
    EXPECT_EQ(scene->app().details()->servingCells()[0].text, "PCI 17");
    for (int i = 0; i < 30; ++i) measure(-72, {}, 17);
    const QImage picture = scene->view().grabWindow();
    const auto inkAbove = [&](const QImage& image) {  // in the strip for marks' names
        const QPoint corner = chart()->mapToScene({0, 0}).toPoint();
        int ink = 0;
        for (int x = 0; x < static_cast<int>(chart()->width()); ++x) {
            for (int y = 0; y < 13; ++y) ink += image.pixelColor(corner + QPoint(x, y)).lightness() < 200 ? 1 : 0;
        }
        return ink;
    };
    EXPECT_EQ(inkAbove(before), 0);
    EXPECT_GT(inkAbove(picture), 50);
}

}  // namespace
}  // namespace kelvo
