#include <fmt/format.h>

#include <set>

#include "telephony/simulation/IFX/Simulation.h"
#include "tests/overview/drive/Driven.h"

namespace kelvo::overview::test {
namespace {

using namespace simulation;
using namespace std::chrono_literals;
using ifx::RadioAccess;

std::string nameOf(const ifx::GsmCell& cell) {
    return fmt::format("ARFCN {}, BSIC {}", int{cell.arfcn}, int{cell.bsic});
}
std::string nameOf(const ifx::UmtsCell& cell) { return fmt::format("UARFCN 10562, PSC {}", int{cell.scramblingCode}); }

/// What the world says in the overview's words; empty where there is no cell.
struct World {
    explicit World(const ifx::Simulation& modem) {
        const ifx::Status& status = modem.modem().status();
        isConnected = status.connection != ifx::Connection::Idle;
        state = status.connection == ifx::Connection::Idle   ? "Idle"
                : status.connection == ifx::Connection::Call ? "Call"
                                                             : "Packet transfer";
        registration = status.registration == ifx::Registration::Searching  ? "Searching"
                       : status.registration == ifx::Registration::Updating ? "Updating"
                                                                            : "Registered";
        if (status.access == RadioAccess::None) return;
        isGsm = status.access == RadioAccess::Gsm;
        access = isGsm ? "GSM" : "UMTS";
        cell = isGsm ? nameOf(modem.network().gsmCells[status.serving])
                     : nameOf(modem.network().umtsCells[status.serving]);
        area = fmt::format("LAC {}", modem.modem().area().lac);
    }

    bool isConnected = false;
    bool isGsm = false;
    std::string state;
    std::string registration;
    std::string access;
    std::string cell;
    std::string area;
};

void note(Happened& happened, simulation::Time time, const World& before, const World& now) {
    const bool stays = before.isConnected && now.isConnected;
    if (before.cell.empty() && !now.cell.empty()) happened.add(Kind::CellFound, time, "", now.cell);
    happened.change(stays ? Kind::Handover : Kind::Reselection, time, before.cell, now.cell);
    happened.change(Kind::Access, time, before.access, now.access);
    if (before.access == now.access) happened.change(Kind::State, time, before.state, now.state);
    happened.change(Kind::Area, time, before.area, now.area);
    happened.change(Kind::Registration, time, before.registration, now.registration);
    if (before.registration == "Searching" && now.registration != "Searching") {
        happened.add(Kind::ServiceBack, time, "",
                     fmt::format("after {:.1f} s", std::chrono::duration<double>(time).count()));
    }
}

void expectServing(const Observation& seen, const ifx::Simulation& modem) {
    const ifx::Status& status = modem.modem().status();
    const auto fact = [&](const char* name) { return Driven::fact(seen.serving, name); };
    if (status.access == RadioAccess::Gsm) {
        const ifx::GsmCell& cell = modem.network().gsmCells[status.serving];
        expectFigure(seen.level, "RSSI", status.rssi, 1);
        EXPECT_FALSE(seen.quality);
        const double mhz = 935 + 0.2 * cell.arfcn;
        EXPECT_EQ(fact("Band"), fmt::format("GSM 900 ({:.1f} MHz down, {:.1f} MHz up)", mhz, mhz - 45));
        EXPECT_EQ(fact("Cell identity"), std::to_string(cell.cellId));
        EXPECT_EQ(fact("Color codes"), fmt::format("NCC {}, BCC {}", cell.bsic / 8, cell.bsic % 8));
    } else {
        const int id = modem.network().umtsCells[status.serving].cellId;
        expectFigure(seen.level, "RSCP", status.rscp, 1);
        expectFigure(seen.quality, "Ec/N0", status.ecN0, 0.5);
        EXPECT_EQ(fact("Band"), "UMTS 2100 (2112.4 MHz down, 1922.4 MHz up)");
        EXPECT_EQ(fact("Cell identity"), fmt::format("{} (RNC {}, cell {})", id, id / 65536, id % 65536));
    }
    EXPECT_EQ(fact("Network"), "001-01");
}

void expectNeighbors(const Driven& driven, const ifx::Simulation& modem) {
    for (const ifx::GsmNeighbor& neighbor : modem.modem().status().gsm) {
        const ifx::GsmCell& cell = modem.network().gsmCells[neighbor.sector];
        const TrackedCell* row = driven.around(nameOf(cell));
        // Before its code is read it passes for the cell heard last on that carrier, if there is one.
        if (!neighbor.identified) row = driven.onChannel(fmt::format("ARFCN {}", int{cell.arfcn}));
        ASSERT_NE(row, nullptr) << nameOf(cell);
        EXPECT_EQ(row->lastHeard, timeOf(driven.time()));
        if (neighbor.measured) {
            expectFigure(row->heard.level, "RSSI", neighbor.rssi, 1);
        } else {
            EXPECT_FALSE(row->heard.level);
        }
    }
    for (const ifx::UmtsNeighbor& neighbor : modem.modem().status().umts) {
        const ifx::UmtsCell& cell = modem.network().umtsCells[neighbor.sector];
        const TrackedCell* row = driven.around(nameOf(cell));
        if (row == nullptr) row = driven.around(fmt::format("PSC {}", int{cell.scramblingCode}));
        ASSERT_NE(row, nullptr) << nameOf(cell);
        expectFigure(row->heard.level, "RSCP", neighbor.rscp, 1);
        expectFigure(row->heard.quality, "Ec/N0", neighbor.ecN0, 0.5);
    }
}

class IfxDrive : public testing::TestWithParam<std::uint64_t> {};

TEST_P(IfxDrive, IsTheSimulatedWorlds) {
    ifx::Simulation modem(GetParam());
    Driven driven(modem);
    Happened happened;
    std::set<std::string> existing;
    for (const ifx::GsmCell& cell : modem.network().gsmCells) {
        existing.insert(nameOf(cell));
        existing.insert(fmt::format("ARFCN {}", int{cell.arfcn}));
    }
    for (const ifx::UmtsCell& cell : modem.network().umtsCells) {
        existing.insert(nameOf(cell));
        existing.insert(fmt::format("PSC {}", int{cell.scramblingCode}));
    }
    std::optional<World> before;
    int count = 0;
    while (driven.time() < 20min && !HasFailure()) {
        driven.next();
        const World now(modem);
        if (before) note(happened, driven.time(), *before, now);
        before = now;
        ++count;
        EXPECT_EQ(driven.seen().cell, now.cell);
        EXPECT_EQ(driven.seen().state, now.state);
        if (now.cell.empty()) continue;
        expectServing(driven.seen(), modem);
        expectNeighbors(driven, modem);
        driven.expectDistinct(existing);
    }
    EXPECT_GT(count, 300);
    happened.expectIn(driven.tracker());
    EXPECT_GT(happened.count(Kind::Reselection), 3);
    EXPECT_GT(happened.count(Kind::Handover), 2);
    EXPECT_GT(happened.count(Kind::State), 5);
    EXPECT_GT(happened.count(Kind::Access), 0);
    EXPECT_GT(happened.count(Kind::Area), 0);
    EXPECT_GT(happened.count(Kind::Registration), 2);
    EXPECT_EQ(happened.count(Kind::ServiceBack), 1);
}

INSTANTIATE_TEST_SUITE_P(Seeds, IfxDrive, testing::Values(1, 2));

}  // namespace
}  // namespace kelvo::overview::test
