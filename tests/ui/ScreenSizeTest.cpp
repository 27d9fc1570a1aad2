#include <gtest/gtest.h>

#include <QQuickItem>
#include <QTest>
#include <ostream>
#include <stdexcept>

#include "tests/ui/ScreenFixture.h"

namespace kelvo {
namespace {

using test::text;

struct WindowSize {
    int width;
    int height;
    friend std::ostream& operator<<(std::ostream& out, const WindowSize& size) {
        return out << size.width << 'x' << size.height;
    }
};

/// Windows of a phone, of one held sideways and as small as they get, at the scale the program was started with.
class ScreenSize : public test::ScreenFixture, public testing::WithParamInterface<WindowSize> {
protected:
    static constexpr qreal kRounding = 0.5;  // places come out of divisions

    static Value measurements() {
        const DictionaryRef levels = Dictionary::make({{"Measured RSRP", "-95.50 dBm"}, {"State", "Idle"}});
        for (int row = 0; row < 30; ++row) levels->set("Row " + std::to_string(row), "1");
        return Dictionary::make({{"Serving Cell Measurements", levels}, {"Registration", "Registered"}});
    }
    QSize size() const { return {GetParam().width, GetParam().height}; }

    static QRectF areaOf(const QQuickItem* item) { return item->mapRectToScene({0, 0, item->width(), item->height()}); }
    static void expectInside(const QQuickItem* item, const QQuickItem* outer) {
        const QRectF area = areaOf(outer).adjusted(-kRounding, -kRounding, kRounding, kRounding);
        EXPECT_TRUE(area.contains(areaOf(item))) << item->metaObject()->className();
    }
    static void expectBeside(const QQuickItem* left, const QQuickItem* right) {
        EXPECT_LE(areaOf(left).right(), areaOf(right).left() + kRounding) << left->metaObject()->className();
    }
    static void expectAbove(const QQuickItem* upper, const QQuickItem* lower) {
        EXPECT_LE(areaOf(upper).bottom(), areaOf(lower).top() + kRounding) << upper->metaObject()->className();
    }
    static const QQuickItem* partOf(const QQuickItem* item, const char* type) {
        const QList<QQuickItem*> parts = item->childItems();
        for (const QQuickItem* part : parts) {
            if (QByteArray(part->metaObject()->className()).startsWith(type)) return part;
        }
        throw std::runtime_error(std::string("no part is a ") + type);
    }

    void expectBars(const char* title) {
        const QQuickItem* bar = scene->paneItemOfType("TitleBar");
        const QQuickItem* toolbar = scene->paneItemOfType("StatusBar");
        const QQuickItem* list = scene->itemOfType("QQuickListView");
        EXPECT_EQ(areaOf(bar).topLeft(), QPointF(0, 0));
        const double width = scene->itemOfType("QQuickStackView")->width();
        EXPECT_EQ(width, size().width() < 900 ? size().width() : 400);  // beside the overview
        EXPECT_EQ(bar->width(), width);
        EXPECT_EQ(areaOf(toolbar).bottomLeft(), QPointF(0, size().height()));
        EXPECT_EQ(toolbar->width(), width);
        expectAbove(bar, list);
        expectAbove(list, toolbar);
        EXPECT_GE(list->height(), 50);  // room for a row

        const QQuickItem* name = scene->itemWithText(text(title));
        expectInside(name, bar);
        EXPECT_LE(name->property("contentWidth").toDouble(), name->width() + 1);
        const QQuickItem* back = partOf(bar, "BarButton");
        EXPECT_EQ(back->isVisible(), depth() > 1);
        if (back->isVisible()) {
            expectInside(back, bar);
            expectBeside(back, name);
        }
        const QQuickItem* status = partOf(toolbar, "FigureText");
        const QQuickItem* save = partOf(toolbar, "BarButton");
        EXPECT_TRUE(save->isVisible());
        expectInside(status, toolbar);
        expectInside(save, toolbar);
        expectBeside(status, save);
    }
    void expectRows(const std::vector<const char*>& keys) {
        const QQuickItem* above = scene->paneItemOfType("TitleBar");
        for (const char* key : keys) {
            const KelvoCell* row = scene->row(text(key));
            expectAbove(above, row);
            const QRectF list = areaOf(scene->itemOfType("QQuickListView"));
            EXPECT_GE(areaOf(row).left(), list.left()) << key;
            EXPECT_LE(areaOf(row).right(), list.right()) << key;
            expectInside(strip(text(key)), row);
            expectInside(scene->paneItemWithText(text(key)), strip(text(key)));
            above = row;
        }
    }
};

TEST_P(ScreenSize, LeavesEveryPartOfAPaneItsRoom) {
    start(true, size());
    scene->show(measurements());
    scene->settle();
    EXPECT_EQ(scene->view().size(), size());
    EXPECT_EQ(scene->view().devicePixelRatio(), qEnvironmentVariable("QT_SCALE_FACTOR", text("1")).toDouble());
    expectBars("Kelvo");
    expectRows({"Serving Cell Measurements", "Registration"});

    scene->tapText(text("Serving Cell Measurements"));
    expectTop("Serving Cell Measurements");
    expectBars("Serving Cell Measurements");
    expectRows({"Measured RSRP", "State"});
    expectBeside(scene->itemWithText(text("Measured RSRP")), scene->itemWithText(text("-95.50 dBm")));
    expectBeside(scene->itemWithText(text("State")), scene->itemWithText(text("Idle")));
    expectInside(scene->itemWithText(text("Idle")), scene->row(text("State")));
}

TEST_P(ScreenSize, ShowsTheLastRowWholeAboveTheToolbar) {
    start(true, size());
    scene->show(measurements());
    scene->settle();
    scene->tapText(text("Serving Cell Measurements"));
    expectTop("Serving Cell Measurements");
    const QQuickItem* list = scene->itemOfType("QQuickListView");
    scene->press(Qt::Key_End);
    EXPECT_TRUE(QTest::qWaitFor([list] { return list->property("atYEnd").toBool(); }));
    scene->settle();
    expectInside(scene->row(text("Row 29")), list);
    expectAbove(scene->row(text("Row 29")), scene->paneItemOfType("StatusBar"));
}

TEST_P(ScreenSize, LeavesEveryPartOfTheSaveScreenItsRoom) {
    start(true, size());
    openSheet();
    const QQuickItem* cancel = scene->itemWithText(text("Cancel"));
    const QQuickItem* heading = scene->itemWithText(text("Save Snapshot"));
    const QQuickItem* save = scene->itemWithText(text("Save"));
    const QQuickItem* field = scene->itemOfType("QQuickTextField");
    const QQuickItem* entry = scene->itemWithText(text("Snapshot (2011-03-04 09:15:04 +0000)"));
    for (const QQuickItem* part : {cancel, heading, save, field, entry}) {
        expectInside(part, scene->view().contentItem());
    }
    expectBeside(cancel, heading);
    expectBeside(heading, save);
    expectAbove(heading, field);
    expectAbove(field, entry);
}

INSTANTIATE_TEST_SUITE_P(Sizes, ScreenSize,
                         testing::Values(WindowSize{412, 915}, WindowSize{915, 412}, WindowSize{240, 240}));

}  // namespace
}  // namespace kelvo
