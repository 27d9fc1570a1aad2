#include "telephony/simulation/IfxSimulation.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <optional>
#include <set>

#include "tests/telephony/simulation/Played.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::ifx;
using namespace std::chrono_literals;

namespace {

std::vector<Bytes> minuteOf(std::uint64_t seed) {
    IfxSimulation modem(seed);
    std::vector<Bytes> messages;
    for (auto message = modem.next(); message.time < 1min; message = modem.next()) messages.push_back(message.bytes);
    return messages;
}

bool lists(const std::vector<GsmNeighbour>& cells, std::size_t sector) {
    return std::ranges::find(cells, sector, &GsmNeighbour::sector) != cells.end();
}

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
            checkGsm(modem.network().gsm[truth().serving]);
        } else {
            checkUmts(modem.network().umts[truth().serving]);
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
    void checkGsmNeighbours() {
        ASSERT_EQ(played.rows("Neighbours/GSM"), truth().gsm.size());
        for (std::size_t i = 0; i < truth().gsm.size(); ++i) {
            const GsmNeighbour& neighbour = truth().gsm[i];
            const GsmCell& cell = modem.network().gsm[neighbour.sector];
            const std::string row = "Neighbours/GSM/" + std::to_string(i);
            if (!neighbour.measured) {
                is(row, cell.arfcn);  // nothing else is known
                continue;
            }
            is(row + "/ARFCN", cell.arfcn);
            near(row + "/RSSI", neighbour.rssi, 1, " dBm");
            is(row + "/BSIC", neighbour.identified ? std::to_string(cell.bsic) : "(absent)");
        }
    }
    void checkUmtsNeighbours() {
        ASSERT_EQ(played.rows("Neighbours/UMTS"), truth().umts.size());
        for (std::size_t i = 0; i < truth().umts.size(); ++i) {
            const std::string row = "Neighbours/UMTS/" + std::to_string(i);
            is(row + "/SCN", modem.network().umts[truth().umts[i].sector].scramblingCode);
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
        if (truth().access != RadioAccess::None) checkGsmNeighbours();
        checkUmtsNeighbours();
        checkRegistration();
        checkConnection();
    }

    IfxSimulation modem{1};
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
    const auto& neighbours = (*shown.dictionary())["Neighbours"];
    EXPECT_EQ((*neighbours.dictionary())["GSM"].array()->size(), 6U);
    EXPECT_TRUE((*(*shown.dictionary())["Serving"].dictionary())["CellId"]);
}

TEST(IfxSimulation, GivesTheSameBytesForTheSameSeed) {
    EXPECT_EQ(minuteOf(1), minuteOf(1));
    EXPECT_NE(minuteOf(1), minuteOf(2));
}

TEST(IfxSimulation, SendsATreeEveryFewSecondsAndAtEachChange) {
    IfxSimulation modem(1);
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

TEST(IfxSimulation, ReselectsAmongTheNeighboursThatWereListed) {
    IfxSimulation modem(1);
    std::optional<Status> before;
    int reselections = 0;
    int changes = 0;
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        const Status& status = modem.modem().status();
        if (before && before->access == RadioAccess::Gsm && status.access == RadioAccess::Gsm &&
            before->serving != status.serving && status.connection == Connection::Idle) {
            ++reselections;
            EXPECT_TRUE(lists(before->gsm, status.serving));
        }
        changes += before && before->access != RadioAccess::None &&
                   std::pair(before->access, before->serving) != std::pair(status.access, status.serving);
        before = status;
    }
    EXPECT_GE(reselections, 2);
    EXPECT_GE(changes, 10);
}

TEST(IfxSimulation, ServesTheStrongestWithinTheMarginsOfItsRules) {
    IfxSimulation modem(2);
    for (auto message = modem.next(); message.time < 5min; message = modem.next()) {
        const Status& status = modem.modem().status();
        if (status.access != RadioAccess::Gsm || status.gsm.empty()) continue;
        EXPECT_GT(status.rssi, status.gsm.front().rssi - 25) << seconds(message.time);
        EXPECT_TRUE(std::ranges::is_sorted(status.gsm, std::greater(), &GsmNeighbour::rssi));
    }
}

TEST(IfxSimulation, ChangesBetweenItsTwoNetworksWithinThreeMinutes) {
    IfxSimulation modem(1);
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
    IfxSimulation modem(1);
    LocationArea area;
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

TEST(IfxSimulation, GivesNeighbouringCellsDifferentIdentities) {
    IfxSimulation modem(7);
    const auto& network = modem.network();
    std::set<std::pair<int, int>> gsm;
    std::set<int> umts;
    std::set<int> cells;
    for (std::size_t i = 0; i < network.radio.size(); ++i) {
        EXPECT_TRUE(gsm.insert({network.gsm[i].arfcn, network.gsm[i].bsic}).second);
        EXPECT_TRUE(umts.insert(network.umts[i].scramblingCode).second);
        EXPECT_TRUE(cells.insert(network.gsm[i].cellId).second && cells.insert(network.umts[i].cellId).second);
        EXPECT_TRUE(network.gsm[i].arfcn >= 1 && network.gsm[i].arfcn <= 124);
        EXPECT_LT(network.umts[i].scramblingCode, 512);
    }
}
