#include "telephony/simulation/IFX/Simulation.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <map>
#include <set>

#include "tests/telephony/simulation/Played.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::ifx;
using namespace std::chrono_literals;

namespace {

constexpr Time kMeasurement = 480ms;

/// The cells that a screen shows, by network and carrier or code.
struct Cells {
    explicit Cells(test::Played& played) {
        network = played.text("Serving/Technology");
        const bool onGsm = network == "GSM";
        if (network != "(absent)") serving = network + played.text(onGsm ? "Serving/ARFCN" : "Serving/SCN");
        const double level = played.number(onGsm ? "Serving/RSSI" : "Serving/RSCP");
        const double quality = onGsm ? 0 : played.number("Serving/ECN0");
        for (std::size_t i = 0; i < played.rows("Neighbours/GSM"); ++i) {
            const std::string row = "Neighbours/GSM/" + std::to_string(i);
            if (played.text(row + "/RSSI") == "(absent)") continue;
            above["GSM" + played.text(row + "/ARFCN")] = played.number(row + "/RSSI") - level;
        }
        for (std::size_t i = 0; i < played.rows("Neighbours/UMTS"); ++i) {
            const std::string row = "Neighbours/UMTS/" + std::to_string(i);
            above["UMTS" + played.text(row + "/SCN")] = played.number(row + "/ECN0") - quality;
        }
    }

    std::string network;
    std::string serving;
    /// How far each neighbor stands above the serving cell, in dB; as seen from GSM, a UMTS cell's Ec/N0.
    std::map<std::string, double> above;
};

}  // namespace

/// Holds what is shown against the simulated world.
class IfxDisplay : public testing::Test {
protected:
    void near(const std::string& path, double truth, double step, const std::string& unit) {
        const std::string shown = played.text(path);
        EXPECT_NEAR(played.number(path), truth, step / 2 + 1e-9) << path << " shows " << shown;
        EXPECT_TRUE(shown.ends_with(unit)) << path << " shows " << shown;
    }
    void is(const std::string& path, const std::string& text) { EXPECT_EQ(played.text(path), text) << path; }
    void is(const std::string& path, int number) { is(path, std::to_string(number)); }

    const Status& truth() const { return modem.modem().status(); }

    void checkServing() {
        if (truth().access == RadioAccess::None) return is("Serving", "none");
        is("Serving/MCC", "001");
        is("Serving/MNC", "01");
        is("Serving/LAC", modem.modem().area().lac);
        if (truth().access == RadioAccess::Gsm) {
            checkGsm(modem.network().gsmCells[truth().serving]);
        } else {
            checkUmts(modem.network().umtsCells[truth().serving]);
        }
    }
    void checkGsm(const GsmCell& cell) {
        is("Serving/Technology", "GSM");
        is("Serving/BandInfo", "GSM 900");
        is("Serving/CellId", cell.cellId);
        is("Serving/ARFCN", cell.arfcn);
        is("Serving/BSIC", cell.bsic);
        is("Serving/UARFCN", "(absent)");
        near("Serving/RSSI", truth().rssi, 1, " dBm");
        near("Serving/C1", truth().rssi + 104, 1, "");
    }
    void checkUmts(const UmtsCell& cell) {
        EXPECT_TRUE(cell.built);
        is("Serving/Technology", "UMTS");
        is("Serving/BandInfo", "UMTS 2100");
        is("Serving/CellId", cell.cellId);
        is("Serving/UARFCN", "10562");
        is("Serving/SCN", cell.scramblingCode);
        is("Serving/ARFCN", "(absent)");
        near("Serving/RSCP", truth().rscp, 1, " dBm");
        near("Serving/ECN0", truth().ecN0, 0.5, " dB");
    }
    void checkGsmNeighbors() {
        ASSERT_EQ(played.rows("Neighbours/GSM"), truth().gsm.size());
        for (std::size_t i = 0; i < truth().gsm.size(); ++i) {
            const GsmNeighbor& neighbor = truth().gsm[i];
            const GsmCell& cell = modem.network().gsmCells[neighbor.sector];
            const std::string row = "Neighbours/GSM/" + std::to_string(i);
            if (!neighbor.measured) {
                is(row, cell.arfcn);  // nothing else is known
                continue;
            }
            is(row + "/ARFCN", cell.arfcn);
            near(row + "/RSSI", neighbor.rssi, 1, " dBm");
            is(row + "/BSIC", neighbor.identified ? std::to_string(cell.bsic) : "(absent)");
        }
    }
    void checkUmtsNeighbors() {
        ASSERT_EQ(played.rows("Neighbours/UMTS"), truth().umts.size());
        for (std::size_t i = 0; i < truth().umts.size(); ++i) {
            const std::string row = "Neighbours/UMTS/" + std::to_string(i);
            is(row + "/SCN", modem.network().umtsCells[truth().umts[i].sector].scramblingCode);
            near(row + "/RSCP", truth().umts[i].rscp, 1, " dBm");
            near(row + "/ECN0", truth().umts[i].ecN0, 0.5, " dB");
        }
    }
    void checkRegistration() {
        const std::string states[] = {"Searching", "Updating", "Registered"};
        const std::string& state = states[static_cast<int>(truth().registration)];
        if (truth().registered.lac == 0) return is("Registration", state);
        is("Registration/State", state);
        is("Registration/MCC", "001");
        is("Registration/MNC", "01");
        is("Registration/LAC", truth().registered.lac);
        is("Registration/RAC", truth().registered.rac);
    }
    void checkConnection() {
        if (truth().connection == Connection::Idle) return is("Connection", "Idle");
        const bool gsm = truth().access == RadioAccess::Gsm;
        if (truth().connection == Connection::Call) {
            is("Connection/State", "Call");
            is("Connection/Channel", gsm ? "TCH/F" : "DCH");
            is("Connection/Throughput", "(absent)");
        } else {
            is("Connection/State", "Packet transfer");
            is("Connection/Channel", gsm ? "EGPRS MCS-" + std::to_string(truth().codingScheme) : "HS-DSCH");
            near("Connection/Throughput", truth().throughput, 1, " kbit/s");
        }
        near("Connection/Errors", truth().errors * 100, 0.1, " %");
        near("Connection/TxPower", truth().tx, 1, " dBm");
        channels.insert(played.text("Connection/Channel"));
    }
    void check() {
        checkServing();
        if (truth().access != RadioAccess::None) checkGsmNeighbors();
        checkUmtsNeighbors();
        checkRegistration();
        checkConnection();
    }

