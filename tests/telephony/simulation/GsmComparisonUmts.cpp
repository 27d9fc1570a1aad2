#include "tests/telephony/simulation/GsmComparison.h"

#include <cmath>

namespace kelvo::test {
namespace {

// clang-format off
const GsmComparison::Labels kRrcStates{{0, "Disconnected"}, {1, "Connecting"}, {2, "CELL_FACH"}, {3, "CELL_DCH"}, {5, "URA_PCH"}};
// clang-format on

}  // namespace

void GsmComparison::compareUmts(std::uint32_t code) {
    _group = "UMTS Radio/UMTS RR Info/";
    const Link link = _modem.modem().link();
    switch (code) {
        case 0x417a: return searcher();
        case 0x4005: return ranking();
        case 0x4125: shows("RRC State", label(kRrcStates, _modem.modem().rrcState())); break;
        case 0x4127:
            shows("Cell ID", umtsCell().cellId);
            shows("Uplink Frequency", "9612");
            shows("Downlink Frequency", "10562");
            shows("UARFCN", "(absent)");  // the cell array's word for it
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
void GsmComparison::searcher() {
    _group = "UMTS Cells/";
    const Modem& phone = _modem.modem();
    const auto members = phone.link() == Link::Open ? phone.activeSet().members() : std::vector{phone.serving()};
    ASSERT_EQ(_played.rows(_group + "Active Set"), members.size());
    for (std::size_t row = 0; row < members.size(); ++row) {
        const std::string path = "Active Set/" + std::to_string(row);
        shows(path + "/Scrambling Code", _modem.network().umtsCells[members[row]].scramblingCode);
        within(path + "/Energy Per Chip", _modem.air().ecNo(members[row]) - 0.55, 0.7, " dB");
        within(path + "/RSCP", _modem.air().rscp(members[row]) - 1.05, 1.25, " dB");
    }
    for (const char* set : {"Monitored Set", "Detected Set", "Virtual Active Set"}) {
        EXPECT_EQ(_played.rows(_group + set), 0U) << set;
    }
}

/// A ranking tells of one system only; the other's list is empty.
void GsmComparison::ranking() {
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

void GsmComparison::rankedUmts() {
    const auto& ranked = _modem.modem().rankedUmts();
    ASSERT_EQ(_played.rows(_group + "UMTS Set"), ranked.size());
    for (std::size_t row = 0; row < ranked.size(); ++row) {
        const std::string path = "UMTS Set/" + std::to_string(row);
        const std::size_t sector = ranked[row].sector;
        shows(path + "/Scrambling Code", _modem.network().umtsCells[sector].scramblingCode);
        shows(path + "/Downlink Frequency", "10562");
        within(path + "/RSCP", _modem.air().rscp(sector), 0.5, " dB");
        within(path + "/Rank Cell RSCP", _modem.air().rscp(sector), 0.5, " dB");
        const double halves = std::round(2 * _modem.air().ecNo(sector));
        shows(path + "/Energy Per Chip", std::to_string(halves / 2) + " dB");  // with six decimals
        within(path + "/Ranking Value", ranked[row].rank, 0.5);
    }
}

void GsmComparison::rankedGsm() {
    _group = "GSM Cell and Neighbours/";
    const auto& ranked = _modem.modem().rankedGsm();
    ASSERT_EQ(_played.rows(_group + "GSM Set"), ranked.size());
    for (std::size_t row = 0; row < ranked.size(); ++row) {
        const std::string path = "GSM Set/" + std::to_string(row);
        const std::size_t sector = ranked[row].sector;
        shows(path + "/ARFCN", _modem.network().gsmCells[sector].arfcn);
        shows(path + "/BSIC", _modem.network().gsmCells[sector].bsic);
        within(path + "/RSSI", _modem.air().gsmLevel(sector), 0.5, " dBm");
        within(path + "/Ranking Value", ranked[row].rank, 0.5);
    }
}

/// Each slot is rounded down to 1 dB; -18.8 dBm is told as -18.7.
void GsmComparison::transmitPower() {
    double sum = 0;
    int count = 0;
    for (const auto& slot : _modem.lastReports().transmitPower) {
        if (!slot) continue;
        sum += *slot;
        ++count;
    }
    within("Transmit Power", sum / count - 0.5, 0.6, " dBm");
}

void GsmComparison::blockErrors() {
    _group = "Counters/BLER/";
    const BlockErrors& errors = _modem.lastReports().blockErrors;
    shows("Window Size", errors.windowSize);
    ASSERT_EQ(_played.rows(_group + "Transport Channels"), errors.channels.size());
    for (std::size_t row = 0; row < errors.channels.size(); ++row) {
        const std::string path = "Transport Channels/" + std::to_string(row);
        shows(path + "/Transport Channel ID", errors.channels[row].id);
        shows(path + "/CRC Received", errors.channels[row].received);
        shows(path + "/CRC Received in Error", errors.channels[row].inError);
    }
}

void GsmComparison::hsdpa() {
    _group = "UMTS Radio/HSDPA Info/";
    const HsdpaReport& report = _modem.lastReports().hsdpa;
    shows("Version", "2");
    shows("Sub Frames", report.subFrames);
    shows("Carrier Info", umtsCell().hasTwoCarriers ? "Dual Carrier" : "Single Carrier");
    processes("Primary HARQ Process", report.primary);
    if (report.hasTwoCarriers) processes("Secondary HARQ Process", report.secondary);
}

void GsmComparison::processes(const std::string& path, const std::vector<HarqProcess>& expected) {
    ASSERT_EQ(_played.rows(_group + path), expected.size());
    for (std::size_t i = 0; i < expected.size(); ++i) {
        const std::string row = path + "/" + std::to_string(i);
        shows(row + "/Process ID", expected[i].id);
        shows(row + "/No Rx Bits", std::to_string(expected[i].bits));
        shows(row + "/New Tx", expected[i].newTransmissions);
        shows(row + "/Block Errors", expected[i].blockErrors);
    }
}

}  // namespace kelvo::test
