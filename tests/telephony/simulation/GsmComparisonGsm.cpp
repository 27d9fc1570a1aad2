#include "tests/telephony/simulation/GsmComparison.h"

namespace kelvo::test {
namespace {

// clang-format off
const GsmComparison::Labels kRrStates{{0, "RR_INACTIVE"}, {3, "RR_CELL_SELECTION"}, {5, "RR_IDLE"}, {6, "RR_CELL_RESELECTION"},
                       {7, "RR_CONNECTION_PENDING"}, {9, "RR_DATA_TRANSFER"}, {11, "RR_CONNECTION_RELEASE"},
                       {13, "RR_W2G_INTERRAT_HANDOVER_ PROGRESS"}, {14, "RR_W2G_INTERRAT_RESELECTION_PROGRESS"},
                       {18, "RR_G2W_INTERRAT_RESELECTION_PROGRESS"}, {19, "RR_G2W_INTERRAT_HANDOVER_ PROGRESS"},
                       {21, "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS"}};
const GsmComparison::Labels kPriorities{{3, "1 Only"}, {4, "1 to 2"}, {5, "1 to 3"}, {6, "1 to 4"}};
const GsmComparison::Labels kT3192{{0, "500 ms"}, {1, "1000 ms"}, {2, "1500 ms"}};
// clang-format on

}  // namespace

void GsmComparison::compareGsm(std::uint32_t code) {
    _group = "GSM Cell and Neighbours/";
    const Modem& phone = _modem.modem();
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
            shows("GSM RR Info/RR Mode", phone.activity() == Activity::Browsing ? "Data" : "Voice");
            break;
        case 0x5072: shows("GSM RR Info/DTX Used", _modem.lastReports().isDtxUsed ? "ON" : "OFF"); break;
        case 0x5076: shows("GSM Serving Cell/MA Dedicated ARFCN", _modem.lastReports().dedicatedArfcn); break;
        case 0x51f8: return mobileAllocation();
        default: ADD_FAILURE() << "not a record of this family";
    }
}

void GsmComparison::gsmMeasurement() {
    const std::size_t serving = _modem.modem().serving();
    const double level = _modem.air().gsmLevel(serving);
    const double c1 = level + 104;  // above the -104 dBm that the cells ask for
    levelWithin("GSM Serving Cell/RSSI", level, " dBm");
    within("GSM Serving Cell/C1 Value", c1 < -0.5 ? c1 + 65536 : c1, 0.5);
    within("GSM Serving Cell/C2 Value", c1 + gsmCell().reselectOffset, 0.5);
    levelWithin("GSM RR Info/Serving Rx Level", level);
    within("GSM RR Info/Rx Quality Full", c1, 0.5);
    within("GSM RR Info/Rx Quality Sub", c1 + gsmCell().reselectOffset, 0.5);
    const auto neighbors = _modem.modem().gsmNeighbors();
    const auto& cells = _modem.network().gsmCells;
    const std::size_t candidate = *std::ranges::max_element(neighbors, {}, [&](std::size_t sector) {
        return _modem.air().gsmLevel(sector) + cells[sector].reselectOffset;
    });
    const bool isApplied = _modem.modem().link() == Link::Open || cells[candidate].area.lac != gsmCell().area.lac;
    EXPECT_EQ(_played.text("GPRS/GPRS Information/Cell Reselect Hysteresis"), isApplied ? "Applied" : "Not Applied");
    gsmNeighbors();
}

void GsmComparison::gsmNeighbors() {
    const auto neighbors = _modem.modem().gsmNeighbors();
    ASSERT_EQ(_played.rows(_group + "Neighboring Cells"), neighbors.size());
    for (std::size_t row = 0; row < neighbors.size(); ++row) {
        const std::string path = "Neighboring Cells/" + std::to_string(row);
        const GsmCell& cell = _modem.network().gsmCells[neighbors[row]];
        const double level = _modem.air().gsmLevel(neighbors[row]);
        shows(path + "/ARFCN", cell.arfcn);
        levelWithin(path + "/RSSI", level);
        within(path + "/C1 Value", level + 104, 0.5);
        const auto bsic = _bsics.find(cell.arfcn);
        shows(path + "/BSIC", bsic == _bsics.end() ? "(absent)" : std::to_string(bsic->second));
    }
}

void GsmComparison::rememberBsics() {
    _bsics.clear();
    for (const std::size_t sector : _modem.modem().gsmNeighbors()) {
        const GsmCell& cell = _modem.network().gsmCells[sector];
        _bsics[cell.arfcn] = cell.bsic;
    }
}

void GsmComparison::mobileAllocation() {
    shows("Mobile Allocation/HSN", gsmCell().hoppingSequence);
    const auto& carriers = gsmCell().mobileAllocation;
    ASSERT_EQ(_played.rows(_group + "Mobile Allocation/ARFCNs"), carriers.size());
    for (std::size_t i = 0; i < carriers.size(); ++i) {
        shows("Mobile Allocation/ARFCNs/" + std::to_string(i), carriers[i]);
    }
}

void GsmComparison::compareGprs(std::uint32_t code) {
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

}  // namespace kelvo::test