    ifx::Simulation modem{1};
    test::Played played{modem};
    std::set<std::string> channels;
};

TEST_F(IfxDisplay, ShowsTheWorldAsItIsForTenMinutes) {
    while (played.time() < 10min) {
        played.next();
        check();
        if (HasFailure()) FAIL() << "at " << seconds(played.time()) << " s";
    }
    for (const auto& [level, line] : played.log()) EXPECT_GT(level, 3) << line;
    EXPECT_TRUE(channels.contains("HS-DSCH"));
    EXPECT_TRUE(channels.contains("TCH/F"));
    EXPECT_GE(channels.size(), 5U);
}

TEST_F(IfxDisplay, HasASearchAtFirstAndACellWithinTwoSeconds) {
    played.next();
    is("Serving", "none");
    is("Registration", "Searching");
    EXPECT_EQ(played.rows("Neighbours/GSM"), 0U);
    Value shown;
    while (played.time() < 1900ms) {
        shown = played.refresh();
        played.next();
    }
    const auto& neighbors = (*shown.dictionary())["Neighbours"];
    EXPECT_EQ((*neighbors.dictionary())["GSM"].array()->size(), 6U);
    EXPECT_TRUE((*(*shown.dictionary())["Serving"].dictionary())["CellId"]);
}

TEST(IfxSimulation, SendsATreeEveryFewSecondsAndAtEachChange) {
    ifx::Simulation modem(1);
    int messages = 0;
    std::size_t bytes = 0;
    Time last{0};
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        EXPECT_LE(message.time - last, 3360ms);
        last = message.time;
        ++messages;
        bytes += message.bytes.size();
    }
    EXPECT_GE(messages, 180);
    EXPECT_LE(messages, 600);
    EXPECT_LT(bytes / 600, 1000U);  // a second
}

