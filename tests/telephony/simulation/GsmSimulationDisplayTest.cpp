// Ten minutes of the drive on the screens: what each record shows is held against the world that it tells of.
#include <gtest/gtest.h>

#include <cmath>
#include <map>

#include "telephony/simulation/GsmSimulation.h"
#include "tests/telephony/simulation/Played.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::gsm;
using namespace std::chrono_literals;
using kelvo::test::Played;

namespace {

using Labels = std::map<int, std::string>;

std::string label(const Labels& labels, int value) {
    const auto found = labels.find(value);
    return found == labels.end() ? "(no label stated)" : found->second;
}

template <class State>
std::string label(const Labels& labels, State state) {
    return label(labels, static_cast<int>(state));
}

// clang-format off
const Labels kMmStates{{0, "MM_NULL"}, {3, "MM_LOCATION_UPDATE_INITIATED"}, {6, "MM_CONNECTION_ACTIVE"},
                       {13, "MM_WAIT_FOR_RR_CONNECTION_LU"}, {14, "MM_WAIT_FOR_RR_CONNECTION_MM"}, {19, "MM_IDLE"}};
const Labels kMmSubStates{{2, "MM_PLMN_SEARCH"}, {5, "MM_LOCATION_UPDATE_NEEDED"}, {8, "MM_NORMAL_SERVICE"}};
const Labels kGmmStates{{1, "GMM_DEREGISTERED"}, {2, "GMM_REGISTERED_INITIATED"}, {3, "GMM_REGISTERED"},
                        {5, "GMM_ROUTING_AREA_UPDATE_INITIATED"}, {6, "GMM_SERVICE_REQUEST_INITIATED"}};
const Labels kGmmSubStates{{0, "GMM_NORMAL_SERVICE"}, {2, "GMM_ATTACH_NEEDED"}, {6, "GMM_PLMN_SEARCH"},
                           {7, "GMM_SUSPENDED"}, {8, "GMM_UPDATE_NEEDED"}};
const Labels kRegistrationStates{{1, "REG_STATE_IDLE"}, {2, "REG_STATE_REGISTERING"}, {5, "REG_STATE_AUTOMATIC_SEARCH"}};
const Labels kServiceTypes{{1, "CS_ONLY"}, {3, "CS_PS_SERVICE"}, {4, "LIMITED_SERVICE"}};
const Labels kRrStates{{0, "RR_INACTIVE"}, {3, "RR_CELL_SELECTION"}, {5, "RR_IDLE"}, {6, "RR_CELL_RESELECTION"},
                       {7, "RR_CONNECTION_PENDING"}, {9, "RR_DATA_TRANSFER"}, {11, "RR_CONNECTION_RELEASE"},
                       {13, "RR_W2G_INTERRAT_HANDOVER_ PROGRESS"}, {14, "RR_W2G_INTERRAT_RESELECTION_PROGRESS"},
                       {18, "RR_G2W_INTERRAT_RESELECTION_PROGRESS"}, {19, "RR_G2W_INTERRAT_HANDOVER_ PROGRESS"},
                       {21, "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS"}};
const Labels kRrcStates{{0, "Disconnected"}, {1, "Connecting"}, {2, "CELL_FACH"}, {3, "CELL_DCH"}, {5, "URA_PCH"}};
const Labels kPriorities{{3, "1 Only"}, {4, "1 to 2"}, {5, "1 to 3"}, {6, "1 to 4"}};
const Labels kT3192{{0, "500 ms"}, {1, "1000 ms"}, {2, "1500 ms"}};
// clang-format on

/// One message after another, each compared with the world at that moment.
class Comparison {
public:
    explicit Comparison(GsmSimulation& modem) : _modem(modem), _played(modem) {}

    void next() {
        const std::uint32_t code = _played.next();
        SCOPED_TRACE(testing::Message() << "record 0x" << std::hex << code << " at " << std::dec
                                        << seconds(_played.time()) << " s");
        compare(code);
    }
    Played& played() { return _played; }

private:
    void compare(std::uint32_t code);
    void compareMobility(std::uint32_t code);
    void compareGsm(std::uint32_t code);
    void compareGprs(std::uint32_t code);
    void compareUmts(std::uint32_t code);

