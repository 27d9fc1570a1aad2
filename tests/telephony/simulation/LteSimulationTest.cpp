#include "telephony/simulation/LTE/Simulation.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>
#include <map>
#include <set>

#include "tests/telephony/simulation/LteShown.h"
#include "tests/telephony/simulation/Played.h"
#include "tests/telephony/simulation/Sightings.h"
#include "tests/telephony/simulation/Standing.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::lte;
using namespace kelvo::test;
using namespace std::chrono_literals;

namespace {

/// The lines of level 3, which tell of something wrong.
std::vector<std::string> errors(const Played& played) {
    std::vector<std::string> texts;
    for (const auto& [level, text] : played.log()) {
        if (level == 3) texts.push_back(text);
    }
    return texts;
}

}  // namespace

TEST(LteSimulation, ShowsTheWorldItPlays) {
    lte::Simulation modem(1);
    Played played(modem);
    LteShown shown(played, modem.modem());
    do {
        played.clearLog();
        const std::uint32_t code = played.next();
        shown.compare(code);
        // Intended by the screen: antennas are shown, and their record is called unknown all the same.
        const std::vector<std::string> allowed =
            code == 0xB0C1 ? std::vector<std::string>{"Received an unknown log message: 45249"}
                           : std::vector<std::string>();
        EXPECT_EQ(errors(played), allowed);
        ASSERT_FALSE(HasFailure()) << "after " << seconds(played.time()) << " s, record " << std::hex << code;
    } while (played.time() < 10min);
}

TEST(LteSimulation, SendsEveryRecordThatTheApplicationAsksFor) {
    lte::Simulation modem(3);
    std::map<std::uint32_t, int> counts;
    Played played(modem);
    std::set<std::uint32_t> codes;  // of the first four minutes
    while (played.time() < 10min) {
        const std::uint32_t code = played.next();
        if (played.time() >= 10min) break;
        if (played.time() < 4min) codes.insert(code);
        ++counts[code];
    }
    EXPECT_EQ(codes, codesAskedFor(Technology::LTE));
    EXPECT_TRUE(between(counts[0xB0C2], 120, 200)) << counts[0xB0C2];    // every 5 s and with each cell
    EXPECT_TRUE(between(counts[0xB0C1], 10, 80)) << counts[0xB0C1];      // with each cell
    EXPECT_TRUE(between(counts[0xB179], 1500, 4500)) << counts[0xB179];  // 10 a second while connected
    EXPECT_TRUE(between(counts[0xB17F], 470, 1400)) << counts[0xB17F];   // 3 a second while idle
    EXPECT_TRUE(between(counts[0xB180], 200, 1400)) << counts[0xB180];   // no more than that
    EXPECT_EQ(counts[0xB186], counts[0xB17F]);
    EXPECT_TRUE(between(counts[0xFF0000], 10, 60)) << counts[0xFF0000];   // every minute and with each area
    EXPECT_TRUE(between(counts[0xFF0001], 30, 110)) << counts[0xFF0001];  // every 20 s and with each cell
    EXPECT_TRUE(between(counts[0xFF0002], 20, 90)) << counts[0xFF0002];   // every 30 s and with each call
}

TEST(LteSimulation, FillsEveryScreenWithinTwoSeconds) {
    lte::Simulation modem(1);
    Played played(modem);
    std::set<std::string> filled;
    while (played.time() < 2s) {
        played.next();
        for (const char* list : {"Measured Neighbor Cells", "Detected Cells", "Neighbor Cells List",
                                 "Reselection Candidates List", "PDP Context Info"}) {
            if (played.rows(list) > 0) filled.insert(list);
        }
    }
    EXPECT_EQ(filled.size(), 5U);
    for (const char* value :
         {"Serving Cell Info/Cell Identity", "Serving Cell Info/Num Tx Antennas", "SIM Info/EF-ICCID",
          "Serving Cell Measurements/Srxlev", "Neighbor Measurements/E-ARFCN", "Reselection Candidates/Serving Cell ID",
          "Connected mode LTE Intra-frequency Measurement/Subframe Number"}) {
        EXPECT_NE(played.text(value), "–") << value;
    }
}

