#include "tests/telephony/simulation/LteShown.h"

#include <gtest/gtest.h>

#include "tests/telephony/simulation/TestSim.h"

namespace kelvo::test {

using namespace simulation;
using namespace simulation::lte;

void LteShown::compare(std::uint32_t code) {
    switch (code) {
        case 0xB0C2: return servingCell();
        case 0xB0C1: EXPECT_EQ(_played.number("Serving Cell Info/Num Tx Antennas"), _modem.serving().antennas); return;
        case 0xB179: return connectedMeasurement();
        case 0xB17F: return servingMeasurement();
        case 0xB180: return neighborMeasurement();
        case 0xB186: return candidates();
        case 0xFF0000: return expectTestSim(_played, "SIM Info", RegisteredArea{_modem.registeredArea()});
        case 0xFF0001: return monitoredCell();
        case 0xFF0002: return contexts();
        default: FAIL() << "a record that no screen asks for: " << code;
    }
}

void LteShown::servingCell() {
    const Cell& cell = _modem.serving();
    const bool isWide = cell.carrier.downlink == 1300;
    open("Serving Cell Info");
    equals("Physical Cell ID", cell.pci);
    equals("Cell Identity", cell.identity);
    equals("Tracking Area Code", cell.trackingArea);
    equals("Download Frequency", isWide ? "1300" : "300");
    equals("Upload Frequency", isWide ? "19300" : "18300");
    equals("Download Bandwidth", isWide ? "20 MHz" : "10 MHz");
    equals("Upload Bandwidth", isWide ? "20 MHz" : "10 MHz");
    equals("Freq Band Indicator", isWide ? "3" : "1");
    equals("UARFCN", "(absent)");
}

void LteShown::connectedMeasurement() {
    EXPECT_TRUE(_modem.isConnected());
    open("Connected mode LTE Intra-frequency Measurement");
    equals("E-ARFCN", _modem.serving().carrier.downlink);
    equals("Serving Physical Cell ID", _modem.serving().pci);
    equals("Subframe Number", _modem.subframe());
    reads("Serving Filtered RSRP", _modem.reading().filteredRsrp, 0.25, " dBm");
    reads("Serving Filtered RSRQ", _modem.reading().filteredRsrq, 0.125, " dB");

    ASSERT_EQ(_played.rows("Measured Neighbor Cells"), _modem.neighbors().size());
    for (std::size_t i = 0; i < _modem.neighbors().size(); ++i) {
        const Neighbor& cell = _modem.neighbors()[i];
        open("Measured Neighbor Cells/" + std::to_string(i));
        equals("Physical Cell ID", cell.pci);
        reads("Filtered RSRP", cell.reading.filteredRsrp, 0.25, " dBm");
        reads("Filtered RSRQ", cell.reading.filteredRsrq, 0.125, " dB");
    }
    ASSERT_EQ(_played.rows("Detected Cells"), _modem.detected().size());
    for (std::size_t i = 0; i < _modem.detected().size(); ++i) {
        open("Detected Cells/" + std::to_string(i));
        equals("Physical Cell ID", _modem.detected()[i]);
    }
}

void LteShown::servingMeasurement() {
    EXPECT_FALSE(_modem.isConnected());
    const Cell& cell = _modem.serving();
    const auto& reading = _modem.reading();
    const IdleState& idle = _modem.idle();
    const auto thresholdText = [](const std::optional<int>& dB, const char* unit) {
        return dB ? std::to_string(*dB) + unit : "Not Present";
    };
    open("Serving Cell Measurements");
    equals("Version", 1);
    equals("E-ARFCN", cell.carrier.downlink);
    equals("Physical Cell ID", cell.pci);
    equals("Serving Layer Priority", cell.priority);
    reads("Measured RSRP", reading.rsrp, 0.25, " dBm");
    reads("Average RSRP", reading.filteredRsrp, 0.25, " dBm");
    reads("Measured RSRQ", reading.rsrq, 0.25, " dB");
    reads("Average RSRQ", reading.filteredRsrq, 0.25, " dB");
    reads("Measured RSSI", reading.rssi, 0.5, " dBm");
    equals("Qrxlevmin", std::to_string(cell.minimumLevel) + " dBm");
    equals("P_Max", thresholdText(cell.maximumPower, " dBm"));
    equals("Max UE Tx Power", "23 dBm");
    reads("Srxlev", idle.srxlev, 1, " dBm");
    equals("Num of Consecutive DRX Cycles of S < 0", idle.failedCycles);
    equals("S Intra Search", thresholdText(cell.searchIntra, " dB"));
    equals("S Non Intra Search", thresholdText(cell.searchOther, " dBm"));
    equals("Measurement Rules Updated", idle.rulesChanged ? "True" : "False");
    equals("Measurement Rules", idle.rules);
}

void LteShown::neighborMeasurement() {
    open("Neighbor Measurements");
    equals("Version", 1);
    equals("E-ARFCN", _modem.neighborsCarrier().downlink);
    equals("Qrxlevmin", std::to_string(_modem.neighborsMinimumLevel()) + " dBm");
    ASSERT_EQ(_played.rows("Neighbor Cells List"), _modem.neighbors().size());
    for (std::size_t i = 0; i < _modem.neighbors().size(); ++i) {
        const Neighbor& cell = _modem.neighbors()[i];
        open("Neighbor Cells List/" + std::to_string(i));
        equals("Physical Cell ID", cell.pci);
        reads("Measured RSSI", cell.reading.rssi, 0.5, " dBm");
        reads("Measured RSRP", cell.reading.rsrp, 0.5, " dBm");
        reads("Average RSRP", cell.reading.filteredRsrp, 0.5, " dBm");
        reads("Measured RSRQ", cell.reading.rsrq, 0.25, " dB");
        reads("Average RSRQ", cell.reading.filteredRsrq, 0.25, " dB");
        reads("Srxlev", cell.srxlev, 1, " dBm");
        equals("Frequency Offset", cell.frequencyError);
        for (const char* antenna : {"Ant 0", "Ant 1"}) {
            equals(std::string(antenna) + " Frame Offset", cell.frames);
            equals(std::string(antenna) + " Sample Offset", cell.samples);
        }
    }
}

void LteShown::candidates() {
    open("Reselection Candidates");
    equals("Version", 1);
    equals("Serving EARFCN", _modem.serving().carrier.downlink);
    equals("Serving Cell ID", _modem.serving().pci);
    const auto& shown = _modem.candidate();
    ASSERT_EQ(_played.rows("Reselection Candidates List"), shown ? 1U : 0U);
    if (shown) candidate(*shown);
}

void LteShown::candidate(const Candidate& candidate) {
    open("Reselection Candidates List/0");
    equals("Candidate Priority", candidate.priority);
    std::visit([this](const auto& cell) { candidateCell(cell); }, candidate.cell);
}

void LteShown::candidateCell(const Candidate::Lte& cell) {
    equals("Candidate RAT Type", "LTE");
    equals("E ARFCN", cell.channel);
    equals("Cell ID", cell.pci);
}

void LteShown::candidateCell(const Candidate::Utran& cell) {
    equals("Candidate RAT Type", "UTRAN");
    equals("U ARFCN", cell.channel);
    equals("PSC", cell.scramblingCode);
}

void LteShown::candidateCell(const Candidate::Geran& cell) {
    equals("Candidate RAT Type", "GERAN");
    equals("ARFCN", cell.channel);
    equals("Band", cell.band);
    equals("BSIC ID", cell.bsic);
}

void LteShown::candidateCell(const Candidate::OneX& cell) {
    equals("Candidate RAT Type", "CDMA1XRTT");
    candidatePilot(cell);
}

void LteShown::candidateCell(const Candidate::Hrpd& cell) {
    equals("Candidate RAT Type", "CDMAHRPD");
    candidatePilot(cell);
}

void LteShown::candidatePilot(const Candidate::Cdma& cell) {
    equals("Band", cell.bandClass);
    equals("Channel", cell.channel);
    equals("Pilot", cell.pilot);
}

void LteShown::monitoredCell() {
    const Cell& cell = _modem.serving();
    open("Serving Cell Info");
    equals("Tracking Area Code", cell.trackingArea);
    equals("Cell Identity", cell.identity);
    equals("Physical Cell ID", cell.pci);
    equals("Freq Band Indicator", cell.carrier.downlink == 1300 ? "3" : "1");
    equals("UARFCN", cell.carrier.downlink);
}

void LteShown::contexts() {
    // A call has a bearer of its own beside those for the internet and for signalling.
    ASSERT_EQ(_played.rows("PDP Context Info"), _modem.isOnCall() ? 3U : 2U);
    for (std::size_t i = 0; i < _played.rows("PDP Context Info"); ++i) {
        open("PDP Context Info/" + std::to_string(i));
        equals("Context ID", std::to_string(5 + i));
        equals("APN", i == 0 ? "internet" : "ims");
        equals("State", "Active");
        equals("Quality of Service", i == 0 ? "QCI 9" : i == 1 ? "QCI 5" : "QCI 1");
        equals("PDP Type", i == 0 ? "IPv4v6" : i == 1 ? "IPv6" : "(absent)");
        equals("PDP Address", i == 0 ? "10.20.30.40" : i == 1 ? "2001:db8:1::2" : "(absent)");
    }
}

}  // namespace kelvo::test
