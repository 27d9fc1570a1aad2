#include <gtest/gtest.h>

#include <QImage>
#include <QQuickItem>
#include <QTest>

#include "tests/ui/Contrast.h"
#include "tests/ui/ScreenFixture.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using test::contrast;
using test::sampleTree;
using test::Scene;
using test::text;

TEST(Contrast, IsThatOfTheStandard) {
    EXPECT_NEAR(contrast(Qt::white, Qt::black), 21, 0.001);
    EXPECT_NEAR(contrast(Qt::white, Qt::white), 1, 0.001);
    EXPECT_NEAR(contrast(QColor(0x77, 0x77, 0x77), Qt::white), 4.48, 0.005);  // the best known near miss of 4.5
}

/// What marks a value that has just changed.
class FreshMark : public test::ScreenFixture, public testing::WithParamInterface<bool> {
protected:
    QQuickItem* mark(const char* key) { return scene->row(text(key))->findChild<QQuickItem*>(text("mark")); }
    QColor drawnAt(const QImage& picture, const QPointF& at) { return picture.pixelColor(at.toPoint()); }
};

TEST_P(FreshMark, StandsOutFromItsRowByThreeToOneAndFades) {
    Scene::useDarkColours(GetParam());
    start();
    scene->tapText(text("Serving Cell"));
    expectTop("Serving Cell");
    EXPECT_EQ(mark("RSRP")->opacity(), 0);
    const QQuickItem* before = scene->itemWithText(text("-95 dBm"));
    const QFont font = before->property("font").value<QFont>();

    scene->show(sampleTree(3, "-80 dBm"));
    const QImage picture = scene->view().grabWindow();
    const QQuickItem* line = mark("RSRP");
    const QPointF middle = line->mapToScene({line->width() / 2, line->height() / 2});
    const QColor background = drawnAt(picture, middle + QPointF(0, 8));
    EXPECT_GE(contrast(drawnAt(picture, middle), background), 3);
    EXPECT_EQ(contrast(drawnAt(picture, line->mapToScene({-10, 1})), background), 1);  // beside it
    EXPECT_EQ(mark("Cell ID")->opacity(), 0);                                          // did not change

    // Under the value, as wide as it, which is neither bolder nor wider than before.
    const QQuickItem* value = scene->itemWithText(text("-80 dBm"));
    EXPECT_EQ(value->property("font").value<QFont>(), font);
    EXPECT_EQ(line->width(), value->parentItem()->implicitWidth());
    EXPECT_GE(line->mapToScene({0, 0}).y(), value->mapToScene({0, value->height()}).y());
    EXPECT_LT(line->mapToScene({0, line->height()}).y(), scene->row(text("RSRP"))->mapToScene({0, 49}).y());

    scene->pass(1s);
    EXPECT_TRUE(QTest::qWaitFor([this] { return mark("RSRP")->opacity() == 0; }));
    EXPECT_EQ(contrast(drawnAt(scene->view().grabWindow(), middle), background), 1);
}

INSTANTIATE_TEST_SUITE_P(LightAndDark, FreshMark, testing::Bool(),
                         [](const auto& info) { return info.param ? "Dark" : "Light"; });

}  // namespace
}  // namespace kelvo
