#include <gtest/gtest.h>

#include "tests/ui/OverviewFixture.h"

namespace kelvo {
namespace {

using test::text;

/// What happened, with the values before and after.
class OverviewEvents : public test::OverviewFixture {
protected:
    /// One cell serves at -95 dBm, then another at -80.25 dBm.
    void startWithHandover() {
        startLte();
        measure(-80.25, {}, 17);
        openOverview();
        scene->press(Qt::Key_End);
        scene->settle();
    }
    /// The values of the event that is open, name by name.
    QStringList values() { return heard().filter(text(": before ")); }
    void reachEvents() {
        for (int presses = 0; presses < 3 && !named("eventRows")->hasActiveFocus(); ++presses)
            scene->press(Qt::Key_Tab);
    }
    static QString handover() {
        return text(
            "09:15:06, Handover, from EARFCN 1300, PCI 301 to EARFCN 1300, PCI 17, from -95.00 dBm to -80.25 dBm");
    }
};

TEST_F(OverviewEvents, StandNewestFirst) {
    startWithHandover();
    const QStringList all = heard();
    const auto at = all.indexOf(handover());
    ASSERT_GE(at, 0) << joined(all);
    EXPECT_EQ(all[at + 1], text("09:15:04, Cell found, EARFCN 1300, PCI 301, -95.00 dBm"));
    EXPECT_TRUE(scene->shows(QString::fromUtf8("EARFCN 1300, PCI 301 → EARFCN 1300, PCI 17")));
    EXPECT_TRUE(scene->shows(QString::fromUtf8("-95.00 dBm → -80.25 dBm")));
}

TEST_F(OverviewEvents, ShowTheValuesBeforeAndAfterAtATapAndHideThemAtTheNext) {
    startWithHandover();
    EXPECT_EQ(values(), QStringList());
    tapEvent("Handover");
    const QStringList open = values();
    EXPECT_TRUE(open.contains(text("Cell: before EARFCN 1300, PCI 301, after EARFCN 1300, PCI 17"))) << joined(open);
    EXPECT_TRUE(open.contains(text("RSRP: before -95.00 dBm, after -80.25 dBm")));
    EXPECT_TRUE(scene->shows(text("Before")));
    tapEvent("Handover");
    EXPECT_EQ(values(), QStringList());
}

TEST_F(OverviewEvents, OpenOneAtATime) {
    startWithHandover();
    tapEvent("Handover");
    tapEvent("Cell found");
    EXPECT_FALSE(values().contains(text("RSRP: before -95.00 dBm, after -80.25 dBm")));
    EXPECT_TRUE(values().contains(QString::fromUtf8("RSRP: before –, after -95.00 dBm"))) << joined(values());
}

TEST_F(OverviewEvents, OpenByKeyAndCloseBeforeTheOverviewGoes) {
    startWithHandover();
    reachEvents();
    scene->press(Qt::Key_Down);
    scene->press(Qt::Key_Up);
    scene->press(Qt::Key_Return);
    scene->settle();
    EXPECT_TRUE(values().contains(text("RSRP: before -95.00 dBm, after -80.25 dBm")));
    scene->press(Qt::Key_Escape);
    scene->settle();
    EXPECT_EQ(values(), QStringList());
    EXPECT_TRUE(isOpen());
    scene->press(Qt::Key_Escape);
    scene->settle();
    EXPECT_FALSE(isOpen());
}

TEST_F(OverviewEvents, KeepTheKeyboardWhenAnotherComes) {
    startWithHandover();
    reachEvents();
    const QQuickItem* rows = named("eventRows");
    EXPECT_EQ(rows->property("currentRow").toInt(), 0);
    measure(-79, {}, 18);
    EXPECT_EQ(rows->property("currentRow").toInt(), 1);
    scene->press(Qt::Key_Return);
    scene->settle();
    EXPECT_TRUE(values().contains(text("RSRP: before -95.00 dBm, after -80.25 dBm")));
}

TEST_F(OverviewEvents, AreFollowedWhileNobodyLooks) {
    startLte();
    for (std::uint32_t cell = 1; cell <= 25; ++cell) measure(-95, {}, cell);
    openOverview();
    EXPECT_EQ(scene->app().overview()->events()->count(), 20);
    scene->press(Qt::Key_End);
    scene->settle();
    scene->tapText(text("Show earlier"));
    scene->settle();
    EXPECT_EQ(scene->app().overview()->events()->count(), 26);
    EXPECT_FALSE(scene->shows(text("Show earlier")));
    scene->app().overview()->close();
    scene->settle();
    EXPECT_EQ(scene->app().overview()->events()->count(), 20);
}

}  // namespace
}  // namespace kelvo
