#include <gtest/gtest.h>

#include "overview/Observation.h"
#include "tests/overview/Shown.h"

namespace kelvo::overview {
namespace {

Value gsmCell(std::uint64_t record) {
    return shown({{"Cell ID", "292"}, {"ARFCN", "21"}, {"BSIC", "44"}, {"RSSI", "45 dBm"}}, record);
}

Value gsmCells(std::uint64_t record) {
    return group({{"GSM Serving Cell", gsmCell(record)},
                  {"GSM RR Info", shown({{"RR State", "RR_DATA_TRANSFER"}}, record)},
                  {"Neighboring Cells", list({shown({{"ARFCN", "23"}, {"RSSI", "39"}, {"BSIC", "42"}}, record),
                                              shown({{"ARFCN", "700"}, {"RSSI", "-95 dBm"}}, record)})}});
}

Value umtsCells(std::uint64_t record) {
    return group(
        {{"Active Set",
          list({shown({{"Scrambling Code", "394"}, {"RSCP", "-99 dB"}, {"Energy Per Chip", "-10 dB"}}, record),
                shown({{"Scrambling Code", "17"}, {"RSCP", "-101 dB"}, {"Energy Per Chip", "-12 dB"}}, record)})}});
}

Value umtsRadio(std::uint64_t record = 8) {
    return group({{"UMTS RR Info", shown({{"RRC State", "CELL_DCH"},
                                          {"Cell ID", "6553791"},
                                          {"Downlink Frequency", "10562"},
                                          {"Transmit Power", "5.33 dBm"}},
                                         record)}});
}

TEST(GsmUmtsObservation, OnGsmTheLevelIsThatOfRxLev) {
    const Observation seen = observe(
        Technology::GSM,
        group({{"GSM Cell and Neighbours", gsmCells(9)}, {"UMTS Cells", umtsCells(8)}, {"UMTS Radio", umtsRadio()}}));
    EXPECT_EQ(seen.access, "GSM");
    EXPECT_EQ(seen.state, "RR_DATA_TRANSFER");
    EXPECT_TRUE(seen.isDedicated);
    EXPECT_EQ(seen.cell, "ARFCN 21, BSIC 44");
    EXPECT_EQ(seen.level->name, "RxLev");
    EXPECT_EQ(seen.level->figure.text, "-65 dBm");  // step 45: -66 to -65 dBm
    EXPECT_EQ(seen.level->grade, "excellent");
    const std::vector<Fact> facts = {
        {"Color codes", "NCC 5, BCC 4"}, {"Cell identity", "292"}, {"Band", "GSM 900 (939.2 MHz down, 894.2 MHz up)"}};
    EXPECT_EQ(seen.serving, facts);
    ASSERT_EQ(seen.cells.size(), 2u);
    EXPECT_EQ(seen.cells[0].identity, "ARFCN 23, BSIC 42");
    EXPECT_EQ(seen.cells[0].level->figure.text, "-71 dBm");
    EXPECT_EQ(seen.cells[1].identity, "ARFCN 700");
    EXPECT_EQ(seen.cells[1].level->figure.text, "-95 dBm");
}

TEST(GsmUmtsObservation, OnUmtsTheCellIsTheFirstOfTheActiveSet) {
    const Observation seen = observe(
        Technology::GSM,
        group({{"GSM Cell and Neighbours", gsmCells(7)}, {"UMTS Cells", umtsCells(8)}, {"UMTS Radio", umtsRadio()}}));
    EXPECT_EQ(seen.access, "UMTS");
    EXPECT_EQ(seen.state, "CELL_DCH");
    EXPECT_EQ(seen.cell, "UARFCN 10562, PSC 394");
    EXPECT_EQ(seen.cellRecord, 8u);
    EXPECT_EQ(seen.level->name, "RSCP");
    EXPECT_DOUBLE_EQ(seen.level->figure.number, -99);
    EXPECT_EQ(seen.level->grade, "");
    EXPECT_EQ(seen.quality->name, "Ec/Io");
    EXPECT_EQ(seen.quality->grade, "good");
    const std::vector<Fact> facts = {{"Cell identity", "6553791 (RNC 100, cell 191)"},
                                     {"Band", "I (2112.4 MHz down, 1922.4 MHz up)"},
                                     {"Transmit power", "5.33 dBm"}};
    EXPECT_EQ(seen.serving, facts);
    EXPECT_EQ(seen.cells[0].identity, "UARFCN 10562, PSC 17");
    EXPECT_EQ(seen.cells[0].mark, "active");
}

TEST(GsmUmtsObservation, InSoftHandoverTheCellIsTheOneThatItsScreenNames) {
    const auto withCode = [](const char* code, std::uint64_t record) {
        const Value radio = group({{"UMTS RR Info", shown({{"UARFCN", "10562"}, {"Scrambling Code", code}}, record)}});
        return observe(Technology::GSM, group({{"UMTS Cells", umtsCells(8)}, {"UMTS Radio", radio}}));
    };
    const Observation seen = withCode("17", 5);
    EXPECT_EQ(seen.cell, "UARFCN 10562, PSC 17");
    EXPECT_DOUBLE_EQ(seen.level->figure.number, -101);
    ASSERT_EQ(seen.cells.size(), 1u);
    EXPECT_EQ(seen.cells[0].identity, "UARFCN 10562, PSC 394");
    EXPECT_EQ(seen.cells[0].mark, "active");
    EXPECT_EQ(withCode("20", 7).cell, "UARFCN 10562, PSC 394") << "which the set has no more";
    EXPECT_EQ(withCode("20", 9).cell, "UARFCN 10562, PSC 20") << "which the set does not have yet";
}

TEST(GsmUmtsObservation, AStateOfAnEarlierVisitIsNone) {
    const auto seen = [](std::uint64_t umts, std::uint64_t state) {
        return observe(Technology::GSM, group({{"GSM Cell and Neighbours", gsmCells(7)},
                                               {"UMTS Cells", umtsCells(umts)},
                                               {"UMTS Radio", umtsRadio(state)}}));
    };
    EXPECT_EQ(seen(8, 6).state, "");
    EXPECT_FALSE(seen(8, 6).isDedicated);
    EXPECT_EQ(seen(8, 9).state, "CELL_DCH");
    EXPECT_EQ(seen(6, 9).state, "RR_DATA_TRANSFER");
}

TEST(GsmUmtsObservation, AnInactiveLayerHasNoState) {
    const Value cells =
        group({{"GSM Serving Cell", gsmCell(3)}, {"GSM RR Info", shown({{"RR State", "RR_INACTIVE"}}, 4)}});
    EXPECT_EQ(observe(Technology::GSM, group({{"GSM Cell and Neighbours", cells}})).state, "");
}

TEST(GsmUmtsObservation, RankedCellsBearTheirCarrier) {
    const Value ranked = shown(
        {{"Scrambling Code", "30"}, {"Downlink Frequency", "10562"}, {"RSCP", "-80 dB"}, {"Energy Per Chip", "-9 dB"}});
    const Observation seen = observe(Technology::GSM, group({{"UMTS Cells", group({{"UMTS Set", list({ranked})}})}}));
    ASSERT_EQ(seen.cells.size(), 1u);
    EXPECT_EQ(seen.cells[0].identity, "UARFCN 10562, PSC 30");
}

TEST(GsmUmtsObservation, RegistrationTellsServiceAndRejects) {
    const auto registered = [](const char* service, const char* attach) {
        return observe(
            Technology::GSM,
            group(
                {{"Registration and Network",
                  group({{"Serving PLMN", shown({{"Mobile Country Code", "310"},
                                                 {"Mobile Network Code", "01 "},
                                                 {"Location Area Code", "8450"},
                                                 {"Routing Area Code", "1"},
                                                 {"Service Type", service}})},
                         {"Process PS", shown({{"MM State", "GMM_REGISTERED"}, {"Attach Reject Cause", attach}})}})}}));
    };
    const Observation seen = registered("CS_PS_SERVICE", "GMM_GU1_UPDATED");
    EXPECT_FALSE(seen.isWithoutService);
    EXPECT_EQ(seen.area, "LAC 8450, RAC 1");
    EXPECT_EQ(seen.reject, "");
    EXPECT_EQ(seen.registrationState, "GMM_REGISTERED");
    EXPECT_EQ(seen.serving, (std::vector<Fact>{{"Network", "310-01"}}));
    EXPECT_TRUE(registered("LIMITED_SERVICE", "").isWithoutService);
    EXPECT_EQ(registered("NO_SERVICE", "GMM_GU3_PLMN_NOT_ALLOWED").reject, "GMM_GU3_PLMN_NOT_ALLOWED");
}

TEST(GsmUmtsObservation, ErrorRatesAndContexts) {
    const Observation seen = observe(
        Technology::GSM,
        group({{"Counters",
                group({{"BLER", group({{"Transport Channels", list({shown({{"Transport Channel ID", "24"},
                                                                           {"CRC Received", "50"},
                                                                           {"CRC Received in Error", "1"}}),
                                                                    shown({{"Transport Channel ID", "1"},
                                                                           {"CRC Received", "0"},
                                                                           {"CRC Received in Error", "0"}})})}})}})},
               {"SIM and Data Contexts",
                group({{"PDP Context Info", list({shown({{"Context ID", "5"},
                                                         {"APN", "internet"},
                                                         {"PDP Type", "IPv4"},
                                                         {"State", "Active"},
                                                         {"PDP Address", "10.20.30.40"}})})}})}}));
    EXPECT_EQ(seen.rates, (std::vector<Fact>{{"BLER, channel 24", "2.0 %"}}));
    ASSERT_TRUE(seen.rates[0].figure);
    EXPECT_DOUBLE_EQ(seen.rates[0].figure->number, 2);
    EXPECT_EQ(seen.rates[0].figure->unit, "%");
    ASSERT_EQ(seen.contexts.size(), 1u);
    EXPECT_EQ(seen.contexts[0].name, "internet (5)");
    EXPECT_EQ(seen.contexts[0].text, "Active, IPv4, 10.20.30.40");
    EXPECT_TRUE(seen.contexts[0].isUp);
}

}  // namespace
}  // namespace kelvo::overview