    void servingNetwork();
    void equivalents();
    void gsmMeasurement();
    void gsmNeighbours();
    void rememberBsics();
    void mobileAllocation();
    void searcher();
    void ranking();
    void rankedUmts();
    void rankedGsm();
    void transmitPower();
    void blockErrors();
    void hsdpa();
    void processes(const std::string& path, const std::vector<HarqProcess>& expected);
    void sim();
    void cells();
    void umtsNeighboursOfArray();
    void gsmNeighboursOfArray();
    void contexts();

    void shows(const std::string& path, const std::string& expected) {
        EXPECT_EQ(_played.text(_group + path), expected) << path;
    }
    void shows(const std::string& path, int expected) { shows(path, std::to_string(expected)); }
    void within(const std::string& path, double truth, double halfStep) {
        EXPECT_NEAR(_played.number(_group + path), truth, halfStep + 1e-6) << path;
    }
    /// RXLEV r tells of -111 + r to -110 + r dBm; both ends are open.
    void levelWithin(const std::string& path, double dBm) {
        const double shown = _played.number(_group + path);
        EXPECT_TRUE(shown == 0 || dBm >= shown - 111) << path << " shows " << shown << " for " << dBm;
        EXPECT_TRUE(shown == 63 || dBm < shown - 110) << path << " shows " << shown << " for " << dBm;
    }

    const GsmCell& gsmCell() const { return _modem.network().gsm[_modem.phone().serving()]; }
    const UmtsCell& umtsCell() const { return _modem.network().umts[_modem.phone().serving()]; }

