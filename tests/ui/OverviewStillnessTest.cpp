#include <gtest/gtest.h>

#include "tests/ui/OverviewFixture.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using overview::group;
using overview::list;
using overview::shown;
using test::text;

/// Nothing on the overview moves because a value comes or goes, and what the reader looks at stays in sight.
class OverviewStillness : public test::OverviewFixture {
protected:
    static Value measured(const char* quality, std::uint64_t record, const char* cell = "185") {
        return shown({{"E-ARFCN", "1300"},
                      {"Physical Cell ID", cell},
                      {"Measured RSRP", "-96.50 dBm"},
                      {"Measured RSRQ", quality}},
                     record);
    }
    static Value context(const char* number) {
        return shown({{"Context ID", number}, {"APN", "internet"}, {"State", "Active"}});
    }
    static Value broadcast(const char* area) {
        return shown({{"Tracking Area Code", area}, {"Download Bandwidth", "20 MHz"}, {"Upload Bandwidth", "20 MHz"}});
    }
    void startWithValues() {
        startModem(kPLLogChannelTechnology_Oskra_LTE);
        openOverview();
        showValues(group({{"Serving Cell Info", broadcast("1042")},
                          {"Serving Cell Measurements", measured("-9.25 dB", 5)},
                          {"Neighbor Measurements", shown({{"E-ARFCN", "1300"}}, 5)},
                          {"Neighbor Cells List", list({cell("17", 5), cell("44", 5)})},
                          {"PDP Context Info", list({context("5"), context("6")})}}));
    }
    static Value cell(const char* pci, std::uint64_t record) {
        return shown({{"Physical Cell ID", pci}, {"Measured RSRP", "-99.75 dBm"}}, record);
    }
};

TEST_F(OverviewStillness, HoldsThePlacesWhileValuesGoAndComeAgain) {
    startWithValues();
    const std::vector<double> before = places();
    showValues(group({{"Serving Cell Info", broadcast("")},
                      {"Serving Cell Measurements", measured("", 6, "186")},
                      {"PDP Context Info", list({})}}));
    EXPECT_EQ(places(), before);
    EXPECT_TRUE(isHeard("RSRQ not reported"));
    EXPECT_TRUE(isHeard("Area not reported"));
    EXPECT_FALSE(isHeard("internet (5), Active"));
    showValues(group({{"Serving Cell Info", broadcast("1043")},
                      {"Serving Cell Measurements", measured("-10.25 dB", 7)},
                      {"PDP Context Info", list({context("7")})}}));
    EXPECT_TRUE(isHeard("Area, TAC 1043"));
    EXPECT_EQ(places(), before);
}

TEST_F(OverviewStillness, HoldsThePlacesWhileCellsGetLostAndGo) {
    startWithValues();
    const std::vector<double> before = places();
    const double gone = before.back();
    showValues(group({{"Neighbor Cells List", list({})}}));
    scene->pass(42s);
    scene->settle();
    EXPECT_TRUE(scene->shows(text("None heard")));
    EXPECT_EQ(places(), before);
    showValues(group({{"Neighbor Cells List", list({cell("17", 8), cell("90", 8), cell("91", 8)})}}));
    EXPECT_FALSE(scene->shows(text("None heard")));
    EXPECT_EQ(places().back(), gone) << joined(heard());  // there is room for a few more from the beginning
}

TEST_F(OverviewStillness, LeavesAGaugeAndItsFactsInTheirPlaces) {
    startWithValues();
    const double level = named("levelGauge")->width();
    showValues(group({{"Serving Cell Measurements", measured("", 6, "186")}}));
    EXPECT_EQ(named("levelGauge")->width(), level);
    EXPECT_TRUE(named("qualityGauge")->isVisible());
}

TEST_F(OverviewStillness, KeepsInSightWhatIsReadWhenSomethingHappensAbove) {
    startLte({412, 412});
    for (std::uint32_t cell = 1; cell <= 12; ++cell) measure(-95, {}, cell);
    openOverview();
    scene->press(Qt::Key_End);
    scene->settle();
    const QQuickItem* last = scene->itemWithText(text("Cell found"));
    const double before = last->mapToScene({0, 0}).y();
    measure(-95, {}, 99);
    scene->settle();
    EXPECT_EQ(last->mapToScene({0, 0}).y(), before);
}

}  // namespace
}  // namespace kelvo
