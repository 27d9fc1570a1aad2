#include "ui/SavedScreens.h"

#include <gtest/gtest.h>

#include "platform/system/Environment.h"
#include "tests/support/ManualClock.h"
#include "tests/ui/SavedSample.h"

namespace kelvo {
namespace {

using test::refreshXml;
using test::sampleSnapshot;
using test::savedScreens;
using test::snapshotXml;

class SavedScreensOf : public testing::Test {
protected:
    static std::string value(const SavedScreens& screens, const char* path) {
        const NodeRef node = screens.shownNodeAtPath(path);
        return node && node->value() != nullptr ? *node->value() : "(none)";
    }
    static constexpr const char* kRsrp = "/Serving Cell Measurements/Measured RSRP";

    test::ManualClock clock{1900000000, 120};  // years later, two hours east
    Environment::Scope environment{{.clock = &clock}};
};

TEST_F(SavedScreensOf, ASnapshotAreThoseOfItsLastRefreshInTheirOrder) {
    const auto screens = savedScreens(sampleSnapshot());
    const KelvoModelNode::Children& sections = *screens->topLevelNodes()->childNodes();
    ASSERT_EQ(sections.size(), 2U);
    EXPECT_EQ(sections[0]->displayName(), "Serving Cell Measurements");
    EXPECT_EQ(sections[1]->displayName(), "Measured Neighbor Cells");
    EXPECT_EQ(value(*screens, kRsrp), "-97.50 dBm");
    EXPECT_EQ(value(*screens, "/Measured Neighbor Cells/0/Filtered RSRP"), "-101.00 dBm");
}

TEST_F(SavedScreensOf, ASnapshotSayWhenItWasSavedInTheReadersZone) {
    const auto screens = savedScreens(sampleSnapshot());
    EXPECT_EQ(screens->savedText(), "Snapshot of 2011-03-04 at 11:15:02");
    EXPECT_EQ(screens->note(), "at the bridge");
}

TEST_F(SavedScreensOf, ALostConnectionSayThatTheReadingsAreOlder) {
    const std::string tenSeconds = refreshXml("2011-03-04 09:14:52 +0000", "-95.00 dBm", "17");
    EXPECT_EQ(savedScreens(snapshotXml(tenSeconds))->note(), "Readings of 2011-03-04 at 11:14:52: at the bridge");
    EXPECT_EQ(savedScreens(snapshotXml(tenSeconds, ""))->note(), "Readings of 2011-03-04 at 11:14:52");
    EXPECT_EQ(savedScreens(snapshotXml(refreshXml("2011-03-04 09:14:53 +0000", "-95.00 dBm", "17"), ""))->note(), "");
}

TEST_F(SavedScreensOf, AFileWithoutTimesDoNotMakeOneUp) {
    const auto screens = savedScreens("<plist version=\"1.0\"><dict><key>Data</key><array>" +
                                      refreshXml("some day", "-95.00 dBm", "17") + "</array></dict></plist>");
    EXPECT_EQ(screens->savedText(), "Snapshot of an unknown time");
    EXPECT_EQ(screens->note(), "");
    EXPECT_EQ(value(*screens, kRsrp), "-95.00 dBm");
    EXPECT_TRUE(screens->trends().changes(kRsrp).empty());
}

TEST_F(SavedScreensOf, ASnapshotKnowWhatStoodThereBefore) {
    using std::chrono::seconds;
    const auto screens = savedScreens(sampleSnapshot());
    const std::vector<TrendChange> expected = {{seconds(1299230096), "-95.00 dBm"},
                                               {seconds(1299230100), "-97.50 dBm"}};
    EXPECT_EQ(screens->trends().changes(kRsrp), expected);
    EXPECT_EQ(screens->trendTime(), seconds(1299230100));
    EXPECT_FALSE(screens->provenance(*screens->shownNodeAtPath(kRsrp)));
}

TEST_F(SavedScreensOf, ASnapshotLeaveOutRefreshesWhoseTimesGoBack) {
    const auto screens = savedScreens(snapshotXml(refreshXml("2011-03-04 09:20:00 +0000", "-80.00 dBm", "17") +
                                                  refreshXml("2011-03-04 09:15:00 +0000", "-90.00 dBm", "17") +
                                                  refreshXml("2011-03-04 09:15:00 +0000", "-97.50 dBm", "17")));
    const std::vector<TrendChange> expected = {{std::chrono::seconds(1299230100), "-97.50 dBm"}};
    EXPECT_EQ(screens->trends().changes(kRsrp), expected);
}

TEST_F(SavedScreensOf, ASnapshotFollowANeighborToAnotherRow) {
    const auto screens = savedScreens(sampleSnapshot());
    EXPECT_EQ(screens->trends().nameAt("/Measured Neighbor Cells/0/Filtered RSRP"),
              "/Measured Neighbor Cells/PCI 17/Filtered RSRP");
}

TEST_F(SavedScreensOf, AFamilyAreKnownByItsValues) {
    EXPECT_EQ(savedScreens(sampleSnapshot())->technology(), Technology::LTE);
    EXPECT_EQ(savedScreens(snapshotXml("<dict><key>DisplayState</key><dict/><key>Display</key><dict><key>Serving</key>"
                                       "<dict><key>CellId</key><string>7</string><key>ECN0</key><string>-8.5 dB"
                                       "</string></dict></dict></dict>"))
                  ->technology(),
              Technology::IFX);
    EXPECT_EQ(savedScreens(snapshotXml("<dict><key>Display</key><dict><key>Nobody's</key><string>7</string></dict>"
                                       "</dict>"))
                  ->technology(),
              std::nullopt);
}

TEST_F(SavedScreensOf, AnEmptyHistoryAreNone) {
    const auto screens = savedScreens(snapshotXml(""));
    EXPECT_EQ(screens->topLevelNodes(), nullptr);
    EXPECT_EQ(screens->whyEmpty(), "This snapshot holds no readings");
    EXPECT_EQ(screens->savedText(), "Snapshot of 2011-03-04 at 11:15:02");
}

TEST_F(SavedScreensOf, AHostileDescriptionStayOneLine) {
    EXPECT_EQ(savedScreens(snapshotXml("", "one&#10;two"))->note(), "one\xEF\xBF\xBDtwo");
}

}  // namespace
}  // namespace kelvo
