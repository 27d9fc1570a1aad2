#include <gtest/gtest.h>

#include "overview/Observation.h"
#include "tests/overview/Shown.h"

namespace kelvo::overview {
namespace {

TEST(UtranObservation, TheServingCellIsTheRowOfTheActiveSet) {
    const auto row = [](const char* uarfcn, const char* cell, const char* level, const char* status) {
        return shown({{"UARFCN", uarfcn}, {"Cell ID", cell}, {"Filter RSCP", level}, {"Status", status}}, 4);
    };
    const Observation seen = observe(
        Technology::UTRAN, group({{"RRC Info", shown({{"State", "Cell DCH"}})},
                                  {"Serving Cell Info", shown({{"Cell ID", "44106030"},
                                                               {"Local Area Code", "2102"},
                                                               {"URA ID", "2"},
                                                               {"Downlink UARFCN", "10063"}})},
                                  {"Neighbor Cell List", list({row("10055", "105", "0.109375", "MSET"),
                                                               row("10063", "14", "0.125000", "ASET"),
                                                               row("10063", "9", "0.062500", "DSET")})},
                                  {"TRCH BLER", list({shown({{"TRCH ID", "5"}, {"TRCH BLER Measurement", "42"}})})}}));
    EXPECT_EQ(seen.state, "Cell DCH");
    EXPECT_TRUE(seen.isDedicated);
    EXPECT_EQ(seen.cell, "UARFCN 10063, cell 14");
    EXPECT_EQ(seen.cellRecord, 4u);
    EXPECT_DOUBLE_EQ(seen.level->figure.number, 0.125);
    EXPECT_EQ(seen.level->grade, "");
    EXPECT_EQ(seen.area, "LAC 2102, URA 2");
    const std::vector<Fact> facts = {{"Cell identity", "44106030 (RNC 673, cell 302)"},
                                     {"Band", "a (2012.6 MHz both ways)"}};
    EXPECT_EQ(seen.serving, facts);
    ASSERT_EQ(seen.cells.size(), 2u);
    EXPECT_EQ(seen.cells[0].identity, "UARFCN 10055, cell 105");
    EXPECT_EQ(seen.cells[1].mark, "detected");
    EXPECT_EQ(seen.rates, (std::vector<Fact>{{"BLER, channel 5", "42"}}));
    ASSERT_TRUE(seen.rates[0].figure);
    EXPECT_DOUBLE_EQ(seen.rates[0].figure->number, 42);
    EXPECT_EQ(seen.rates[0].figure->unit, "");
}

TEST(UtranObservation, WithoutAnActiveSetTheBroadcastNamesTheCell) {
    const Observation seen = observe(
        Technology::UTRAN,
        group({{"Serving Cell Info", shown({{"Downlink UARFCN", "10063"}, {"Cell Scrambling Code", "14"}}, 3)}}));
    EXPECT_EQ(seen.cell, "UARFCN 10063, cell 14");
    EXPECT_EQ(seen.cellRecord, 3u);
    EXPECT_FALSE(seen.level);
}

}  // namespace
}  // namespace kelvo::overview
