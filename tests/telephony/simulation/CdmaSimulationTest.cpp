#include "telephony/simulation/CDMA/Simulation.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <deque>
#include <map>
#include <optional>
#include <set>

#include "tests/telephony/simulation/Played.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::cdma;
using namespace std::chrono_literals;

namespace {

std::uint32_t codeOf(const Bytes& message) { return message.at(5) | message.at(6) << 8U; }

bool holds(const std::vector<PilotReading>& active, int pn) {
    return std::ranges::find(active, pn, &PilotReading::pn) != active.end();
}

}  // namespace

TEST(CdmaSimulation, SendsEveryRecordAskedForAtItsRate) {
    cdma::Simulation modem(1);
    std::map<std::uint32_t, int> counts;
    std::set<std::uint32_t> codes;  // of the first four minutes
    std::size_t bytes = 0;
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        ++counts[codeOf(message.bytes)];
        if (message.time < 4min) codes.insert(codeOf(message.bytes));
        bytes += message.bytes.size();
    }
    EXPECT_EQ(codes, test::codesAskedFor(Technology::CDMA));
    const std::map<std::uint32_t, std::pair<int, int>> expected{
        {0x108A, {450, 1500}}, {0x1183, {400, 1000}}, {0x1192, {100, 300}}, {0x12B6, {450, 1500}},
        {0x119C, {600, 1500}}, {0x119D, {900, 3000}}, {0x127E, {40, 120}},  {0x134F, {25, 100}},
    };
    for (const auto& [code, range] : expected) {
        EXPECT_GE(counts[code], range.first) << std::hex << code;
        EXPECT_LE(counts[code], range.second) << std::hex << code;
    }
    EXPECT_EQ(counts.size(), expected.size());
    EXPECT_LT(bytes / 600, 1000U);  // a second
}

TEST(CdmaSimulation, HandsOffOnlyToPilotsOfTheActiveSetDuringACall) {
    cdma::Simulation modem(1);
    std::vector<PilotReading> before;
    std::optional<PnOffset> reference;
    int handoffs = 0;
    std::size_t most = 0;
    for (auto message = modem.next(); message.time < 5min; message = modem.next()) {
        const OneXStatus& status = modem.modem().oneX().status();
        if (status.state != OneXState::Traffic) {
            reference.reset();
        } else if (codeOf(message.bytes) == 0x119C) {
            if (reference && status.referencePn != *reference) {
                ++handoffs;
                EXPECT_TRUE(holds(before, status.referencePn)) << status.referencePn;
            }
            EXPECT_TRUE(holds(status.active, status.referencePn));
            reference = status.referencePn;
            before = status.active;
            most = std::max(most, status.active.size());
        }
    }
    EXPECT_GE(handoffs, 3);
    EXPECT_GE(most, 3U);
}

// The pilot that the modem follows alone, as it does when idle.
std::optional<PilotReading> followedOneX(const cdma::Simulation& modem) {
    const OneXStatus& status = modem.modem().oneX().status();
    if (status.state != OneXState::Paging && status.state != OneXState::Sleep) return std::nullopt;
    EXPECT_EQ(status.active.size(), 1U);
    return status.active.at(0);
}

std::optional<PilotReading> followedEvdo(const cdma::Simulation& modem) {
    const EvdoStatus& status = modem.modem().evdo().status();
    if (status.state != EvdoState::Idle) return std::nullopt;
    EXPECT_EQ(status.active.size(), 1U);
    return status.active.at(0);
}