TEST(LteSimulation, HasALivelyFirstThreeMinutesInLittleSpace) {
    lte::Simulation modem(1);
    Played played(modem);
    std::set<std::string> seen;
    Reported<std::size_t> serving;
    int cells = -1;  // the first is no change
    while (played.time() < 3min) {
        played.next();
        cells += serving.isDue(played.time(), modem.modem().servingIndex());
        for (const char* value :
             {"Serving Cell Info/Download Bandwidth", "Serving Cell Measurements/S Intra Search",
              "Serving Cell Measurements/P_Max", "Reselection Candidates List/0/Candidate RAT Type",
              "Serving Cell Measurements/Measurement Rules Updated", "Serving Cell Info/Tracking Area Code"}) {
            seen.insert(played.text(value));
        }
    }
    EXPECT_GE(cells, 5);
    for (const char* text : {"20 MHz", "10 MHz", "Not Present", "23 dBm", "50 dB", "True", "False", "LTE", "UTRAN",
                             "GERAN", "CDMA1XRTT", "CDMAHRPD", "1041", "1042"}) {
        EXPECT_TRUE(seen.contains(text)) << text;
    }
    EXPECT_LT(captureBytes<lte::Simulation>(1, 3min), 180U * 1024);
}

TEST(LteSimulation, GoesOnlyToCellsThatItHasShownBeforeAndThatCameCloser) {
    lte::Simulation modem(2);
    Played played(modem);
    Sightings sightings;
    Time changed = 0s;
    int serving = modem.modem().serving().pci;
    while (played.time() < 10min) {
        const auto code = played.next();
        if (modem.modem().serving().pci != serving) {
            serving = modem.modem().serving().pci;
            ASSERT_NO_FATAL_FAILURE(sightings.goTo(serving, played.time()));
            changed = played.time();
        }
        if (code != 0xB179 && code != 0xB180) continue;
        const bool isConnected = code == 0xB179;
        const std::string list = isConnected ? "Measured Neighbor Cells/" : "Neighbor Cells List/";
        const std::string level = isConnected ? "/Filtered RSRP" : "/Average RSRP";
        const double own =
            played.number(isConnected ? "Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP"
                                      : "Serving Cell Measurements/Average RSRP");
        for (std::size_t i = 0; i < played.rows(list.substr(0, list.size() - 1)); ++i) {
            const std::string row = list + std::to_string(i);
            const int cell = static_cast<int>(played.number(row + "/Physical Cell ID"));
            sightings.see(cell, played.time(), played.number(row + level) - own);
        }
    }
    EXPECT_GE(sightings.changes(), 15);
    EXPECT_GE(sightings.risen(), sightings.changes() * 3 / 4) << sightings.changes();
    EXPECT_GT(changed, 9min);  // to the end
}

TEST(LteSimulation, RegistersSoonAfterTheAreaChanges) {
    lte::Simulation modem(4);
    Played played(modem);
    Time since = 0s;
    int registrations = 0;
    int last = modem.modem().registeredArea();
    Reported<std::size_t> serving;
    while (played.time() < 10min) {
        played.next();
        const Modem& world = modem.modem();
        const bool hasMoved = serving.isDue(played.time(), world.servingIndex());
        if (world.serving().trackingArea == world.registeredArea() || hasMoved) since = played.time();
        ASSERT_LE(played.time() - since, 1s);
        if (world.registeredArea() == last) continue;
        last = world.registeredArea();
        EXPECT_TRUE(world.isConnected());
        ++registrations;
    }
    EXPECT_GE(registrations, 4);
}

