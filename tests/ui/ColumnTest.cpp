#include <gtest/gtest.h>

#include <QQuickItem>
#include <stdexcept>

#include "tests/ui/ScreenFixture.h"

namespace kelvo {
namespace {

using test::text;

/// Windows as wide as the column of the rows, and wider.
class Column : public test::ScreenFixture, public testing::WithParamInterface<int> {
protected:
    static double left(const QQuickItem* item) { return item->mapToScene({0, 0}).x(); }
    static double right(const QQuickItem* item) { return item->mapToScene({item->width(), 0}).x(); }
    QQuickItem* buttonOf(const char* words) {
        QQuickItem* item = scene->itemWithText(text(words));
        while (item != nullptr && !item->inherits("QQuickAbstractButton")) item = item->parentItem();
        if (item == nullptr) throw std::runtime_error("not on a button");
        return item;
    }
};

TEST_P(Column, HoldsTheTitleLineAndTheStatusLineTogetherWithTheRows) {
    start(true, {GetParam(), 800});
    scene->tapText(text("Serving Cell"));
    expectTop("Serving Cell");
    const QQuickItem* row = scene->row(text("RSRP"));
    EXPECT_LE(row->width(), 640);
    EXPECT_EQ(left(scene->itemWithText(text("RSRP"))), left(row) + 16);
    EXPECT_EQ(left(scene->itemWithText(text("Updated 2011-03-04 at 09:15:04"))), left(row) + 16);  // below the keys
    EXPECT_EQ(left(buttonOf("Kelvo")), left(row) + 4);
    EXPECT_EQ(right(buttonOf("Save")), right(row) - 4);
    const QQuickItem* title = scene->itemWithText(text("Serving Cell"));
    EXPECT_NEAR((left(title) + right(title)) / 2, (left(row) + right(row)) / 2, 0.51);
    const double pane = scene->itemOfType("QQuickStackView")->width();  // the bars go on to its edges
    EXPECT_EQ(scene->paneItemOfType("TitleBar")->width(), pane);
    EXPECT_EQ(scene->paneItemOfType("StatusBar")->width(), pane);
}

TEST_P(Column, HoldsTheIndicatorBesideTheStatus) {
    test::Scene fresh(false, {GetParam(), 800});
    const QQuickItem* list = fresh.itemOfType("QQuickListView");
    EXPECT_EQ(left(fresh.itemOfType("kelvo::ActivityIndicator")), left(list) + 16);
    EXPECT_EQ(left(fresh.itemWithText(text("Connecting"))), left(list) + 44);
}

INSTANTIATE_TEST_SUITE_P(Widths, Column, testing::Values(360, 640, 641, 1201, 1280));

using TitleLine = test::ScreenFixture;

TEST_F(TitleLine, GivesTheWayBackRoomForAThumbHoweverShortItsNameIs) {
    start();
    const auto depths = [](const char* title) {
        return Dictionary::make(
            {{"l", Dictionary::make({{title, Dictionary::make({{"A", "1"}, {"B", "2"}})}, {"b", "1"}})}, {"z", "1"}});
    };
    const char* shortTitle = "i";
    const char* longTitle = "A title that is much too long for the width of this telephone";
    for (const char* title : {shortTitle, longTitle}) {
        scene->show(depths(title));
        scene->settle();
        scene->tap(scene->row(text("l")));
        expectTop("l");
        scene->tap(scene->row(text(title)));
        scene->settle();
        const QQuickItem* back = scene->itemOfType("TitleBar")->findChild<QQuickItem*>(text("back"));
        EXPECT_GE(back->width(), 44) << title;
        EXPECT_GE(back->height(), 44) << title;
        const QQuickItem* name = scene->itemWithText(text(title));
        EXPECT_LE(back->mapToScene({back->width(), 0}).x(), name->mapToScene({0, 0}).x()) << title;
        scene->tap(back->mapToScene({43, 43}));
        expectTop("l");
        scene->press(Qt::Key_Escape);
        expectTop("Kelvo");
    }
}

}  // namespace
}  // namespace kelvo
