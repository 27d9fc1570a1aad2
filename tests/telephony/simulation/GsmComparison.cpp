#include "tests/telephony/simulation/GsmComparison.h"

#include <algorithm>
#include <cstdio>

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

void GsmComparison::servingNetwork() {
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
void GsmComparison::equivalents() {
    const auto& registered = _modem.phone().registration().registered();
    const bool hasPartner = registered && registered->lac % 2 == 1;
    ASSERT_EQ(_played.rows(_group + "Equivalent PLMN List"), hasPartner ? 1U : 0U);
    if (!hasPartner) return;
    shows("Equivalent PLMN List/0/Mobile Country Code", "1");
    shows("Equivalent PLMN List/0/Mobile Network Code", "2");
}

void GsmComparison::sim() {
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

void GsmComparison::cells() {
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

void GsmComparison::umtsNeighboursOfArray() {
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

void GsmComparison::gsmNeighboursOfArray() {
    const auto neighbours = _modem.phone().gsmNeighbours();
    const std::size_t told = std::min<std::size_t>(neighbours.size(), _modem.phone().rat() == Rat::GSM ? 2 : 1);
    ASSERT_EQ(_played.rows("GSM Cell and Neighbours/Neighboring Cells"), told);
    for (std::size_t row = 0; row < told; ++row) {
        _group = "GSM Cell and Neighbours/Neighboring Cells/" + std::to_string(row) + "/";
        shows("ARFCN", _modem.network().gsm[neighbours[row]].arfcn);
        within("RSSI", _modem.air().gsmLevel(neighbours[row]), 1);  // told in steps of 2 dB
    }
}

void GsmComparison::contexts() {
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

}  // namespace kelvo::test