TEST(LteSimulation, IsIdleAndConnectedByTurns) {
    lte::Simulation modem(2);
    int phases = 0;
    int messages = 0;
    int calls = 0;
    bool wasConnected = false;
    Time connected = 0s;
    Time last = 0s;
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        ++messages;
        if (wasConnected) connected += message.time - last;
        last = message.time;
        if (modem.modem().isConnected() == wasConnected) continue;
        wasConnected = !wasConnected;
        ++phases;
        calls += modem.modem().isOnCall() ? 1 : 0;
    }
    EXPECT_GE(phases, 30);
    EXPECT_GE(calls, 4);
    EXPECT_TRUE(between(seconds(connected) / 600, 0.25, 0.75)) << seconds(connected);
    EXPECT_TRUE(between(messages / 600.0, 8, 40)) << messages;
}

// A phone whose user does something stays connected, unless the network sends it to another carrier; a call it never
// ends.
TEST(LteSimulation, EndsASessionEarlyOnlyToGoToAnotherCarrierAndNoCallAtAll) {
    int calls = 0;
    int redirections = 0;
    int arrivals = 0;
    for (std::uint64_t seed = 8; seed <= 12; ++seed) {
        lte::Simulation modem(seed);
        const Modem& world = modem.modem();
        bool wasConnected = true;
        bool wasOnCall = false;
        std::optional<Earfcn> left;  // the carrier, until the phone has gone from it
        for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
            if (left && world.serving().carrier.downlink != *left) {
                ++arrivals;
                left.reset();
            }
            if (wasOnCall && !world.isOnCall()) {
                EXPECT_FALSE(modem.user().isTalking()) << seed << ": " << seconds(message.time);
                ++calls;
            }
            wasOnCall = world.isOnCall();
            if (world.isConnected() == wasConnected) continue;
            wasConnected = world.isConnected();
            left.reset();
            if (wasConnected || modem.user().isResting()) continue;
            left = world.serving().carrier.downlink;
            ++redirections;
        }
    }
    EXPECT_GE(calls, 25);
    EXPECT_GE(redirections, 4);
    EXPECT_GE(arrivals, redirections * 3 / 4) << redirections;
}

TEST(LteSimulation, ReadsQualityAsLevelOverEverythingHeard) {
    lte::Simulation modem(7);
    int readings = 0;
    for (auto message = modem.next(); message.time < 2min; message = modem.next()) {
        const auto& reading = modem.modem().reading();
        const bool isAtTheEnd = reading.rsrq <= -19.5 || reading.rsrq >= -3 || reading.rsrp >= -44;
        if (!modem.modem().hasMeasured() || isAtTheEnd) continue;
        const double blocks = modem.modem().serving().carrier.downlink == 1300 ? 100 : 50;
        EXPECT_NEAR(reading.rsrq, reading.rsrp + 10 * std::log10(blocks) - reading.rssi, 1e-9);
        ++readings;
    }
    EXPECT_GT(readings, 500);
}

TEST(LteSimulation, KeepsTheLevelWhileThePhoneStands) {
    lte::Simulation modem(1);
    const Modem& world = modem.modem();
    const int steady = checkStanding(modem, 4s, [&](double level) {  // until then the average still remembers the road
        EXPECT_NEAR(world.reading().filteredRsrp, level - 10 * std::log10(12 * world.serving().carrier.resourceBlocks),
                    3);
    });
    EXPECT_GT(steady, 100);
}

TEST(LteNetwork, NamesEveryCellByItself) {
    Random random(1);
    const Network network(random);
    std::set<int> pcis;
    std::set<std::uint32_t> identities;
    for (const Cell& cell : network.cells) {
        pcis.insert(cell.pci);
        identities.insert(cell.identity);
        for (const Candidate& other : cell.others) {
            const auto* utran = std::get_if<Candidate::Utran>(&other.cell);
            const auto* geran = std::get_if<Candidate::Geran>(&other.cell);
            EXPECT_TRUE(!utran || between(utran->channel, 10'562, 10'838));  // band I
            EXPECT_TRUE(!geran || between(geran->channel, 512, 885));        // DCS 1800
        }
    }
    EXPECT_EQ(pcis.size(), network.cells.size());
    EXPECT_EQ(identities.size(), network.cells.size());
}