// An idle phone's records show the pilot that it follows alone, so the others come from the world. A pilot weaker than
// `drop` may be left for any that is stronger.
void expectMovesWhenIdle(std::optional<PilotReading> (*followed)(const cdma::Simulation&),
                         const Reception& (Air::*carrier)() const, double drop, int fewest) {
    cdma::Simulation modem(1);
    const auto& sectors = modem.network().cells;
    const auto sectorOf = [&sectors](int pn) {
        return static_cast<std::size_t>(std::ranges::find(sectors, pn, &Cell::pn) - sectors.begin());
    };
    std::deque<std::pair<Time, std::vector<double>>> received;  // of the last 8 s
    std::optional<PilotReading> before;
    int moves = 0;
    int rising = 0;
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        received.emplace_back(message.time, modem.air().drive().received());
        while (received.front().first < message.time - 8s) received.pop_front();
        const std::optional<PilotReading> now = followed(modem);
        if (before && now && now->pn != before->pn) {
            const auto above = [&, to = sectorOf(now->pn), from = sectorOf(before->pn)](const auto& levels) {
                return levels[to] - levels[from];
            };
            const double own = (modem.air().*carrier)().pilots[sectorOf(before->pn)];
            const double least = own < drop + 1 ? -1 : 2;  // 0 or 3 dB as read, noise included
            EXPECT_GT(above(received.back().second), least) << seconds(message.time);
            rising += above(received.back().second) > above(received.front().second);
            ++moves;
        }
        before = now;
    }
    EXPECT_GE(moves, fewest);
    EXPECT_GE(rising, moves * 3 / 4) << moves;
}

TEST(CdmaSimulation, MovesToClearlyStrongerPilotsThatCameCloserWhenIdle) {
    expectMovesWhenIdle(followedOneX, &Air::oneX, -16, 12);  // T_DROP
}

TEST(CdmaSimulation, MovesLikewiseInEvdo) {
    expectMovesWhenIdle(followedEvdo, &Air::evdo, -9, 6);  // PilotDrop
}

TEST(CdmaSimulation, RegistersWheneverTheSystemOrNetworkChanges) {
    cdma::Simulation modem(3);
    std::pair<int, int> area{0, 0};
    int changes = 0;
    int registrationsThen = 0;
    Time changedAt{0};
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        const System& system = modem.modem().oneX().system();
        if (std::pair(system.sid, system.nid) != area) {
            area = {system.sid, system.nid};
            ++changes;
            registrationsThen = modem.modem().oneX().registrations();
            changedAt = message.time;
            EXPECT_EQ(modem.modem().oneX().status().state, OneXState::Paging);  // awake for it
        } else if (message.time > changedAt + 1300ms) {
            EXPECT_EQ(modem.modem().oneX().registrations(), registrationsThen + 1 - (changes == 0 ? 1 : 0));
        }
    }
    EXPECT_GE(changes, 3);
}

TEST(CdmaSimulation, KeepsAnEvdoAddressOfTheSubnetItIsIn) {
    cdma::Simulation modem(3);
    std::map<int, std::set<std::uint32_t>> addresses;  // by colour code
    Time settled{0};
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        const EvdoStatus& status = modem.modem().evdo().status();
        if (status.state != EvdoState::Idle || status.session != SessionState::Open) settled = message.time + 400ms;
        if (message.time <= settled) continue;
        const auto& sectors = modem.network().cells;
        const auto serving = std::ranges::find(sectors, *status.servingPn, &Cell::pn);
        ASSERT_NE(serving, sectors.end());
        EXPECT_EQ(status.colorCode, kZones[serving->zone].colorCode);
        addresses[status.colorCode].insert(status.uati);
    }
    EXPECT_GE(addresses.size(), 2U);
}

TEST(CdmaSimulation, LeavesEvdoDuringCallsAndReturnsToIt) {
    cdma::Simulation modem(1);
    int calls = 0;
    int connections = 0;
    bool talked = false;
    bool connected = false;
    for (auto message = modem.next(); message.time < 5min; message = modem.next()) {
        const bool talks = modem.modem().oneX().status().state == OneXState::Traffic;
        const EvdoStatus& evdo = modem.modem().evdo().status();
        if (talks) {
            EXPECT_EQ(evdo.state, EvdoState::Inactive);
            EXPECT_TRUE(evdo.active.empty() && evdo.fingers.empty());
        }
        calls += talks && !talked;
        connections += evdo.state == EvdoState::Connected && !connected;
        talked = talks;
        connected = evdo.state == EvdoState::Connected;
    }
    EXPECT_GE(calls, 3);
    EXPECT_GE(connections, 6);
}

