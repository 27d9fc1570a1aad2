#include <fmt/format.h>

#include <set>

#include "telephony/simulation/LTE/Simulation.h"
#include "tests/overview/drive/Driven.h"

namespace kelvo::overview::test {
namespace {

using namespace simulation;
using namespace std::chrono_literals;

/// What the world says in the overview's words.
struct World {
    explicit World(const lte::Modem& modem)
        : cell(nameOf(modem.serving())),
          isConnected(modem.isConnected()),
          area(fmt::format("TAC {}", modem.serving().trackingArea)),
          band(modem.serving().carrier.downlink == 1300 ? "3" : "1"),
          isOnCall(modem.isOnCall()) {}
    static std::string nameOf(const lte::Cell& cell) {
        return fmt::format("EARFCN {}, PCI {}", int{cell.carrier.downlink}, int{cell.pci});
    }
    std::string state() const { return isConnected ? "connected" : "idle"; }

    std::string cell;
    bool isConnected;
    std::string area;
    std::string band;
    bool isOnCall;
};

void note(Happened& happened, simulation::Time time, const World& before, const World& now) {
    const bool stays = before.isConnected && now.isConnected;
    happened.change(stays ? Kind::Handover : Kind::Reselection, time, before.cell, now.cell);
    happened.change(Kind::State, time, before.state(), now.state());
    happened.change(Kind::Area, time, before.area, now.area);
    happened.change(Kind::Band, time, before.band, now.band);
    if (now.isOnCall && !before.isOnCall) happened.add(Kind::ContextUp, time, "", "ims (7)");
    if (before.isOnCall && !now.isOnCall) happened.add(Kind::ContextDown, time, "ims (7)", "");
}

void expectServing(const Observation& seen, const lte::Cell& cell) {
    const bool isWide = cell.carrier.downlink == 1300;
    const auto fact = [&](const char* name) { return Driven::fact(seen.serving, name); };
    EXPECT_EQ(fact("Band"), isWide ? "3 (1815.0 MHz down, 1720.0 MHz up)" : "1 (2140.0 MHz down, 1950.0 MHz up)");
    EXPECT_EQ(fact("Bandwidth"), isWide ? "20 MHz" : "10 MHz");
    EXPECT_EQ(fact("Cell identity"),
              fmt::format("{} (eNB {}, sector {})", cell.identity, cell.identity / 256, cell.identity % 256));
}

/// The neighbors that a record named are around, with the levels that it sent.
void expectNeighbors(const Driven& driven, const lte::Modem& modem) {
    const double step = modem.isConnected() ? 0.25 : 0.5;
    for (const auto& neighbor : modem.neighbors()) {
        const std::string name =
            fmt::format("EARFCN {}, PCI {}", int{modem.neighborsCarrier().downlink}, int{neighbor.pci});
        const TrackedCell* row = driven.around(name);
        ASSERT_NE(row, nullptr) << name;
        EXPECT_EQ(row->lastHeard, timeOf(driven.time())) << name;
        EXPECT_FALSE(row->isLost) << name;
        expectFigure(row->heard.level, "RSRP",
                     modem.isConnected() ? neighbor.reading.filteredRsrp : neighbor.reading.rsrp, step);
    }
}

struct NameOf {
    std::string operator()(const lte::Candidate::Lte& cell) const {
        return fmt::format("EARFCN {}, PCI {}", int{cell.channel}, int{cell.pci});
    }
    std::string operator()(const lte::Candidate::Utran& cell) const {
        return fmt::format("UARFCN {}, PSC {}", int{cell.channel}, int{cell.scramblingCode});
    }
    std::string operator()(const lte::Candidate::Geran& cell) const {
        return fmt::format("ARFCN {}, BSIC {}", int{cell.channel}, int{cell.bsic});
    }
    std::string operator()(const lte::Candidate::Cdma& cell) const {
        return fmt::format("channel {}, PN {}", int{cell.channel}, int{cell.pilot});
    }
};

class LteDrive : public testing::TestWithParam<std::uint64_t> {};

TEST_P(LteDrive, IsTheSimulatedWorlds) {
    lte::Simulation modem(GetParam());
    Driven driven(modem);
    Happened happened;
    happened.add(Kind::CellFound, 0ms, "", World(modem.modem()).cell);
    happened.add(Kind::ContextUp, 0ms, "", "internet (5)");
    happened.add(Kind::ContextUp, 0ms, "", "ims (6)");
    std::optional<World> before;
    int measurements = 0;
    std::set<std::string> existing;
    for (const lte::Cell& cell : modem.network().cells) {
        existing.insert(World::nameOf(cell));
        for (const lte::Candidate& other : cell.others) existing.insert(std::visit(NameOf(), other.cell));
    }
    while (driven.time() < 10min && !HasFailure()) {
        const std::uint32_t code = driven.next();
        const World now(modem.modem());
        if (before) note(happened, driven.time(), *before, now);
        before = now;
        const Observation& seen = driven.seen();
        if (code == 0xB0C2) expectServing(seen, modem.modem().serving());
        if (code == 0xB179 || code == 0xB17F) {
            const auto& reading = modem.modem().reading();
            EXPECT_EQ(seen.cell, now.cell);
            EXPECT_EQ(seen.area, now.area);
            EXPECT_EQ(seen.state, now.state());
            expectFigure(seen.level, "RSRP", now.isConnected ? reading.filteredRsrp : reading.rsrp, 0.25);
            expectFigure(seen.quality, "RSRQ", now.isConnected ? reading.filteredRsrq : reading.rsrq, 0.25);
            ++measurements;
        }
        if (code == 0xB179 || code == 0xB180) expectNeighbors(driven, modem.modem());
        if (code == 0xB0C2 || code == 0xB180) driven.expectDistinct(existing);
    }
    EXPECT_GT(measurements, 1000);
    EXPECT_GT(happened.count(Kind::Handover), 3);
    EXPECT_GT(happened.count(Kind::Reselection), 0);
    EXPECT_GT(happened.count(Kind::State), 10);
    EXPECT_GT(happened.count(Kind::Area), 0);
    EXPECT_GT(happened.count(Kind::ContextUp), 2);
    happened.expectIn(driven.tracker());
}

INSTANTIATE_TEST_SUITE_P(Seeds, LteDrive, testing::Values(1, 2));

}  // namespace
}  // namespace kelvo::overview::test