TEST(IfxSimulation, GoesOnlyToCellsThatItHasShownBeforeAndThatCameCloser) {
    struct Sighting {
        Time time;
        double above;
    };
    struct Moves {
        int all = 0;
        int rising = 0;
    };
    std::map<std::string, Moves> moves;
    for (std::uint64_t seed = 1; seed <= 3; ++seed) {
        ifx::Simulation modem(seed);
        test::Played played(modem);
        std::map<std::string, std::vector<Sighting>> sightings;
        Cells before(played);
        while (played.time() < 10min) {
            played.next();
            const Cells shown(played);
            if (!before.serving.empty() && shown.serving != before.serving) {
                const auto& history = sightings[shown.serving];
                ASSERT_FALSE(history.empty()) << shown.serving << " at " << seconds(played.time()) << " s";
                EXPECT_LE(played.time() - history.back().time, 6720ms);  // by one of the last two messages
                double last = history.back().above;
                if (const auto left = shown.above.find(before.serving);
                    left != shown.above.end() && shown.network == before.network) {
                    last = -left->second;
                    EXPECT_GE(last, 0);
                }
                if (before.network == "GSM" && shown.network == "UMTS") {
                    EXPECT_GE(last, -11);  // for 5 s
                }
                Moves& kind = moves[before.network + " to " + shown.network];
                ++kind.all;
                kind.rising += last > history.front().above;
                sightings.clear();
            }
            for (const auto& [cell, above] : shown.above) sightings[cell].push_back({played.time(), above});
            before = shown;
        }
    }
    EXPECT_GE(moves["GSM to GSM"].all, 25);
    EXPECT_GE(moves["GSM to UMTS"].all, 5);
    EXPECT_GE(moves["UMTS to UMTS"].all, 8);
    EXPECT_GE(moves["UMTS to GSM"].all, 5);
    for (const char* kind : {"GSM to GSM", "UMTS to UMTS", "UMTS to GSM"}) {
        EXPECT_GE(moves[kind].rising, moves[kind].all * 3 / 4) << kind << ", " << moves[kind].all << " in all";
    }
}

// The rules of GSM: idle, a cell is left for one that has been stronger by 6 dB for 5 s (in another area; by less
// within one); connected, for one that has been stronger by 4 dB for 1 s.
TEST(IfxSimulation, ServesTheStrongestWithinTheMarginsOfItsRules) {
    for (std::uint64_t seed = 1; seed <= 3; ++seed) {
        Random random(seed);
        const Network network(random);
        Air air{network, Journey::through(2000, random), random.split()};
        PhoneUser user(random.split(), 4s);
        Modem modem(network, air, random.split());
        const Status& status = modem.status();
        std::size_t serving = 0;
        std::map<std::size_t, Time> idleSince;
        std::map<std::size_t, Time> connectedSince;
        int compared = 0;
        for (Time now{0}; now < 10min; now += kMeasurement) {
            const bool wasIdle = status.connection == Connection::Idle;
            user.moveTo(now);
            air.measure(now);
            modem.step(now, user);
            EXPECT_TRUE(std::ranges::is_sorted(status.gsm, std::greater(), &GsmNeighbor::rssi));
            std::map<std::size_t, Time> idle;
            std::map<std::size_t, Time> connected;
            if (status.access == RadioAccess::Gsm && status.serving == serving) {
                ++compared;
                for (const GsmNeighbor& other : status.gsm) {
                    const auto since = [&](const auto& before) {
                        return before.contains(other.sector) ? before.at(other.sector) : now;
                    };
                    const double better = other.rssi - status.rssi;
                    if (wasIdle && better > 6) idle[other.sector] = since(idleSince);
                    if (!wasIdle && better > 4) connected[other.sector] = since(connectedSince);
                }
            }
            serving = status.serving;
            idleSince = idle;
            connectedSince = connected;
            for (const auto& [sector, since] : idle) EXPECT_LT(now - since, 5s) << seed << ": " << seconds(now);
            for (const auto& [sector, since] : connected) EXPECT_LT(now - since, 1s) << seed << ": " << seconds(now);
        }
        EXPECT_GT(compared, 300);
    }
}

TEST(IfxSimulation, HearsOneCellOfACarrierAtMost) {
    for (std::uint64_t seed = 1; seed <= 5; ++seed) {
        ifx::Simulation modem(seed);
        test::Played played(modem);
        std::size_t most = 0;
        while (played.time() < 5min) {
            played.next();
            std::set<std::string> carriers{played.text("Serving/ARFCN")};
            const std::size_t rows = played.rows("Neighbours/GSM");
            for (std::size_t i = 0; i < rows; ++i) {
                const std::string row = "Neighbours/GSM/" + std::to_string(i);
                const std::string carrier = played.text(row + "/ARFCN");
                carriers.insert(carrier == "(absent)" ? played.text(row) : carrier);  // nothing else is known
            }
            EXPECT_EQ(carriers.size(), rows + 1) << "seed " << seed << " at " << seconds(played.time()) << " s";
            most = std::max(most, rows);
        }
        EXPECT_EQ(most, 6U);
    }
}

