#include "telephony/modemmanager/CellReader.h"

#include <gtest/gtest.h>

#include <cmath>

namespace kelvo::modemmanager {
namespace {

using phone::MonitoredCell;
using Cell = MonitoredCell::Technology;

TEST(CellReader, ReadsAGsmCell) {
    const auto cell = cellOf({{"cell-type", 2U},
                              {"serving", true},
                              {"operator-id", "00101"},
                              {"lac", "84CD"},
                              {"ci", "D30156"},
                              {"arfcn", 62U},
                              {"base-station-id", "3F"},
                              {"rx-level", 30U}});
    // 30 above -110 dBm, in steps of 2 dB
    EXPECT_EQ(cell, (MonitoredCell{.technology = Cell::GSM,
                                   .isServing = true,
                                   .mcc = 1,
                                   .mnc = 1,
                                   .lac = 0x84CD,
                                   .cellId = 0xD30156,
                                   .arfcn = 62,
                                   .rssi = -40}));
}

TEST(CellReader, ReadsAUmtsCell) {
    const auto cell = cellOf({{"cell-type", 3U},
                              {"serving", false},
                              {"operator-id", "310410"},
                              {"lac", "1"},
                              {"ci", "ABCDEF1"},
                              {"uarfcn", 10687U},
                              {"psc", 511U},
                              {"rscp", -95.5},
                              {"ecio", -7.6}});
    EXPECT_EQ(cell, (MonitoredCell{.technology = Cell::UMTS,
                                   .mcc = 310,
                                   .mnc = 410,
                                   .lac = 1,
                                   .cellId = 0xABCDEF1,
                                   .uarfcn = 10687,
                                   .scn = 511,
                                   .rscp = -95,
                                   .ecn0 = -8}));
}

TEST(CellReader, ReadsATdScdmaCell) {
    const auto cell = cellOf({{"cell-type", 4U},
                              {"serving", true},
                              {"lac", "9"},
                              {"uarfcn", 10088U},
                              {"cell-parameter-id", 100U},
                              {"rscp", -80.0}});
    EXPECT_EQ(cell,
              (MonitoredCell{
                  .technology = Cell::UTRAN2, .isServing = true, .lac = 9, .uarfcn = 10088, .scn = 100, .rscp = -80}));
}

TEST(CellReader, ReadsAnLteCellAndItsLevels) {
    const QVariantMap told{{"cell-type", 5U},  {"serving", true}, {"operator-id", "00101"},
                           {"tac", "6FFE"},    {"ci", "1CEAD8F"}, {"physical-ci", "12D"},
                           {"earfcn", 66586U}, {"rsrp", -101.25}, {"rsrq", -9.5}};
    EXPECT_EQ(cellOf(told), (MonitoredCell{.technology = Cell::LTE,
                                           .isServing = true,
                                           .mcc = 1,
                                           .mnc = 1,
                                           .tac = 0x6FFE,
                                           .cellId = 0x1CEAD8F,
                                           .pid = 301,
                                           .uarfcn = 66586}));
    EXPECT_EQ(levelsOfCell(told), (phone::LteLevels{.rsrp = -101.25, .rsrq = -9.5}));
}

TEST(CellReader, HasNoPlaceForCdmaAnd5GCells) {
    for (const uint type : {0U, 1U, 6U, 7U}) EXPECT_FALSE(cellOf({{"cell-type", type}, {"serving", true}}));
    EXPECT_FALSE(cellOf({}));
    EXPECT_FALSE(cellOf({{"cell-type", "2"}}));
}

TEST(CellReader, LeavesOutWhatIsNotToldAndMarksLevelsThatAreNot) {
    EXPECT_EQ(cellOf({{"cell-type", 2U}}), (MonitoredCell{.technology = Cell::GSM, .rssi = 32767}));
    EXPECT_EQ(cellOf({{"cell-type", 3U}}), (MonitoredCell{.technology = Cell::UMTS, .rscp = 32767, .ecn0 = 32767}));
    EXPECT_EQ(cellOf({{"cell-type", 5U}}), (MonitoredCell{.technology = Cell::LTE}));
}

TEST(CellReader, LeavesOutWhatIsNoNumberOfItsKind) {
    const auto gsm = cellOf({{"cell-type", 2U},
                             {"operator-id", "0010"},
                             {"lac", "84CG"},
                             {"ci", "1FFFFFFFF"},
                             {"arfcn", "62"},
                             {"rx-level", 64U}});
    EXPECT_EQ(gsm, (MonitoredCell{.technology = Cell::GSM, .rssi = 32767}));
    const auto umts = cellOf({{"cell-type", 3U}, {"operator-id", "abcde"}, {"rscp", std::nan("")}, {"ecio", -1e308}});
    EXPECT_EQ(umts, (MonitoredCell{.technology = Cell::UMTS, .rscp = 32767, .ecn0 = 32767}));
}

TEST(CellReader, PutsSignalValuesIntoTheCellThatServes) {
    MonitoredCell gsm{.technology = Cell::GSM, .isServing = true, .rssi = 32767};
    setLevels(gsm, {{"rssi", -83.0}});
    EXPECT_EQ(gsm.rssi, -41);  // -41.5, ties up
    MonitoredCell umts{.technology = Cell::UMTS, .isServing = true, .rscp = -90, .ecn0 = 32767};
    setLevels(umts, {{"ecio", -6.0}, {"rssi", -70.0}});
    EXPECT_EQ(umts.rscp, -90);  // not told: the cell's own stays
    EXPECT_EQ(umts.ecn0, -6);
    setLevels(umts, {{"rscp", -91.4}});
    EXPECT_EQ(umts.rscp, -91);
}

TEST(CellReader, PrefersSignalValuesToThoseOfTheLteCell) {
    const phone::LteLevels ofCell{.rsrp = -100, .rsrq = -10};
    EXPECT_EQ(levelsOf({}, ofCell), ofCell);
    EXPECT_EQ(levelsOf({{"rsrp", -98.0}, {"rssi", -66.0}}, ofCell),
              (phone::LteLevels{.rsrp = -98, .rsrq = -10, .rssi = -66}));
}

TEST(CellReader, MakesACellOfTheRegistration) {
    EXPECT_EQ(registeredCell(Cell::LTE, "", "001,01,0000,000ABCDE,001234"),
              (MonitoredCell{
                  .technology = Cell::LTE, .isServing = true, .mcc = 1, .mnc = 1, .tac = 0x1234, .cellId = 0xABCDE}));
    EXPECT_EQ(registeredCell(Cell::GSM, "310410", "310,260,8BE3,2BAF"), (MonitoredCell{.technology = Cell::GSM,
                                                                                       .isServing = true,
                                                                                       .mcc = 310,
                                                                                       .mnc = 260,
                                                                                       .lac = 0x8BE3,
                                                                                       .cellId = 0x2BAF,
                                                                                       .rssi = 32767}));
    EXPECT_EQ(registeredCell(Cell::UMTS, "310410", ""),
              (MonitoredCell{
                  .technology = Cell::UMTS, .isServing = true, .mcc = 310, .mnc = 410, .rscp = 32767, .ecn0 = 32767}));
    EXPECT_EQ(registeredCell(Cell::LTE, "", "nonsense"), (MonitoredCell{.technology = Cell::LTE, .isServing = true}));
}

TEST(AccessTechnology, LeadsToTheFamilyOfTheLatestGeneration) {
    const auto family = [](std::uint32_t bits) { return AccessTechnology{bits}.family(); };
    EXPECT_EQ(family(0), std::nullopt);
    EXPECT_EQ(family(1), std::nullopt);  // a landline
    for (int bit = 1; bit <= 9; ++bit) EXPECT_EQ(family(1U << bit), Technology::GSM) << bit;
    for (int bit = 10; bit <= 13; ++bit) EXPECT_EQ(family(1U << bit), Technology::CDMA) << bit;
    for (int bit : {14, 16, 17}) EXPECT_EQ(family(1U << bit), Technology::LTE) << bit;
    EXPECT_EQ(family(1U << 15), std::nullopt);                // 5G alone
    EXPECT_EQ(family(1U << 14 | 1U << 15), Technology::LTE);  // 5G beside LTE
    EXPECT_EQ(family(1U << 5 | 1U << 14), Technology::LTE);
}

TEST(AccessTechnology, IsNamedForPeople) {
    EXPECT_EQ(AccessTechnology{0}.words(), "");
    EXPECT_EQ(AccessTechnology{1U << 1 | 1U << 4}.words(), "GSM, EDGE");
    EXPECT_EQ(AccessTechnology{1U << 14 | 1U << 15}.words(), "LTE, 5G");
}

TEST(AccessTechnology, TellsTheKindOfItsServingCell) {
    EXPECT_EQ(AccessTechnology{1U << 4}.cell(), Cell::GSM);
    EXPECT_EQ(AccessTechnology{1U << 9 | 1U << 4}.cell(), Cell::UMTS);
    EXPECT_EQ(AccessTechnology{1U << 14}.cell(), Cell::LTE);
    EXPECT_EQ(AccessTechnology{1U << 10}.cell(), std::nullopt);
    EXPECT_EQ(AccessTechnology{1U << 15}.cell(), std::nullopt);
}

}  // namespace
}  // namespace kelvo::modemmanager
