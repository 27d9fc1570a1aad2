#include <gtest/gtest.h>

#include <QImage>
#include <QQuickItem>
#include <QTest>
#include <optional>

#include "tests/ui/ScreenFixture.h"

namespace kelvo {
namespace {

using test::sampleTree;
using test::Scene;
using test::text;

/// What moves, what does not, and what stands at a row's end.
class TransitionTest : public test::ScreenFixture {
protected:
    bool slides() { return scene->itemOfType("QQuickStackView")->property("busy").toBool(); }
    /// Where the left edge of the page with that title is; it may be on its way.
    double pageOf(const char* title) {
        const QQuickItem* item = scene->itemWithText(text(title));
        while (item != nullptr && !QByteArray(item->metaObject()->className()).startsWith("PanePage")) {
            item = item->parentItem();
        }
        return item != nullptr ? item->x() : -1;
    }
    bool shows(const QString& key, const char* accessory) {
        return scene->row(key)->findChild<QQuickItem*>(text(accessory))->isVisible();
    }
    QColor backgroundOf(const char* key) {
        return scene->view().grabWindow().pixelColor(scene->row(text(key))->mapToScene({180, 6}).toPoint());
    }
};

TEST_F(TransitionTest, ShowsTheFirstPaneWithoutOne) {
    scene = std::make_unique<Scene>();
    EXPECT_FALSE(slides());
    EXPECT_EQ(pageOf("Connecting"), 0);
}

TEST_F(TransitionTest, SlidesAPaneInFromTheRightThatIsPushed) {
    start();
    std::optional<double> comesFrom;
    QObject::connect(scene->app().navigation(), &NavigationStack::pushed, &scene->view(), [&] {
        EXPECT_TRUE(slides());
        comesFrom = pageOf("Serving Cell");
    });
    scene->tapText(text("Serving Cell"));
    EXPECT_EQ(comesFrom, 360);  // beside the window
    scene->settle();
    EXPECT_FALSE(slides());
    EXPECT_EQ(pageOf("-95 dBm"), 0);
}

TEST_F(TransitionTest, SlidesAPaneOutToTheRightThatIsPopped) {
    start();
    scene->tapText(text("Serving Cell"));
    scene->settle();
    bool popped = false;
    QObject::connect(scene->app().navigation(), &NavigationStack::popped, &scene->view(), [&] {
        popped = true;
        EXPECT_TRUE(slides());
        EXPECT_EQ(pageOf("-95 dBm"), 0);  // still there
        EXPECT_LT(pageOf("Registration"), 0);
    });
    scene->press(Qt::Key_Escape);
    EXPECT_TRUE(popped);
    scene->settle();
    EXPECT_EQ(pageOf("Registration"), 0);
    EXPECT_FALSE(scene->shows(text("-95 dBm")));
}

TEST_F(TransitionTest, SlidesAPaneOutWhoseBranchHasVanished) {
    start();
    scene->tapText(text("Neighbor Cells"));
    scene->settle();
    scene->tap(scene->row(text("2")));
    scene->settle();
    EXPECT_FALSE(slides());
    scene->show(sampleTree(1));
    EXPECT_TRUE(slides());
    expectTop("Neighbor Cells");
}

TEST_F(TransitionTest, LetsTheHighlightOfALeafGoAtOnce) {
    start();
    const QColor calm = backgroundOf("Registration");
    scene->tapText(text("Registration"));
    EXPECT_EQ(scene->app().navigation()->topViewController().selectedRow(), -1);
    EXPECT_EQ(backgroundOf("Registration"), calm);
}

TEST_F(TransitionTest, KeepsTheHighlightOfARowWhilePushedPaneComes) {
    start();
    const QColor calm = backgroundOf("Serving Cell");
    const QPointF at = scene->row(text("Serving Cell"))->mapToScene({100, 25});
    scene->touch(at);
    EXPECT_NE(backgroundOf("Serving Cell"), calm);
    scene->lift(at);
    EXPECT_EQ(scene->app().navigation()->viewControllers().front()->selectedRow(), 0);
    scene->settle();
    scene->press(Qt::Key_Escape);
    scene->settle();
    EXPECT_EQ(backgroundOf("Serving Cell"), calm);
}

TEST_F(TransitionTest, PutsRowsInAndTakesThemAwayWithoutOne) {
    start();
    scene->tapText(text("Neighbor Cells"));
    scene->settle();
    scene->show(sampleTree(4));
    QCoreApplication::processEvents();
    scene->view().grabWindow();
    EXPECT_EQ(scene->row(text("3"))->y(), 150);
    EXPECT_EQ(scene->row(text("3"))->opacity(), 1);
    scene->show(sampleTree(2));
    QCoreApplication::processEvents();
    scene->view().grabWindow();
    EXPECT_FALSE(scene->shows(text("3")));
}

TEST_F(TransitionTest, MovesTheStatusTextToItsPlaceWhenTheIndicatorGoes) {
    scene = std::make_unique<Scene>();
    scene->connect();
    const auto statusAt = [this] {
        return scene->itemOfType("StatusBar")->findChild<QQuickItem*>(text("status"))->x();
    };
    EXPECT_EQ(statusAt(), 44);
    scene->app().navigation()->topViewController().setStatus(text("Updated"), false);
    EXPECT_EQ(statusAt(), 44);  // it sets out from where it is
    EXPECT_TRUE(QTest::qWaitFor([&] { return statusAt() == 16; }));
}

TEST_F(TransitionTest, MarksEveryRowThatOpensAndNoOther) {
    start();
    EXPECT_TRUE(shows(text("Serving Cell"), "disclosure"));
    EXPECT_TRUE(shows(text("Neighbor Cells"), "disclosure"));
    EXPECT_FALSE(shows(text("Registration"), "disclosure"));
    scene->show(
        Dictionary::make({{"Serving Cell", "none"}, {"Neighbor Cells", "none"}, {"Registration", Array::make()}}));
    scene->settle();
    EXPECT_FALSE(shows(text("Serving Cell"), "disclosure"));
    EXPECT_TRUE(shows(text("Registration"), "disclosure"));
}

TEST_F(TransitionTest, MarksRowsThatOpenAmongRecycledOnes) {
    QQuickItem* list = startWithRecycledRows();
    for (int leaf = 22; leaf < 29; ++leaf) {
        EXPECT_FALSE(shows(text("Leaf ") + QString::number(leaf), "disclosure")) << leaf;
    }
    for (int y = 2400; y >= 0; y -= 100) {
        list->setProperty("contentY", y);
        scene->settle();
    }
    for (int branch = 0; branch < 8; ++branch) {
        EXPECT_TRUE(shows(text("Branch ") + QString::number(branch), "disclosure")) << branch;
    }
}

TEST_F(TransitionTest, MarksEveryEntryOfASnapshot) {
    start(true);
    scene->show(sampleTree(2));
    bool moves = false;
    QObject::connect(&scene->app(), &KelvoApp::saveViewPresented, &scene->view(),
                     [&] { moves = scene->itemOfType("SaveSheet")->property("moving").toBool(); });
    scene->tapText(text("Save"));
    EXPECT_TRUE(moves);  // presented animated
    scene->settle();
    for (const char* entry : {"Snapshot (2011-03-04 09:15:04 +0000)", "Snapshot (2011-03-04 09:15:06 +0000)"}) {
        const QQuickItem* row = scene->itemWithText(text(entry))->parentItem();
        const QQuickItem* check = row->findChild<QQuickItem*>(text("check"));
        ASSERT_NE(check, nullptr);
        EXPECT_TRUE(check->isVisible()) << entry;
    }
    scene->tapText(text("Cancel"));
    scene->queue.run();
    EXPECT_TRUE(scene->shows(text("Save Snapshot")));  // dismissed animated: on its way
    scene->settle();
    EXPECT_FALSE(scene->shows(text("Save Snapshot")));
}

}  // namespace
}  // namespace kelvo
