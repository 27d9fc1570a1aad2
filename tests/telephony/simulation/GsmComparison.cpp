#include "tests/telephony/simulation/GsmComparison.h"

#include "tests/telephony/simulation/TestSim.h"

namespace kelvo::test {
namespace {

// clang-format off
const GsmComparison::Labels kMmStates{{0, "MM_NULL"}, {3, "MM_LOCATION_UPDATE_INITIATED"}, {6, "MM_CONNECTION_ACTIVE"},
                       {13, "MM_WAIT_FOR_RR_CONNECTION_LU"}, {14, "MM_WAIT_FOR_RR_CONNECTION_MM"}, {19, "MM_IDLE"}};
const GsmComparison::Labels kMmSubStates{{2, "MM_PLMN_SEARCH"}, {5, "MM_LOCATION_UPDATE_NEEDED"}, {8, "MM_NORMAL_SERVICE"}};
const GsmComparison::Labels kGmmStates{{1, "GMM_DEREGISTERED"}, {2, "GMM_REGISTERED_INITIATED"}, {3, "GMM_REGISTERED"},
                        {5, "GMM_ROUTING_AREA_UPDATE_INITIATED"}, {6, "GMM_SERVICE_REQUEST_INITIATED"}};
const GsmComparison::Labels kGmmSubStates{{0, "GMM_NORMAL_SERVICE"}, {2, "GMM_ATTACH_NEEDED"}, {6, "GMM_PLMN_SEARCH"},
                           {7, "GMM_SUSPENDED"}, {8, "GMM_UPDATE_NEEDED"}};
const GsmComparison::Labels kRegistrationStates{{1, "REG_STATE_IDLE"}, {2, "REG_STATE_REGISTERING"}, {5, "REG_STATE_AUTOMATIC_SEARCH"}};
const GsmComparison::Labels kServiceTypes{{1, "CS_ONLY"}, {3, "CS_PS_SERVICE"}, {4, "LIMITED_SERVICE"}};
// clang-format on

}  // namespace

void GsmComparison::compare(std::uint32_t code) {
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

void GsmComparison::compareMobility(std::uint32_t code) {
    _group = "Registration and Network/";
    const Mobility& mobility = _modem.modem().registration().mobility();
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

void GsmComparison::servingNetwork() {
    const Modem& phone = _modem.modem();
    shows("Serving PLMN/Mobile Country Code", "001");
    shows("Serving PLMN/Mobile Network Code", "01 ");
    shows("Serving PLMN/Location Area Code", phone.area().lac);
    shows("Serving PLMN/Routing Area Code", phone.area().rac);
    shows("Serving PLMN/Service Type", label(kServiceTypes, phone.registration().mobility().service));
    const bool isModeTwo = phone.rat() == Rat::GSM && gsmCell().gprs.networkOperationMode == 1;
    EXPECT_EQ(_played.text("GPRS/GPRS Information/Network Operating Mode"), isModeTwo ? "Class 2" : "Class 1");
}

/// The partner network 001 02 serves the districts of odd codes.
void GsmComparison::equivalents() {
    const auto& registered = _modem.modem().registration().registered();
    const bool hasPartner = registered && registered->lac % 2 == 1;
    ASSERT_EQ(_played.rows(_group + "Equivalent PLMN List"), hasPartner ? 1U : 0U);
    if (!hasPartner) return;
    shows("Equivalent PLMN List/0/Mobile Country Code", "1");
    shows("Equivalent PLMN List/0/Mobile Network Code", "2");
}

void GsmComparison::sim() {
    std::optional<RegisteredArea> area;
    if (const auto& registered = _modem.modem().registration().registered()) area = {registered->lac, registered->rac};
    expectTestSim(_played, "SIM and Data Contexts/SIM Info", area);
}

void GsmComparison::cells() {
    _group = "Registration and Network/Serving PLMN/";
    shows("Mobile Country Code", "1");
    shows("Mobile Network Code", "1");
    shows("Location Area Code", _modem.modem().area().lac);
    _group = "";
    if (_modem.modem().rat() == Rat::GSM) {
        shows("GSM Cell and Neighbours/GSM Serving Cell/Cell ID", gsmCell().cellId);
        shows("GSM Cell and Neighbours/GSM Serving Cell/ARFCN", gsmCell().arfcn);
    } else {
        shows("UMTS Radio/UMTS RR Info/Cell ID", umtsCell().cellId);
        shows("UMTS Radio/UMTS RR Info/UARFCN", "10562");
        shows("UMTS Radio/UMTS RR Info/Scrambling Code", umtsCell().scramblingCode);
    }
    umtsNeighborsOfArray();
    gsmNeighborsOfArray();
}

/// The best cells that are found beside those in use and, in UMTS, the first of the serving site that is not found.
void GsmComparison::umtsNeighborsOfArray() {
    const Modem& phone = _modem.modem();
    const bool isUmts = phone.rat() == Rat::UMTS;
    std::vector<std::size_t> told = phone.umtsNeighbors(isUmts ? 2 : 1);
    const std::size_t first = phone.serving() - phone.serving() % 3;
    for (std::size_t sector = first; isUmts && sector < first + 3; ++sector) {
        if (sector == phone.serving() || _modem.air().isFound(sector)) continue;
        told.push_back(sector);
        break;
    }
    ASSERT_EQ(_played.rows("UMTS Cells/UMTS Set"), told.size());
    for (std::size_t row = 0; row < told.size(); ++row) {
        _group = "UMTS Cells/UMTS Set/" + std::to_string(row) + "/";
        const std::size_t sector = told[row];
        EXPECT_FALSE(isUmts && sector == phone.serving());
        shows("UARFCN", "10562");
        shows("Scrambling Code", _modem.network().umtsCells[sector].scramblingCode);
        if (_modem.air().isFound(sector)) {
            within("RSCP", _modem.air().rscp(sector), 0.5, " dBm");
            within("Energy Per Chip", _modem.air().ecNo(sector), 0.5, " dB");
        } else {
            shows("RSCP", "");
            shows("Energy Per Chip", "");
        }
    }
}

void GsmComparison::gsmNeighborsOfArray() {
    const auto neighbors = _modem.modem().gsmNeighbors();
    const std::size_t told = std::min<std::size_t>(neighbors.size(), _modem.modem().rat() == Rat::GSM ? 2 : 1);
    ASSERT_EQ(_played.rows("GSM Cell and Neighbours/Neighboring Cells"), told);
    for (std::size_t row = 0; row < told; ++row) {
        _group = "GSM Cell and Neighbours/Neighboring Cells/" + std::to_string(row) + "/";
        shows("ARFCN", _modem.network().gsmCells[neighbors[row]].arfcn);
        within("RSSI", _modem.air().gsmLevel(neighbors[row]), 1, " dBm");  // told in steps of 2 dB
    }
}

void GsmComparison::contexts() {
    _group = "SIM and Data Contexts/PDP Context Info";
    const Modem& phone = _modem.modem();
    if (!phone.registration().registered()) {
        EXPECT_EQ(_played.rows(_group), 0U);
        return;
    }
    const bool isData = phone.activity() == Activity::Browsing;
    const int session = _modem.user().sessions();
    const bool hasMessages = isData && session % 2 == 0;
    const std::string host = std::to_string(session % 250 + 2);
    ASSERT_EQ(_played.rows(_group), hasMessages ? 2U : 1U);
    shows("/0/Context ID", "5");
    shows("/0/APN", "internet");
    shows("/0/PDP Type", "IPv4");
    shows("/0/State", isData ? "Active" : "Inactive");
    shows("/0/PDP Address", isData ? "10.64.0." + host : "(absent)");
    shows("/0/Quality of Service", isData ? "Interactive" : "(absent)");
    if (!hasMessages) return;
    shows("/1/Context ID", "6");
    shows("/1/APN", "mms");
    shows("/1/PDP Type", "IPv4");
    shows("/1/State", "Active");
    shows("/1/PDP Address", "10.65.0." + host);
    shows("/1/Quality of Service", "Background");
}

}  // namespace kelvo::test