TEST(CdmaSimulation, ReadsASteadyLevelWhileThePhoneStands) {
    cdma::Simulation modem(1);
    double driven = -1;
    double least = 0;
    double most = 0;
    Time since{0};
    int stops = 0;
    for (auto message = modem.next(); message.time < 5min; message = modem.next()) {
        const double level = modem.modem().oneX().status().rx0;
        if (modem.air().drive().driven() != driven) {
            stops += message.time - since > 4s;
            driven = modem.air().drive().driven();
            since = message.time;
            least = most = level;
        }
        least = std::min(least, level);
        most = std::max(most, level);
        EXPECT_LT(most - least, 4);  // the receiver's own noise
    }
    EXPECT_GE(stops, 1);
}

TEST(CdmaSimulation, GivesNoTwoSectorsOnePilotOffset) {
    cdma::Simulation modem(5);
    std::set<int> offsets;
    for (const Cell& sector : modem.network().cells) {
        EXPECT_TRUE(offsets.insert(sector.pn).second);
    }
}

namespace {

Reception air(std::vector<double> pilots) {
    Reception air;
    air.pilots = std::move(pilots);
    air.total = -70;
    return air;
}

}  // namespace

TEST(PilotSet, AddsAPilotAboveTheAddThresholdAndDropsItAfterItsTimer) {
    PilotSet pilots({.add = -14, .drop = -16, .dropTime = 4s, .compare = 2.5});
    pilots.follow(0);
    pilots.update(0s, air({-6, -14.5}));
    EXPECT_EQ(pilots.sectors(), (std::vector<std::size_t>{0}));
    pilots.update(1s, air({-6, -13.5}));
    EXPECT_EQ(pilots.sectors(), (std::vector<std::size_t>{0, 1}));
    pilots.update(2s, air({-6, -17}));
    pilots.update(5s, air({-6, -15}));  // above the drop threshold: the timer ends
    pilots.update(6s, air({-6, -17}));
    pilots.update(9s, air({-6, -17}));
    EXPECT_EQ(pilots.sectors().size(), 2U);
    pilots.update(10s, air({-6, -17}));
    EXPECT_EQ(pilots.sectors(), (std::vector<std::size_t>{0}));
}

TEST(PilotSet, FollowsAMemberThatIsClearlyStronger) {
    PilotSet pilots(kOneXRules);
    pilots.follow(0);
    pilots.update(0s, air({-8, -7}));
    pilots.update(1s, air({-8, -7}));
    EXPECT_EQ(pilots.reference(), 0U);
    pilots.update(2s, air({-11, -7}));
    EXPECT_EQ(pilots.reference(), 1U);
}

TEST(PilotSet, ReplacesTheWeakestOfSixByOneThatBeatsIt) {
    PilotSet pilots(kOneXRules);
    pilots.follow(0);
    pilots.update(0s, air({-9, -10, -10, -10, -10, -12, -20}));
    pilots.update(1s, air({-9, -10, -10, -10, -10, -12, -10}));
    EXPECT_EQ(pilots.sectors(), (std::vector<std::size_t>{0, 1, 2, 3, 4, 5}));
    pilots.update(2s, air({-9, -10, -10, -10, -10, -12, -9}));
    EXPECT_EQ(pilots.sectors(), (std::vector<std::size_t>{0, 1, 2, 3, 4, 6}));
}

TEST(PilotSet, LeavesItsPilotWhenIdleForOneThatStaysStrongerOrAtOnceWhenItIsLost) {
    PilotSet pilots(kOneXRules);
    pilots.follow(0);
    EXPECT_FALSE(pilots.reselect(0s, air({-10, -6})));
    EXPECT_TRUE(pilots.reselect(2s, air({-10, -6})));
    EXPECT_EQ(pilots.reference(), 1U);
    EXPECT_FALSE(pilots.reselect(4s, air({-10, -12})));
    EXPECT_TRUE(pilots.reselect(6s, air({-15, -17})));
    EXPECT_EQ(pilots.reference(), 0U);
}

TEST(PacketLink, ReceivesMoreOnABetterLink) {
    PacketLink poor{Random(1)};
    PacketLink good{Random(1)};
    poor.receive(-10, 1, 10s);
    good.receive(10, 1, 10s);
    // 76.8 and 2457.6 kbit/s, less what is lost or sent in small packets.
    EXPECT_NEAR(static_cast<double>(poor.counters().forwardBits), 700e3, 70e3);
    EXPECT_NEAR(static_cast<double>(good.counters().forwardBits), 24.3e6, 1e6);
}
