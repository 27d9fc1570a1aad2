#include "tests/telephony/simulation/UtranShown.h"

#include <gtest/gtest.h>

#include <cmath>

#include "tests/telephony/simulation/TestSim.h"

namespace kelvo::test {

using namespace simulation;
using namespace simulation::utran;

namespace {

/// Whether `truth` lies in the step that a reported level names: level 1 begins at `lowest`, 0 is all below it and
/// `last` all from its own lower end on.
bool isInStep(double truth, double level, double lowest, double step, int last) {
    const double low = lowest + (level - 1) * step;
    return (level == 0 || truth >= low - 1e-9) && (level == last || truth < low + step + 1e-9);
}

}  // namespace

void UtranShown::compare(std::uint32_t code) {
    switch (code) {
        case 0xD0E0: return rrcState();
        case 0xD0E2: return servingCell();
        case 0xD00A: return cells();
        case 0xD00C: return channels();
        case 0xD00E: EXPECT_EQ(_played.rows("GSM Neighbor Cell List"), 0U); return;  // intended by the screen
        case 0xFF0000: return expectTestSim(_played, "SIM Info", RegisteredArea{_modem.registeredArea()});
        case 0xFF0001: return monitoredCell();
        case 0xFF0002: return contexts();
        default: FAIL() << "a record that no screen asks for: " << code;
    }
}

void UtranShown::rrcState() {
    open("RRC Info");
    switch (_modem.rrcState()) {
        case RrcState::Disconnected: return equals("State", "Disconnected");
        case RrcState::Connecting: return equals("State", "Connecting");
        case RrcState::CellFach: return equals("State", "Cell Fach");
        case RrcState::CellDch: return equals("State", "Cell DCH");
        case RrcState::CellPch: return equals("State", "Cell PCH");
        case RrcState::UraPch: return equals("State", "Cell URA PCH");
    }
}

void UtranShown::servingCell() {
    const Cell& cell = _modem.serving();
    open("Serving Cell Info");
    equals("Cell Access Restrictions", cell.barredClasses);
    equals("Cell ID", cell.identity);
    equals("Downlink UARFCN", cell.uarfcn);
    equals("Uplink UARFCN", cell.uarfcn);
    equals("URA ID", cell.registrationArea);
    equals("Allowed Access", _modem.isRegistered() ? "All Calls" : "Emergency Calls Only");
}

void UtranShown::cells() {
    ASSERT_EQ(_played.rows("Neighbor Cell List"), _modem.measurements().size());
    for (std::size_t i = 0; i < _modem.measurements().size(); ++i) {
        const auto& measured = _modem.measurements()[i];
        const Cell& cell = _modem.cells()[measured.cell];
        open("Neighbor Cell List/" + std::to_string(i));
        equals("UARFCN", cell.uarfcn);
        equals("Cell ID", cell.parameterId);
        const double level = 256 * number("Filter RSCP");  // -115 dBm and up in steps of 1 dB
        EXPECT_NEAR(level, std::round(level), 0.001);
        EXPECT_TRUE(isInStep(measured.rscp, std::round(level), -115, 1, 91)) << measured.rscp << " as " << level;
        switch (measured.set) {
            case utran::Measurement::Set::Active: equals("Status", "ASET"); break;
            case utran::Measurement::Set::Monitored: equals("Status", "MSET"); break;
            case utran::Measurement::Set::Detected: equals("Status", "DSET"); break;
        }
        equals("inJDCS", measured.isJointlyDetected ? "TRUE" : "FALSE");
    }
}

void UtranShown::channels() {
    const auto& channels = _modem.transportChannels();
    ASSERT_EQ(_played.rows("TRCH BLER"), channels.size());
    for (std::size_t i = 0; i < channels.size(); ++i) {
        open("TRCH BLER/" + std::to_string(i));
        equals("TRCH ID", channels[i].id);
        const double level = number("TRCH BLER Measurement");
        if (channels[i].blockErrors == 0) {
            EXPECT_EQ(level, 0);
        } else {
            EXPECT_GE(level, 1);  // below -4.03 and from there in steps of 0.065
            EXPECT_TRUE(isInStep(std::log10(channels[i].blockErrors), level - 1, -4.03, 0.065, 62)) << level;
        }
    }
    const auto& composites = _modem.composites();
    ASSERT_EQ(_played.rows("CCTRCH SIR"), composites.size());
    for (std::size_t i = 0; i < composites.size(); ++i) {
        open("CCTRCH SIR/" + std::to_string(i));
        equals("CCTRCH ID", composites[i].id);
        equals("TSNUM", composites[i].timeslots);
        ASSERT_EQ(rows("SIR"), 6U);
        for (std::size_t slot = 0; slot < 6; ++slot) {
            const auto& sir = composites[i].sir[slot];
            const double level = number("SIR/" + std::to_string(slot));  // -11 dB and up in steps of 0.5 dB
            EXPECT_TRUE(sir ? isInStep(*sir, level, -11, 0.5, 63) : level == 0) << level;
        }
    }
}

void UtranShown::monitoredCell() {
    const Cell& cell = _modem.serving();
    open("Serving Cell Info");
    equals("Local Area Code", cell.locationArea);
    equals("Cell ID", cell.identity);
    equals("Freq Band Indicator", cell.uarfcn > 10'000 ? "1" : "6");  // above 2000 MHz: band a
    equals("Cell Scrambling Code", cell.parameterId);
    equals("Uplink UARFCN", cell.uarfcn);
    equals("Downlink UARFCN", cell.uarfcn);
}

void UtranShown::contexts() {
    ASSERT_EQ(_played.rows("PDP Context Info"), _modem.contexts().size());
    for (std::size_t i = 0; i < _modem.contexts().size(); ++i) {
        open("PDP Context Info/" + std::to_string(i));
        equals("Context ID", i == 0 ? "5" : "6");
        equals("APN", i == 0 ? "internet" : "mms");
        equals("PDP Type", "IPv4");
        equals("State", "Active");
        equals("PDP Address", i == 0 ? "10.20.30.40" : "10.20.30.41");
        equals("Quality of Service", "Interactive");
    }
}

}  // namespace kelvo::test
