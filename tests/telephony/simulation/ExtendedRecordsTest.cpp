#include "telephony/simulation/ExtendedRecords.h"

#include <gtest/gtest.h>

#include "platform/encodings/PropertyList.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace std::chrono_literals;

namespace {

/// What the record carries, read back; none unless it is an extended record of this 16-bit code and states its length.
Value payloadOf(const Bytes& record, std::uint8_t code) {
    const bool isExtended = record.size() > 15 && record[0] == 0x81 && record[2] == 255;
    if (!isExtended || record[5] != code || record[6] != 0) return {};
    if (record[3] + 256U * record[4] != record.size() - 3) return {};
    return readPropertyList(ByteView(record).subspan(15)).value();
}

}  // namespace

TEST(SimFilesRecord, HoldsTheFilesUnderTheirNamesAndNoEmptyOne) {
    const Value payload = payloadOf(simFilesRecord(1s, {.iccid = "8900101", .oplmnAct = "00F110C080"}), 0);
    const Value expected = Dictionary::make({{"kSimFile_ICCID", "8900101"}, {"kSimFile_OPLMNAcT", "00F110C080"}});
    EXPECT_EQ(payload, expected);
}

TEST(SimFilesRecord, HoldsAllFourteenFilesOfTheTestNetwork) {
    const Value payload = payloadOf(simFilesRecord(1s, testNetworkSim(0x1234, 0x0A)), 0);
    const auto& files = payload.dictionary();
    ASSERT_TRUE(files);
    for (const char* name : {"ICCID", "MSISDN", "MBDN", "HPPLMN", "LOCI", "PSLOCI", "ACC", "AD", "FPLMN", "AHPLMN",
                             "RATMODE", "PNN", "OPL", "OPLMNAcT"}) {
        EXPECT_NE(files->find(std::string("kSimFile_") + name), nullptr) << name;
    }
    EXPECT_EQ(files->size(), 14U);
    EXPECT_EQ((*files)["kSimFile_LOCI"], Value("3A9C41D700F1101234FF00"));
    EXPECT_EQ((*files)["kSimFile_PSLOCI"], Value("C41B7E02A95D1300F11012340A00"));
}

TEST(SimFilesRecord, SaysNotUpdatedAndNoAreaOfASimThatIsRegisteredNowhere) {
    const Value payload = payloadOf(simFilesRecord(1s, testNetworkSim()), 0);
    const auto& files = payload.dictionary();
    ASSERT_TRUE(files);
    EXPECT_EQ((*files)["kSimFile_LOCI"], Value("3A9C41D700F110FFFEFF01"));
    EXPECT_EQ((*files)["kSimFile_PSLOCI"], Value("C41B7E02A95D1300F110FFFEFF01"));
}

TEST(CellInformationRecord, GivesEachCellOnlyTheKeysItHas) {
    using enum MonitoredCell::Technology;
    const MonitoredCell cells[] = {
        {.technology = LTE, .isServing = true, .tac = 7, .cellId = 0x1234501, .pid = 301, .uarfcn = 1300},
        {.technology = GSM, .arfcn = 62, .rssi = -50},
        {.technology = UTRAN2, .lac = 9, .scn = 100, .bandInfo = 1, .rscp = MonitoredCell::kNoValue, .ecn0 = -7},
    };
    const Value payload = payloadOf(cellInformationRecord(1s, cells), 1);
    const Value expected = Array::make({
        Dictionary::make({
            {"kPLCellMonitorCellRadioAccessTechnology", "kPLCellMonitorRadioAccessTechnologyLTE"},
            {"kPLCellMonitorCellType", "kPLCellMonitorCellTypeServing"},
            {"kPLCellMonitorTAC", 7},
            {"kPLCellMonitorCellId", 0x1234501},
            {"kPLCellMonitorPID", 301},
            {"kPLCellMonitorUARFCN", 1300},
        }),
        Dictionary::make({
            {"kPLCellMonitorCellRadioAccessTechnology", "kPLCellMonitorRadioAccessTechnologyGSM"},
            {"kPLCellMonitorCellType", "kPLCellMonitorCellTypeNeighbor"},
            {"kPLCellMonitorARFCN", 62},
            {"kPLCellMonitorRSSI", -50},
        }),
        Dictionary::make({
            {"kPLCellMonitorCellRadioAccessTechnology", "kPLCellMonitorRadioAccessTechnologyUTRAN2"},
            {"kPLCellMonitorCellType", "kPLCellMonitorCellTypeNeighbor"},
            {"kPLCellMonitorLAC", 9},
            {"kPLCellMonitorSCN", 100},
            {"kPLCellMonitorBandInfo", 1},
            {"kPLCellMonitorRSCP", 32767},
            {"kPLCellMonitorECN0", -7},
        }),
    });
    EXPECT_EQ(payload, expected);
}

TEST(CellInformationRecord, NamesNetworkAreaAndUmtsCells) {
    const MonitoredCell cells[] = {
        {.technology = MonitoredCell::Technology::UMTS, .isServing = true, .mcc = 1, .mnc = 1, .lac = 4096}};
    const Value payload = payloadOf(cellInformationRecord(1s, cells), 1);
    const Value expected = Array::make({Dictionary::make({
        {"kPLCellMonitorCellRadioAccessTechnology", "kPLCellMonitorRadioAccessTechnologyUMTS"},
        {"kPLCellMonitorCellType", "kPLCellMonitorCellTypeServing"},
        {"kPLCellMonitorMCC", 1},
        {"kPLCellMonitorMNC", 1},
        {"kPLCellMonitorLAC", 4096},
    })});
    EXPECT_EQ(payload, expected);
}

TEST(PdpContextsRecord, WordsEveryValueAsTextForTheScreen) {
    const PdpContext contexts[] = {{.apn = "internet", .type = "IPv4", .state = "Active", .address = "10.1.2.3"},
                                   {.id = 6, .apn = "mms"}};
    const Value payload = payloadOf(pdpContextsRecord(1s, contexts), 2);
    const Value expected = Array::make({
        Dictionary::make({{"Context ID", "5"},
                          {"APN", "internet"},
                          {"PDP Type", "IPv4"},
                          {"State", "Active"},
                          {"PDP Address", "10.1.2.3"}}),
        Dictionary::make({{"Context ID", "6"}, {"APN", "mms"}}),
    });
    EXPECT_EQ(payload, expected);
}

TEST(PdpContextsRecord, HoldsAnEmptyArrayWhenThereAreNone) {
    EXPECT_EQ(payloadOf(pdpContextsRecord(1s, {}), 2), Value(Array::make()));
}
