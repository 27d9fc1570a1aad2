#include <gtest/gtest.h>

#include "overview/Observation.h"
#include "tests/overview/Shown.h"

namespace kelvo::overview {
namespace {

TEST(IfxObservation, TheTreeSaysWhichRadioItIsOn) {
    const Observation seen = observe(
        Technology::IFX,
        group(
            {{"Serving", shown({{"Technology", "UMTS"},
                                {"MCC", "001"},
                                {"MNC", "01"},
                                {"LAC", "2152"},
                                {"CellId", "6649158"},
                                {"BandInfo", "UMTS 2100"},
                                {"UARFCN", "10562"},
                                {"SCN", "17"},
                                {"RSCP", "-101 dBm"},
                                {"ECN0", "-8.5 dB"}},
                               3)},
             {"Neighbours",
              group({{"GSM", list({shown({{"ARFCN", "48"}, {"BSIC", "16"}, {"RSSI", "-85 dBm"}}, 3), shown("72", 3)})},
                     {"UMTS", list({shown({{"SCN", "19"}, {"RSCP", "-104 dBm"}, {"ECN0", "-12.0 dB"}}, 3)})}})},
             {"Registration", shown({{"State", "Registered"}, {"LAC", "2152"}})},
             {"Connection", shown({{"State", "Call"}, {"Channel", "DCH"}, {"Errors", "0.2 %"}})}}));
    EXPECT_EQ(seen.access, "UMTS");
    EXPECT_EQ(seen.state, "Call");
    EXPECT_TRUE(seen.isDedicated);
    EXPECT_EQ(seen.cell, "UARFCN 10562, PSC 17");
    EXPECT_EQ(seen.cellRecord, 3u);
    EXPECT_DOUBLE_EQ(seen.level->figure.number, -101);
    EXPECT_EQ(seen.level->figure.unit, "dBm");
    EXPECT_DOUBLE_EQ(seen.quality->figure.number, -8.5);
    EXPECT_EQ(seen.area, "LAC 2152");
    const std::vector<Fact> facts = {{"Network", "001-01"},
                                     {"Cell identity", "6649158 (RNC 101, cell 30022)"},
                                     {"Band", "UMTS 2100 (2112.4 MHz down, 1922.4 MHz up)"}};
    EXPECT_EQ(seen.serving, facts);
    ASSERT_EQ(seen.cells.size(), 3u);
    EXPECT_EQ(seen.cells[0].identity, "ARFCN 48, BSIC 16");
    EXPECT_EQ(seen.cells[1].identity, "ARFCN 72");
    EXPECT_FALSE(seen.cells[1].level);
    EXPECT_EQ(seen.cells[1].record, 3u);
    EXPECT_EQ(seen.cells[2].identity, "UARFCN 10562, PSC 19");
    EXPECT_EQ(seen.rates, (std::vector<Fact>{{"Errors", "0.2 %"}}));
    ASSERT_TRUE(seen.rates[0].figure);
    EXPECT_DOUBLE_EQ(seen.rates[0].figure->number, 0.2);
    EXPECT_EQ(seen.rates[0].figure->unit, "%");
    EXPECT_EQ(seen.registrationState, "Registered");
}

TEST(IfxObservation, AGroupWithNothingButItsStateStandsAsThatText) {
    const Observation seen =
        observe(Technology::IFX, group({{"Registration", shown("Searching")}, {"Connection", shown("Idle")}}));
    EXPECT_EQ(seen.state, "Idle");
    EXPECT_FALSE(seen.isDedicated);
    EXPECT_TRUE(seen.isWithoutService);
}

}  // namespace
}  // namespace kelvo::overview