    GsmSimulation& _modem;
    Played _played;
    std::string _group;  // the screen that paths begin at
    std::map<int, int> _bsics;
};

void Comparison::compare(std::uint32_t code) {
    switch (code) {
        case 0xff0000: return sim();
        case 0xff0001: return cells();
        case 0xff0002: return contexts();
        default: break;
    }
    if (code >= 0x7000) return compareMobility(code);
    if (code >= 0x51f4 && code != 0x51f8 && code != 0x51ff) return compareGprs(code);
    if (code >= 0x5000) return compareGsm(code);
    compareUmts(code);
}

void Comparison::compareMobility(std::uint32_t code) {
    _group = "Registration and Network/";
    const Mobility& mobility = _modem.phone().registration().mobility();
    switch (code) {
        case 0x7130:
            shows("Process PS/MM State", label(kGmmStates, mobility.gmm));
            shows("Process PS/MM Sub State", label(kGmmSubStates, mobility.gmmSub));
            shows("Process PS/Attach Reject Cause",
                  mobility.isRoutingUpdated ? "GMM_GU1_UPDATED" : "GMM_GU2_NOT_UPDATED");
            break;
        case 0x7131:
            shows("Process CS/MM State", label(kMmStates, mobility.mm));
            shows("Process CO/MM State", label(kMmStates, mobility.mm));
            shows("Process CS/MM Sub State", label(kMmSubStates, mobility.mmSub));
            shows("Process CS/LU Reject Cause", mobility.isLocationUpdated ? "UPDATED" : "NOT_UPDATED");
            break;
        case 0x7132:
            for (const char* process : {"Process CS", "Process PS", "Process CO"}) {
                shows(std::string(process) + "/MM Service State", label(kRegistrationStates, mobility.registration));
            }
            shows("Serving PLMN/PLMN Sel Mod", "Automatic");
            break;
        case 0x7135: return servingNetwork();
        case 0x7150: return equivalents();
        default: ADD_FAILURE() << "not a record of this family";
    }
}

void Comparison::servingNetwork() {
    const Phone& phone = _modem.phone();
    shows("Serving PLMN/Mobile Country Code", "001");
    shows("Serving PLMN/Mobile Network Code", "01 ");
    shows("Serving PLMN/Location Area Code", phone.area().lac);
    shows("Serving PLMN/Routing Area Code", phone.area().rac);
    shows("Serving PLMN/Service Type", label(kServiceTypes, phone.registration().mobility().service));
    const bool isModeTwo = phone.rat() == Rat::GSM && gsmCell().gprs.networkOperationMode == 1;
    EXPECT_EQ(_played.text("GPRS/GPRS Information/Network Operating Mode"), isModeTwo ? "Class 2" : "Class 1");
}

/// The partner network 001 02 serves the districts of odd codes.
void Comparison::equivalents() {
    const auto& registered = _modem.phone().registration().registered();
    const bool hasPartner = registered && registered->lac % 2 == 1;
    ASSERT_EQ(_played.rows(_group + "Equivalent PLMN List"), hasPartner ? 1U : 0U);
    if (!hasPartner) return;
    shows("Equivalent PLMN List/0/Mobile Country Code", "1");
    shows("Equivalent PLMN List/0/Mobile Network Code", "2");
}

void Comparison::compareGsm(std::uint32_t code) {
    _group = "GSM Cell and Neighbours/";
    const Phone& phone = _modem.phone();
    switch (code) {
        case 0x5134:
            shows("GSM Serving Cell/Cell ID", gsmCell().cellId);
            shows("GSM Serving Cell/ARFCN", gsmCell().arfcn);
            shows("GSM Serving Cell/BSIC", gsmCell().bsic);
            break;
        case 0x5137: return gsmMeasurement();
        case 0x51ff: return rememberBsics();
        case 0x512c:
            shows("GSM RR Info/RR State", label(kRrStates, phone.rrState()));
            shows("GSM RR Info/RR Sub State", static_cast<int>(phone.link()));
            shows("GSM RR Info/RR Status", phone.isCamped() ? "1" : "0");
            shows("GSM RR Info/RR Mode", phone.use() == Use::Data ? "Data" : "Voice");
            break;
        case 0x5072: shows("GSM RR Info/DTX Used", _modem.drawn().isDtxUsed ? "ON" : "OFF"); break;
        case 0x5076: shows("GSM Serving Cell/MA Dedicated ARFCN", _modem.drawn().dedicatedArfcn); break;
        case 0x51f8: return mobileAllocation();
        default: ADD_FAILURE() << "not a record of this family";
    }
}

void Comparison::gsmMeasurement() {
    const std::size_t serving = _modem.phone().serving();
    const double level = _modem.air().gsmLevel(serving);
    const double c1 = level + 104;  // above the -104 dBm that the cells ask for
    levelWithin("GSM Serving Cell/RSSI", level);
    within("GSM Serving Cell/C1 Value", c1 < -0.5 ? c1 + 65536 : c1, 0.5);
    within("GSM Serving Cell/C2 Value", c1 + gsmCell().reselectOffset, 0.5);
    levelWithin("GSM RR Info/Serving Rx Level", level);
    within("GSM RR Info/Rx Quality Full", c1, 0.5);
    within("GSM RR Info/Rx Quality Sub", c1 + gsmCell().reselectOffset, 0.5);
    EXPECT_EQ(_played.text("GPRS/GPRS Information/Cell Reselect Hysteresis"),
              _modem.phone().isHysteresisApplied() ? "Applied" : "Not Applied");
    gsmNeighbours();
}

void Comparison::gsmNeighbours() {
    const auto neighbours = _modem.phone().gsmNeighbours();
    ASSERT_EQ(_played.rows(_group + "Neighboring Cells"), neighbours.size());
    for (std::size_t row = 0; row < neighbours.size(); ++row) {
        const std::string path = "Neighboring Cells/" + std::to_string(row);
        const GsmCell& cell = _modem.network().gsm[neighbours[row]];
        const double level = _modem.air().gsmLevel(neighbours[row]);
        shows(path + "/ARFCN", cell.arfcn);
        levelWithin(path + "/RSSI", level);
        within(path + "/C1 Value", level + 104, 0.5);
        const auto bsic = _bsics.find(cell.arfcn);
        shows(path + "/BSIC", bsic == _bsics.end() ? "(absent)" : std::to_string(bsic->second));
    }
}

void Comparison::rememberBsics() {
    _bsics.clear();
    for (const std::size_t sector : _modem.phone().gsmNeighbours()) {
        const GsmCell& cell = _modem.network().gsm[sector];
        _bsics[cell.arfcn] = cell.bsic;
    }
}

void Comparison::mobileAllocation() {
    shows("Mobile Allocation/HSN", gsmCell().hoppingSequence);
    const auto& carriers = gsmCell().mobileAllocation;
    ASSERT_EQ(_played.rows(_group + "Mobile Allocation/ARFCNs"), carriers.size());
    for (std::size_t i = 0; i < carriers.size(); ++i) {
        shows("Mobile Allocation/ARFCNs/" + std::to_string(i), carriers[i]);
    }
}

void Comparison::compareGprs(std::uint32_t code) {
    _group = "GPRS/GPRS Information/";
    const GprsOptions& options = gsmCell().gprs;
    switch (code) {
        case 0x51f4:
            shows("SI13 Position", options.isSi13OnExtendedBcch ? "Located on Extended BCCH" : "Located on BCCH");
            break;
        case 0x51f5:
            shows("PFC Supported", options.hasPacketFlowContexts ? "Supported" : "Not Supported");
            shows("Priority Access Threshold", label(kPriorities, options.priorityAccessThreshold));
            shows("Network Control Order", options.networkControlOrder == 0 ? "NC0" : "NC1");
            break;
        case 0x51f6:
            shows("T3192", label(kT3192, options.t3192));
            shows("DRX Timer Max", options.drxTimerMax);
            shows("Access Burst Type", options.longAccessBursts ? "11-bit format" : "8-bit format");
            EXPECT_EQ(_played.text("GSM Cell and Neighbours/GSM RR Info/DRX Used"),
                      std::to_string(options.drxTimerMax) + " sec");
            break;
        case 0x51fb: shows("PBCCH Present", options.hasPbcch ? "1" : "0"); break;
        case 0x51fd:
            shows("Packet PSI Status", options.hasPbcch ? "1" : "0");
            shows("Count LR", options.psiCountLow);
            shows("Count HR", options.psiCountHigh);
            shows("Ext Measurement Order", options.hasExtendedMeasurementOrder ? "1" : "0");
            shows("Packet SI Status", options.hasPacketSystemInformation ? "Supported" : "Not Supported");
            break;
        default: ADD_FAILURE() << "not a record of this family";
    }
}

void Comparison::compareUmts(std::uint32_t code) {
    _group = "UMTS Radio/UMTS RR Info/";
    const Link link = _modem.phone().link();
    switch (code) {
        case 0x417a: return searcher();
        case 0x4005: return ranking();
        case 0x4125: shows("RRC State", label(kRrcStates, _modem.phone().rrcState())); break;
        case 0x4127:
            shows("Cell ID", umtsCell().cellId);
            shows("Uplink Frequency", "9612");
            shows("Downlink Frequency", "10562");
            shows("URA ID", umtsCell().uraId);
            break;
        case 0x4157: shows("Ciphering", link == Link::None || link == Link::Opening ? "Disabled" : "Enabled"); break;
        case 0x4031: return transmitPower();
        case 0x4116: return blockErrors();
        case 0x4221: return hsdpa();
        default: ADD_FAILURE() << "not a record of this family";
    }
}

/// The searcher's table has steps of 1 dB, rounded down, which lie up to a quarter dB off below -15 dB; the received
/// power under the RSCP is rounded down to 1 dB, too.
void Comparison::searcher() {
    _group = "UMTS Cells/";
    const Phone& phone = _modem.phone();
    const auto members = phone.link() == Link::Open ? phone.activeSet().members() : std::vector{phone.serving()};
    ASSERT_EQ(_played.rows(_group + "Active Set"), members.size());
    for (std::size_t row = 0; row < members.size(); ++row) {
        const std::string path = "Active Set/" + std::to_string(row);
        shows(path + "/Scrambling Code", _modem.network().umts[members[row]].scramblingCode);
        within(path + "/Energy Per Chip", _modem.air().ecNo(members[row]) - 0.55, 0.7);
        within(path + "/RSCP", _modem.air().rscp(members[row]) - 1.05, 1.25);
    }
    for (const char* set : {"Monitored Set", "Detected Set", "Virtual Active Set"}) {
        EXPECT_EQ(_played.rows(_group + set), 0U) << set;
    }
}

/// A ranking tells of one system only; the other's list is empty.
void Comparison::ranking() {
    _group = "UMTS Cells/";
    const std::size_t umts = _played.rows("UMTS Cells/UMTS Set");
    const std::size_t gsm = _played.rows("GSM Cell and Neighbours/GSM Set");
    ASSERT_NE(umts == 0, gsm == 0);
    if (umts > 0) {
        rankedUmts();
    } else {
        rankedGsm();
    }
}

void Comparison::rankedUmts() {
    const auto& ranked = _modem.phone().rankedUmts();
    ASSERT_EQ(_played.rows(_group + "UMTS Set"), ranked.size());
    for (std::size_t row = 0; row < ranked.size(); ++row) {
        const std::string path = "UMTS Set/" + std::to_string(row);
        const std::size_t sector = ranked[row].sector;
        shows(path + "/Scrambling Code", _modem.network().umts[sector].scramblingCode);
        shows(path + "/Downlink Frequency", "10562");
        within(path + "/RSCP", _modem.air().rscp(sector), 0.5);
        within(path + "/Rank Cell RSCP", _modem.air().rscp(sector), 0.5);
        within(path + "/Energy Per Chip", _modem.air().ecNo(sector), 0.25);
        within(path + "/Ranking Value", ranked[row].rank, 0.5);
    }
}

void Comparison::rankedGsm() {
    _group = "GSM Cell and Neighbours/";
    const auto& ranked = _modem.phone().rankedGsm();
    ASSERT_EQ(_played.rows(_group + "GSM Set"), ranked.size());
    for (std::size_t row = 0; row < ranked.size(); ++row) {
        const std::string path = "GSM Set/" + std::to_string(row);
        const std::size_t sector = ranked[row].sector;
        shows(path + "/ARFCN", _modem.network().gsm[sector].arfcn);
        shows(path + "/BSIC", _modem.network().gsm[sector].bsic);
        within(path + "/RSSI", _modem.air().gsmLevel(sector), 0.5);
        within(path + "/Ranking Value", ranked[row].rank, 0.5);
    }
}

/// Each slot is rounded down to 1 dB; -18.8 dBm is told as -18.7.
void Comparison::transmitPower() {
    double sum = 0;
    int count = 0;
    for (const auto& slot : _modem.drawn().transmitPower) {
        if (!slot) continue;
        sum += *slot;
        ++count;
    }
    if (count == 0) {
        EXPECT_NE(_played.text(_group + "Transmit Power").find("nan"), std::string::npos);
    } else {
        within("Transmit Power", sum / count - 0.5, 0.6);
    }
}

void Comparison::blockErrors() {
    _group = "Counters/BLER/";
    const BlockErrors& errors = _modem.drawn().blockErrors;
    shows("Window Size", errors.windowSize);
    ASSERT_EQ(_played.rows(_group + "Transport Channels"), errors.channels.size());
    for (std::size_t row = 0; row < errors.channels.size(); ++row) {
        const std::string path = "Transport Channels/" + std::to_string(row);
        shows(path + "/Transport Channel ID", errors.channels[row].id);
        shows(path + "/CRC Received", errors.channels[row].received);
        shows(path + "/CRC Received in Error", errors.channels[row].inError);
    }
}

void Comparison::hsdpa() {
    _group = "UMTS Radio/HSDPA Info/";
    const HsdpaReport& report = _modem.drawn().hsdpa;
    shows("Sub Frames", report.subFrames);
    shows("Carrier Info", umtsCell().hasTwoCarriers ? "Dual Carrier" : "Single Carrier");
    processes("Primary HARQ Process", report.primary);
    if (report.hasTwoCarriers) processes("Secondary HARQ Process", report.secondary);
}

void Comparison::processes(const std::string& path, const std::vector<HarqProcess>& expected) {
    ASSERT_EQ(_played.rows(_group + path), expected.size());
    for (std::size_t i = 0; i < expected.size(); ++i) {
        const std::string row = path + "/" + std::to_string(i);
        shows(row + "/Process ID", expected[i].id);
        shows(row + "/No Rx Bits", std::to_string(expected[i].bits));
        shows(row + "/New Tx", expected[i].newTransmissions);
        shows(row + "/Block Errors", expected[i].blockErrors);
    }
}

void Comparison::sim() {
    const auto& registered = _modem.phone().registration().registered();
    char loci[32];
    char psloci[40];
    std::snprintf(loci, sizeof loci, "3A9C41D700F110%04XFF00", registered ? registered->lac : 0xfffe);
    std::snprintf(psloci, sizeof psloci, "C41B7E02A95D1300F110%04X%02X00", registered ? registered->lac : 0xfffe,
                  registered ? registered->rac : 0xff);
    const Value* files = _played.at("SIM and Data Contexts/SIM Info");
    ASSERT_TRUE(files != nullptr && files->dictionary());
    EXPECT_EQ((*files->dictionary())["EF-LOCI"], Value(std::string(loci)));
    EXPECT_EQ((*files->dictionary())["EF-GPRS/PS-LOCI"], Value(std::string(psloci)));
    EXPECT_EQ((*files->dictionary())["EF-ICCID"], Value("8900101000000123456"));
    EXPECT_EQ(files->dictionary()->size(), 14U);
    for (const auto& [name, text] : *files->dictionary()) {
        EXPECT_TRUE(text.string() != nullptr && *text.string() != "–") << name;
    }
}

void Comparison::cells() {
    _group = "Registration and Network/Serving PLMN/";
    shows("Mobile Country Code", "1");
    shows("Mobile Network Code", "1");
    shows("Location Area Code", _modem.phone().area().lac);
    _group = "";
    if (_modem.phone().rat() == Rat::GSM) {
        shows("GSM Cell and Neighbours/GSM Serving Cell/Cell ID", gsmCell().cellId);
        shows("GSM Cell and Neighbours/GSM Serving Cell/ARFCN", gsmCell().arfcn);
    } else {
        shows("UMTS Radio/UMTS RR Info/Cell ID", umtsCell().cellId);
        shows("UMTS Radio/UMTS RR Info/UARFCN", "10562");
        shows("UMTS Radio/UMTS RR Info/Scrambling Code", umtsCell().scramblingCode);
    }
    umtsNeighboursOfArray();
    gsmNeighboursOfArray();
}

void Comparison::umtsNeighboursOfArray() {
    for (std::size_t row = 0; row < _played.rows("UMTS Cells/UMTS Set"); ++row) {
        _group = "UMTS Cells/UMTS Set/" + std::to_string(row) + "/";
        const auto& cells = _modem.network().umts;
        const auto cell = std::ranges::find(cells, _played.number(_group + "Scrambling Code"),
                                            [](const UmtsCell& each) { return double(each.scramblingCode); });
        ASSERT_NE(cell, cells.end());
        const auto sector = static_cast<std::size_t>(cell - cells.begin());
        EXPECT_FALSE(_modem.phone().rat() == Rat::UMTS && sector == _modem.phone().serving());
        shows("UARFCN", "10562");
        if (_modem.air().isFound(sector)) {
            within("RSCP", _modem.air().rscp(sector), 0.5);
            within("Energy Per Chip", _modem.air().ecNo(sector), 0.5);
        } else {
            shows("RSCP", "");
            shows("Energy Per Chip", "");
        }
    }
}

void Comparison::gsmNeighboursOfArray() {
    const auto neighbours = _modem.phone().gsmNeighbours();
    ASSERT_EQ(_played.rows("GSM Cell and Neighbours/Neighboring Cells"), std::min<std::size_t>(neighbours.size(), 2));
    for (std::size_t row = 0; row < std::min<std::size_t>(neighbours.size(), 2); ++row) {
        _group = "GSM Cell and Neighbours/Neighboring Cells/" + std::to_string(row) + "/";
        shows("ARFCN", _modem.network().gsm[neighbours[row]].arfcn);
        within("RSSI", _modem.air().gsmLevel(neighbours[row]), 1);  // told in steps of 2 dB
    }
}

void Comparison::contexts() {
    _group = "SIM and Data Contexts/PDP Context Info";
    const Phone& phone = _modem.phone();
    if (!phone.registration().registered()) {
        EXPECT_EQ(_played.rows(_group), 0U);
        return;
    }
    const bool isData = phone.use() == Use::Data;
    ASSERT_EQ(_played.rows(_group), isData && _modem.dataSessions() % 2 == 0 ? 2U : 1U);
    shows("/0/APN", "internet");
    shows("/0/Context ID", "5");
    shows("/0/State", isData ? "Active" : "Inactive");
}

}  // namespace

TEST(GsmSimulationDisplay, ShowsForTenMinutesWhatTheWorldIs) {
    GsmSimulation modem(1);
    Comparison comparison(modem);
    comparison.next();
    comparison.played().clearLog();  // the display's own first lines
    while (comparison.played().time() < 10min && !testing::Test::HasFailure()) comparison.next();
    for (const auto& [level, line] : comparison.played().log()) EXPECT_NE(level, 3) << line;
}

TEST(GsmSimulationDisplay, ShowsTheWorldOfOtherSeeds) {
    for (std::uint64_t seed = 2; seed < 8; ++seed) {
        SCOPED_TRACE(seed);
        GsmSimulation modem(seed);
        Comparison comparison(modem);
        while (comparison.played().time() < 1min && !testing::Test::HasFailure()) comparison.next();
    }
}