TEST(IfxSimulation, LosesMoreAndCarriesLessWhereTheSignalIsWorse) {
    std::map<int, std::map<double, double>> gsm;  // by coding scheme, and call as 0: errors by carrier to interference
    std::map<double, int> schemes;                // by carrier to interference
    std::map<bool, std::map<double, double>> umts;   // by call: errors by Ec/N0
    std::map<bool, std::pair<double, int>> carried;  // on UMTS, by a good Ec/N0: the sum of kbit/s, the messages
    for (std::uint64_t seed = 1; seed <= 3; ++seed) {
        ifx::Simulation modem(seed);
        for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
            const Status& status = modem.modem().status();
            if (status.connection == Connection::Idle) continue;
            const bool call = status.connection == Connection::Call;
            if (status.access == RadioAccess::Gsm) {
                gsm[call ? 0 : status.codingScheme][status.carrierToInterference] = status.errors;
                if (!call) schemes[status.carrierToInterference] = status.codingScheme;
            } else {
                umts[call][status.ecN0] = status.errors;
                if (call || status.throughput == 0) continue;
                auto& [sum, count] = carried[status.ecN0 > -9];
                sum += status.throughput;
                ++count;
            }
        }
    }
    const auto second = [](const auto& entry) { return entry.second; };
    const auto falls = [&second](const auto& values) {
        return std::ranges::is_sorted(values, std::greater(), second) &&
               values.begin()->second > values.rbegin()->second;
    };
    EXPECT_GE(gsm.size(), 5U);
    for (const auto& [scheme, errors] : gsm) {
        if (errors.size() < 2) continue;
        EXPECT_TRUE(falls(errors)) << scheme;
    }
    EXPECT_TRUE(std::ranges::is_sorted(schemes, {}, second));
    EXPECT_TRUE(falls(umts[false]));
    EXPECT_TRUE(falls(umts[true]));
    ASSERT_GE(carried[false].second, 15);
    ASSERT_GE(carried[true].second, 20);
    EXPECT_GT(carried[true].first / carried[true].second, 1.3 * carried[false].first / carried[false].second);
}

TEST(IfxSimulation, ChangesBetweenItsTwoNetworksWithinThreeMinutes) {
    ifx::Simulation modem(1);
    std::set<RadioAccess> served;
    std::set<int> cells;
    for (auto message = modem.next(); message.time < 3min; message = modem.next()) {
        const Status& status = modem.modem().status();
        served.insert(status.access);
        if (status.access != RadioAccess::None) cells.insert(static_cast<int>(status.serving));
    }
    EXPECT_EQ(served.size(), 3U);
    EXPECT_GE(cells.size(), 4U);
}

TEST(IfxSimulation, UpdatesItsAreaAfterEachChangeButNotDuringACall) {
    ifx::Simulation modem(1);
    Area area;
    Time elsewhereSince{0};
    std::set<int> registered;
    int updatesInCalls = 0;
    bool updating = false;
    bool called = false;
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        const Status& status = modem.modem().status();
        const bool call = status.connection == Connection::Call;
        const bool begins = status.registration == Registration::Updating && !updating;
        updatesInCalls += begins && call;
        updating = status.registration == Registration::Updating;
        if (modem.modem().area() != area || call || called) elsewhereSince = message.time;
        called = call;
        area = modem.modem().area();
        EXPECT_TRUE(message.time <= elsewhereSince + 3600ms || status.registered == area) << seconds(message.time);
        registered.insert(status.registered.lac);
    }
    EXPECT_EQ(updatesInCalls, 0);
    EXPECT_GE(registered.size(), 4U);
}

TEST(IfxSimulation, GivesNeighboringCellsDifferentIdentities) {
    ifx::Simulation modem(7);
    const auto& network = modem.network();
    std::set<std::pair<int, int>> gsm;
    std::set<int> umts;
    std::set<int> cells;
    for (std::size_t i = 0; i < network.sectors.size(); ++i) {
        EXPECT_TRUE(gsm.insert({network.gsmCells[i].arfcn, network.gsmCells[i].bsic}).second);
        EXPECT_TRUE(umts.insert(network.umtsCells[i].scramblingCode).second);
        EXPECT_TRUE(cells.insert(network.gsmCells[i].cellId).second &&
                    cells.insert(network.umtsCells[i].cellId).second);
        EXPECT_TRUE(network.gsmCells[i].arfcn >= 1 && network.gsmCells[i].arfcn <= 124);
        EXPECT_LT(network.umtsCells[i].scramblingCode, 512);
    }
}
