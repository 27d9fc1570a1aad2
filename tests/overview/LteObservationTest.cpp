#include <gtest/gtest.h>

#include "overview/Observation.h"
#include "tests/overview/Shown.h"

namespace kelvo::overview {
namespace {

constexpr const char* kIdle = "Serving Cell Measurements";
constexpr const char* kConnected = "Connected mode LTE Intra-frequency Measurement";

Value idle(std::uint64_t record) {
    return shown({{"E-ARFCN", "5780"},
                  {"Physical Cell ID", "185"},
                  {"Measured RSRP", "-109.50 dBm"},
                  {"Measured RSRQ", "-9.25 dB"}},
                 record);
}

Value connected(std::uint64_t record) {
    return shown({{"E-ARFCN", "1300"},
                  {"Serving Physical Cell ID", "84"},
                  {"Serving Filtered RSRP", "-88.00 dBm"},
                  {"Serving Filtered RSRQ", "-13.00 dB"}},
                 record);
}

TEST(LteObservation, TheStateIsThatOfTheNewestMeasurement) {
    const Observation seen = observe(Technology::LTE, group({{kIdle, idle(5)}, {kConnected, connected(4)}}));
    EXPECT_EQ(seen.access, "LTE");
    EXPECT_EQ(seen.state, "idle");
    EXPECT_FALSE(seen.isDedicated);
    EXPECT_EQ(seen.cell, "EARFCN 5780, PCI 185");
    EXPECT_EQ(seen.cellRecord, 5u);
    EXPECT_EQ(seen.level->figure.text, "-109.50 dBm");
    EXPECT_DOUBLE_EQ(seen.level->figure.number, -109.5);
    EXPECT_EQ(seen.level->figure.unit, "dBm");
    EXPECT_EQ(seen.level->grade, "poor");
    EXPECT_EQ(seen.quality->grade, "excellent");
    EXPECT_EQ(seen.band, "17");

    const Observation later = observe(Technology::LTE, group({{kIdle, idle(5)}, {kConnected, connected(6)}}));
    EXPECT_EQ(later.state, "connected");
    EXPECT_TRUE(later.isDedicated);
    EXPECT_EQ(later.cell, "EARFCN 1300, PCI 84");
    EXPECT_EQ(later.level->grade, "good");
    EXPECT_EQ(later.quality->grade, "good");
}

TEST(LteObservation, ABroadcastTellsTheCellsPartsAndItsBand) {
    const Observation seen = observe(Technology::LTE, group({{"Serving Cell Info", shown({
                                                                                       {"Physical Cell ID", "256"},
                                                                                       {"Cell Identity", "27439618"},
                                                                                       {"Tracking Area Code", "1042"},
                                                                                       {"Download Frequency", "1300"},
                                                                                       {"Upload Frequency", "19300"},
                                                                                       {"Download Bandwidth", "20 MHz"},
                                                                                       {"Upload Bandwidth", "10 MHz"},
                                                                                   })}}));
    EXPECT_EQ(seen.cell, "EARFCN 1300, PCI 256");
    EXPECT_EQ(seen.state, "");
    EXPECT_EQ(seen.area, "TAC 1042");
    const std::vector<Fact> facts = {{"Cell identity", "27439618 (eNB 107186, sector 2)"},
                                     {"Band", "3 (1815.0 MHz down, 1720.0 MHz up)"},
                                     {"Bandwidth", "20 MHz down, 10 MHz up"}};
    EXPECT_EQ(seen.serving, facts);
}

TEST(LteObservation, WhatNoRecordHasWrittenIsNotThere) {
    const Value placeholders = Dictionary::make({{"E-ARFCN", Value("–")}, {"Physical Cell ID", Value("–")}});
    const Observation seen = observe(Technology::LTE, group({{kIdle, placeholders}}));
    EXPECT_EQ(seen.cell, "");
    EXPECT_EQ(seen.channel, "");
    EXPECT_EQ(seen.state, "");
    EXPECT_FALSE(seen.level);
    EXPECT_TRUE(seen.serving.empty());
}

TEST(LteObservation, CellsAroundBearTheChannelOfTheirList) {
    const Observation seen =
        observe(Technology::LTE,
                group({{kConnected, connected(7)},
                       {"Measured Neighbor Cells",
                        list({shown({{"Physical Cell ID", "366"}, {"Filtered RSRP", "-99.75 dBm"}}, 7),
                              shown({{"Physical Cell ID", "144"}, {"Filtered RSRP", "-100.75 dBm"}}, 7)})},
                       {"Detected Cells", list({shown({{"Physical Cell ID", "478"}}, 7)})},
                       {"Reselection Candidates List",
                        list({shown({{"Candidate RAT Type", "LTE"}, {"E ARFCN", "1300"}, {"Cell ID", "144"}}, 8),
                              shown({{"Candidate RAT Type", "GERAN"}, {"ARFCN", "37"}, {"BSIC ID", "44"}}, 8),
                              shown({{"Candidate RAT Type", "??"}}, 8)})}}));
    ASSERT_EQ(seen.cells.size(), 4u);
    EXPECT_EQ(seen.cells[0].identity, "EARFCN 1300, PCI 366");
    EXPECT_EQ(seen.cells[0].mark, "");
    EXPECT_EQ(seen.cells[0].record, 7u);
    EXPECT_DOUBLE_EQ(seen.cells[0].level->figure.number, -99.75);
    EXPECT_EQ(seen.cells[1].mark, "candidate");
    EXPECT_EQ(seen.cells[2].identity, "EARFCN 1300, PCI 478");
    EXPECT_EQ(seen.cells[2].mark, "detected");
    EXPECT_FALSE(seen.cells[2].level);
    EXPECT_EQ(seen.cells[3].identity, "ARFCN 37, BSIC 44");
}

TEST(LteObservation, OfSeveralCarriersTheBroadcastSaysWhichServes) {
    const Value broadcast = shown({{"Physical Cell ID", "185"}, {"Download Frequency", "5780"}}, 3);
    const Observation seen =
        observe(Technology::LTE, group({{kConnected, connected(9)}, {"Serving Cell Info", broadcast}}));
    EXPECT_EQ(seen.cell, "EARFCN 5780, PCI 185");
    EXPECT_EQ(seen.cellRecord, 3u);
    EXPECT_EQ(seen.band, "17");
    EXPECT_EQ(seen.state, "connected");
    EXPECT_FALSE(seen.level);
    ASSERT_EQ(seen.cells.size(), 1u);
    EXPECT_EQ(seen.cells[0].identity, "EARFCN 1300, PCI 84");
    EXPECT_EQ(seen.cells[0].mark, "active");
    EXPECT_EQ(seen.cells[0].level->figure.text, "-88.00 dBm");
    EXPECT_EQ(seen.cells[0].record, 9u);
    const Observation later = observe(Technology::LTE, group({{kIdle, idle(10)}, {"Serving Cell Info", broadcast}}));
    EXPECT_EQ(later.cell, "EARFCN 5780, PCI 185");
    EXPECT_EQ(later.level->figure.text, "-109.50 dBm");
}

}  // namespace
}  // namespace kelvo::overview
