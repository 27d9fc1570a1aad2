#include <fmt/format.h>

#include <set>

#include "telephony/simulation/CDMA/Simulation.h"
#include "tests/overview/drive/Driven.h"

namespace kelvo::overview::test {
namespace {

using namespace simulation;
using namespace std::chrono_literals;
using cdma::OneXState;

std::string nameOf(PnOffset pn) { return fmt::format("channel 283, PN {}", int{pn}); }

/// What the world says in the overview's words.
struct World {
    explicit World(const cdma::Simulation& modem) {
        const cdma::OneXStatus& status = modem.modem().oneX().status();
        const cdma::System& system = modem.modem().oneX().system();
        switch (status.state) {
            case OneXState::Initial: state = "Initial state for CDMA operation"; break;
            case OneXState::Acquisition: state = "Acquisition"; break;
            case OneXState::Sync: state = "Sync"; break;
            case OneXState::Slew: state = "Slew"; break;
            case OneXState::Paging:  // it sleeps and wakes every few seconds
            case OneXState::Sleep: state = "idle"; break;
            case OneXState::Traffic: state = "in traffic"; break;
            case OneXState::Powerup: state = "Powerup state"; break;
        }
        if (!status.active.empty()) cell = nameOf(status.referencePn);
        if (system.type == cdma::System::kNone) return;
        area = fmt::format("SID {}, NID {}", system.sid, system.nid);
        roaming = system.roamingIndicator == 0 ? "OFF" : system.roamingIndicator == 1 ? "ON" : "ERI - 64";
    }

    std::string state;
    std::string cell;
    std::string area;
    std::string roaming;
};

void note(Happened& happened, simulation::Time time, const World& before, const World& now) {
    const bool stays = before.state == "in traffic" && now.state == "in traffic";
    if (before.cell.empty() && !now.cell.empty()) happened.add(Kind::CellFound, time, "", now.cell);
    happened.change(stays ? Kind::Handover : Kind::Reselection, time, before.cell, now.cell);
    happened.change(Kind::State, time, before.state, now.state);
    happened.change(Kind::Area, time, before.area, now.area);
    happened.change(Kind::Registration, time, before.roaming, now.roaming);
}

void expectServing(const Driven& driven, const cdma::Simulation& modem) {
    const cdma::OneXStatus& status = modem.modem().oneX().status();
    expectFigure(driven.seen().level, "Rx AGC", status.rx0, 0.334);
    EXPECT_EQ(Driven::fact(driven.seen().serving, "Band"), "BC 0 (878.5 MHz down, 833.5 MHz up)");
    for (const cdma::PilotReading& pilot : status.active) {
        if (pilot.pn == status.referencePn) {
            expectFigure(driven.seen().quality, "Ec/Io", pilot.strength, 0.05);
            continue;
        }
        const TrackedCell* row = driven.around(nameOf(pilot.pn));
        ASSERT_NE(row, nullptr) << nameOf(pilot.pn);
        EXPECT_EQ(row->lastHeard, timeOf(driven.time()));
        EXPECT_EQ(row->heard.mark, "active");
        expectFigure(row->heard.quality, "Ec/Io", pilot.strength, 0.05);
    }
}

class CdmaDrive : public testing::TestWithParam<std::uint64_t> {};

TEST_P(CdmaDrive, IsTheSimulatedWorlds) {
    cdma::Simulation modem(GetParam());
    Driven driven(modem);
    Happened happened;
    std::set<std::string> existing{""};
    for (const cdma::Cell& cell : modem.network().cells) existing.insert(nameOf(cell.pn));
    std::optional<World> before;
    int statuses = 0;
    while (driven.time() < 10min && !HasFailure()) {
        const std::uint32_t code = driven.next();
        const World now(modem);
        if (before) note(happened, driven.time(), *before, now);
        before = now;
        if (code == 0x119C) {
            EXPECT_EQ(driven.seen().state, now.state);
            EXPECT_EQ(driven.seen().cell, now.cell);
            expectServing(driven, modem);
            ++statuses;
        }
        if (!now.cell.empty() && (code == 0x119C)) driven.expectDistinct(existing);
    }
    EXPECT_GT(statuses, 300);
    happened.expectIn(driven.tracker());
    EXPECT_GT(happened.count(Kind::CellFound), 2);
    EXPECT_GT(happened.count(Kind::Reselection), 2);
    EXPECT_GT(happened.count(Kind::State), 10);
    EXPECT_GT(happened.count(Kind::Area), 0);
}

INSTANTIATE_TEST_SUITE_P(Seeds, CdmaDrive, testing::Values(1, 2));

}  // namespace
}  // namespace kelvo::overview::test
