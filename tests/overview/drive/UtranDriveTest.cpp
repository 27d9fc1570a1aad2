#include <fmt/format.h>

#include <cmath>
#include <set>

#include "telephony/simulation/UTRAN/Simulation.h"
#include "tests/overview/drive/Driven.h"

namespace kelvo::overview::test {
namespace {

using namespace simulation;
using namespace std::chrono_literals;
using utran::RrcState;

std::string nameOf(const utran::Cell& cell) {
    return fmt::format("UARFCN {}, cell {}", int{cell.uarfcn}, int{cell.parameterId});
}

/// What the world says in the overview's words.
struct World {
    explicit World(const utran::Modem& modem)
        : cell(nameOf(modem.serving())),
          isDedicated(modem.rrcState() == RrcState::CellDch),
          state(textOf(modem.rrcState())),
          area(fmt::format("LAC {}, URA {}", modem.serving().locationArea, modem.serving().registrationArea)),
          band(modem.serving().band == 1 ? "a" : "b or f") {
        for (const std::string& apn : modem.contexts()) contexts.insert(apn == "internet" ? "internet (5)" : "mms (6)");
    }
    static std::string textOf(RrcState state) {
        switch (state) {
            case RrcState::Disconnected: return "Disconnected";
            case RrcState::Connecting: return "Connecting";
            case RrcState::CellFach: return "Cell Fach";
            case RrcState::CellDch: return "Cell DCH";
            case RrcState::CellPch: return "Cell PCH";
            case RrcState::UraPch: break;
        }
        return "Cell URA PCH";
    }

    std::string cell;
    bool isDedicated;
    std::string state;
    std::string area;
    std::string band;
    std::set<std::string> contexts;
};

void note(Happened& happened, simulation::Time time, const World& before, const World& now) {
    const bool stays = before.isDedicated && now.isDedicated;
    happened.change(stays ? Kind::Handover : Kind::Reselection, time, before.cell, now.cell);
    happened.change(Kind::State, time, before.state, now.state);
    happened.change(Kind::Area, time, before.area, now.area);
    happened.change(Kind::Band, time, before.band, now.band);
    for (const std::string& context : now.contexts) {
        if (!before.contexts.contains(context)) happened.add(Kind::ContextUp, time, "", context);
    }
    for (const std::string& context : before.contexts) {
        if (!now.contexts.contains(context)) happened.add(Kind::ContextDown, time, context, "");
    }
}

/// The screens show 256ths of the steps of 1 dB that a phone reports, the first from -115 dBm on.
void expectRscp(const std::optional<Measure>& shown, double truth) {
    ASSERT_TRUE(shown);
    EXPECT_EQ(shown->name, "RSCP");
    EXPECT_NEAR(256 * shown->figure.number, std::max(std::floor(truth) + 116, 0.0), 0.01) << truth;
}

void expectCells(const Driven& driven, const utran::Modem& modem) {
    for (const auto& measured : modem.measurements()) {
        const utran::Cell& cell = modem.cells()[measured.cell];
        if (measured.cell == modem.servingIndex()) {
            EXPECT_EQ(driven.seen().cell, nameOf(cell));
            expectRscp(driven.seen().level, measured.rscp);
            continue;
        }
        const TrackedCell* row = driven.around(nameOf(cell));
        ASSERT_NE(row, nullptr) << nameOf(cell);
        EXPECT_EQ(row->lastHeard, timeOf(driven.time()));
        EXPECT_EQ(row->heard.mark, measured.set == utran::Measurement::Set::Detected ? "detected" : "");
        expectRscp(row->heard.level, measured.rscp);
    }
}

class UtranDrive : public testing::TestWithParam<std::uint64_t> {};

TEST_P(UtranDrive, IsTheSimulatedWorlds) {
    utran::Simulation modem(GetParam());
    Driven driven(modem);
    Happened happened;
    std::set<std::string> existing;
    for (const utran::Cell& cell : modem.network().cells) existing.insert(nameOf(cell));
    happened.add(Kind::CellFound, 0ms, "", World(modem.modem()).cell);
    happened.add(Kind::ContextUp, 0ms, "", "internet (5)");
    std::optional<World> before;
    int measurements = 0;
    while (driven.time() < 10min && !HasFailure()) {
        const std::uint32_t code = driven.next();
        const World now(modem.modem());
        if (before) note(happened, driven.time(), *before, now);
        before = now;
        if (code == 0xD0E0) {
            EXPECT_EQ(driven.seen().state, now.state);
        }
        if (code == 0xD00A) {
            expectCells(driven, modem.modem());
            ++measurements;
        }
        if (code == 0xD00A) driven.expectDistinct(existing);
    }
    EXPECT_GT(measurements, 500);
    happened.expectIn(driven.tracker());
    EXPECT_GT(happened.count(Kind::Reselection), 2);
    EXPECT_GT(happened.count(Kind::Handover), 0);
    EXPECT_GT(happened.count(Kind::State), 10);
    EXPECT_GT(happened.count(Kind::Area), 0);
    EXPECT_GT(happened.count(Kind::ContextUp), 2);
    EXPECT_GT(happened.count(Kind::ContextDown), 0);
}

INSTANTIATE_TEST_SUITE_P(Seeds, UtranDrive, testing::Values(1, 2));

}  // namespace
}  // namespace kelvo::overview::test
