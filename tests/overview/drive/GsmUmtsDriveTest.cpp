#include <fmt/format.h>

#include <set>

#include "telephony/simulation/GSMUMTS/Simulation.h"
#include "tests/overview/drive/Driven.h"

namespace kelvo::overview::test {
namespace {

using namespace simulation;
using namespace std::chrono_literals;
using gsm::GmmState;
using gsm::Rat;
using gsm::RrcState;
using gsm::RrState;

std::string nameOf(const gsm::GsmCell& cell) {
    return fmt::format("ARFCN {}, BSIC {}", int{cell.arfcn}, int{cell.bsic});
}
std::string nameOf(const gsm::UmtsCell& cell) { return fmt::format("UARFCN 10562, PSC {}", int{cell.scramblingCode}); }

std::string textOf(RrState state) {
    switch (state) {
        case RrState::Inactive: return "RR_INACTIVE";
        case RrState::CellSelection: return "RR_CELL_SELECTION";
        case RrState::Idle: return "RR_IDLE";
        case RrState::CellReselection: return "RR_CELL_RESELECTION";
        case RrState::ConnectionPending: return "RR_CONNECTION_PENDING";
        case RrState::DataTransfer: return "RR_DATA_TRANSFER";
        case RrState::ConnectionRelease: return "RR_CONNECTION_RELEASE";
        case RrState::W2gHandover: return "RR_W2G_INTERRAT_HANDOVER_ PROGRESS";
        case RrState::W2gReselection: return "RR_W2G_INTERRAT_RESELECTION_PROGRESS";
        case RrState::G2wReselection: return "RR_G2W_INTERRAT_RESELECTION_PROGRESS";
        case RrState::G2wHandover: return "RR_G2W_INTERRAT_HANDOVER_ PROGRESS";
        case RrState::W2gCellChangeOrder: break;
    }
    return "RR_W2G_INTERRAT_CC_ORDER_ PROGRESS";
}

std::string textOf(RrcState state) {
    switch (state) {
        case RrcState::Disconnected: return "Disconnected";
        case RrcState::Connecting: return "Connecting";
        case RrcState::CellFach: return "CELL_FACH";
        case RrcState::CellDch: return "CELL_DCH";
        case RrcState::UraPch: break;
    }
    return "URA_PCH";
}

std::string textOf(GmmState state) {
    switch (state) {
        case GmmState::Deregistered: return "GMM_DEREGISTERED";
        case GmmState::RegisteredInitiated: return "GMM_REGISTERED_INITIATED";
        case GmmState::Registered: return "GMM_REGISTERED";
        case GmmState::RoutingAreaUpdateInitiated: return "GMM_ROUTING_AREA_UPDATE_INITIATED";
        case GmmState::ServiceRequestInitiated: break;
    }
    return "GMM_SERVICE_REQUEST_INITIATED";
}

/// What the world says in the overview's words; empty before the phone camps.
struct World {
    explicit World(const gsm::Simulation& modem) {
        const gsm::Modem& phone = modem.modem();
        registration = textOf(phone.registration().mobility().gmm);
        if (!phone.isCamped()) return;
        isGsm = phone.rat() == Rat::GSM;
        rr = phone.rrState();
        access = isGsm ? "GSM" : "UMTS";
        state = isGsm ? textOf(phone.rrState()) : textOf(phone.rrcState());
        cell = isGsm ? nameOf(modem.network().gsmCells[phone.serving()])
                     : nameOf(modem.network().umtsCells[phone.serving()]);
        area = fmt::format("LAC {}, RAC {}", phone.area().lac, phone.area().rac);
        hasService = phone.registration().mobility().service != gsm::ServiceType::Limited;
        isConnected = phone.link() == gsm::Link::Open;
        const bool isBrowsing = phone.activity() == gsm::Activity::Browsing && phone.registration().registered();
        if (isBrowsing) contexts.insert("internet (5)");
        if (isBrowsing && modem.user().sessions() % 2 == 0) contexts.insert("mms (6)");
    }
    /// Packets on GSM do not hand over; the network's order to change cells in a connection from UMTS does.
    bool isHandedOverTo(const World& now) const {
        const bool isOrdered =
            rr == RrState::W2gHandover || rr == RrState::G2wHandover || rr == RrState::W2gCellChangeOrder;
        if (isGsm != now.isGsm) return isOrdered;
        return isConnected && now.isConnected && rr != RrState::CellReselection;
    }

    bool isGsm = false;
    bool isConnected = false;
    bool hasService = false;
    RrState rr = RrState::Inactive;
    std::string access;
    std::string state;
    std::string cell;
    std::string area;
    std::string registration;
    std::set<std::string> contexts;
};

void note(Happened& happened, simulation::Time time, const World& before, const World& now) {
    if (before.cell.empty() && !now.cell.empty()) happened.add(Kind::CellFound, time, "", now.cell);
    happened.change(before.isHandedOverTo(now) ? Kind::Handover : Kind::Reselection, time, before.cell, now.cell);
    happened.change(Kind::Access, time, before.access, now.access);
    if (before.access == now.access) happened.change(Kind::State, time, before.state, now.state);
    happened.change(Kind::Area, time, before.area, now.area);
    happened.change(Kind::Registration, time, before.registration, now.registration);
    for (const std::string& context : now.contexts) {
        if (!before.contexts.contains(context)) happened.add(Kind::ContextUp, time, "", context);
    }
    for (const std::string& context : before.contexts) {
        if (!now.contexts.contains(context)) happened.add(Kind::ContextDown, time, context, "");
    }
}

/// RXLEV has steps of 1 dB, whose upper end is shown; the last one has none, and is shown like the others.
void expectRxLev(const std::optional<Measure>& shown, double truth) {
    ASSERT_TRUE(shown);
    EXPECT_EQ(shown->name, "RxLev");
    EXPECT_EQ(shown->figure.unit, "dBm");
    EXPECT_NEAR(shown->figure.number, std::min(truth + 0.5, -47.0), 0.51);
}

void expectGsm(const Driven& driven, const gsm::Simulation& modem) {
    const gsm::GsmCell& cell = modem.network().gsmCells[modem.modem().serving()];
    const auto fact = [&](const char* name) { return Driven::fact(driven.seen().serving, name); };
    expectRxLev(driven.seen().level, modem.air().gsmLevel(modem.modem().serving()));
    const double mhz = 935 + 0.2 * cell.arfcn;
    EXPECT_EQ(fact("Band"), fmt::format("GSM 900 ({:.1f} MHz down, {:.1f} MHz up)", mhz, mhz - 45));
    EXPECT_EQ(fact("Cell identity"), std::to_string(cell.cellId));
    EXPECT_EQ(fact("Color codes"), fmt::format("NCC {}, BCC {}", cell.bsic / 8, cell.bsic % 8));
    EXPECT_EQ(fact("Network"), "001-01");
    for (const std::size_t sector : modem.modem().gsmNeighbors()) {
        const auto row = driven.onChannel(fmt::format("ARFCN {}", int{modem.network().gsmCells[sector].arfcn}));
        ASSERT_NE(row, nullptr) << nameOf(modem.network().gsmCells[sector]);
        expectRxLev(row->heard.level, modem.air().gsmLevel(sector));
    }
}

/// The searcher's steps of 1 dB are rounded down, and so is the power under the RSCP.
void expectUmtsFigures(const std::optional<Measure>& level, const std::optional<Measure>& quality, const gsm::Air& air,
                       std::size_t sector) {
    ASSERT_TRUE(level && quality);
    EXPECT_EQ(level->name, "RSCP");
    EXPECT_EQ(quality->name, "Ec/Io");
    EXPECT_NEAR(level->figure.number, air.rscp(sector) - 1.05, 1.25);
    EXPECT_NEAR(quality->figure.number, air.ecNo(sector) - 0.55, 0.7);
}

void expectUmts(const Driven& driven, const gsm::Simulation& modem) {
    const gsm::Modem& phone = modem.modem();
    const gsm::UmtsCell& cell = modem.network().umtsCells[phone.serving()];
    const auto fact = [&](const char* name) { return Driven::fact(driven.seen().serving, name); };
    expectUmtsFigures(driven.seen().level, driven.seen().quality, modem.air(), phone.serving());
    EXPECT_EQ(fact("Band"), "I (2112.4 MHz down, 1922.4 MHz up)");
    EXPECT_EQ(fact("Cell identity"),
              fmt::format("{} (RNC {}, cell {})", cell.cellId, cell.cellId / 65536, cell.cellId % 65536));
    EXPECT_EQ(fact("Network"), "001-01");
    if (phone.link() != gsm::Link::Open) return;
    for (const std::size_t sector : phone.activeSet().members()) {
        if (sector == phone.serving()) continue;
        const TrackedCell* row = driven.around(nameOf(modem.network().umtsCells[sector]));
        ASSERT_NE(row, nullptr) << nameOf(modem.network().umtsCells[sector]);
        EXPECT_EQ(row->heard.mark, "active");
        expectUmtsFigures(row->heard.level, row->heard.quality, modem.air(), sector);
    }
}

/// Of each system in its turn.
void expectRanked(const Driven& driven, const gsm::Simulation& modem) {
    for (const auto& ranked : modem.modem().rankedUmts()) {
        const std::string name = nameOf(modem.network().umtsCells[ranked.sector]);
        if (name == driven.seen().cell || driven.around(name) == nullptr) continue;
        if (driven.around(name)->lastHeard != timeOf(driven.time())) continue;
        expectFigure(driven.around(name)->heard.level, "RSCP", modem.air().rscp(ranked.sector), 1);
    }
}

class GsmUmtsDrive : public testing::TestWithParam<std::uint64_t> {};

TEST_P(GsmUmtsDrive, IsTheSimulatedWorlds) {
    gsm::Simulation modem(GetParam());
    Driven driven(modem);
    Happened happened;
    std::set<std::string> existing;
    for (const gsm::GsmCell& cell : modem.network().gsmCells) {
        existing.insert(nameOf(cell));
        existing.insert(fmt::format("ARFCN {}", int{cell.arfcn}));
    }
    for (const gsm::UmtsCell& cell : modem.network().umtsCells) existing.insert(nameOf(cell));
    std::optional<World> before;
    std::optional<simulation::Time> withoutServiceSince;
    int levels = 0;
    while (driven.time() < 10min && !HasFailure()) {
        const std::uint32_t code = driven.next();
        const World now(modem);
        if (before) note(happened, driven.time(), *before, now);
        before = now;
        if (code == 0x7135 && !now.hasService && !withoutServiceSince) withoutServiceSince = driven.time();
        if (code == 0x7135 && now.hasService && withoutServiceSince) {
            const std::chrono::duration<double> length = driven.time() - *withoutServiceSince;
            happened.add(Kind::ServiceBack, driven.time(), "", fmt::format("after {:.1f} s", length.count()));
            withoutServiceSince.reset();
        }
        if (code == 0x5137 || code == 0x417a) {
            EXPECT_EQ(driven.seen().cell, now.cell);
            EXPECT_EQ(driven.seen().access, now.access);
            EXPECT_EQ(driven.seen().area, now.area);
            EXPECT_EQ(driven.seen().state, now.state);
            ++levels;
        }
        if (code == 0x5137) expectGsm(driven, modem);
        if (code == 0x417a) expectUmts(driven, modem);
        if (code == 0x4005) expectRanked(driven, modem);
        if (!now.cell.empty() && (code == 0x5137 || code == 0x4005 || code == 0x417a)) driven.expectDistinct(existing);
    }
    EXPECT_GT(levels, 500);
    happened.expectIn(driven.tracker());
    EXPECT_GT(happened.count(Kind::Reselection), 3);
    EXPECT_GT(happened.count(Kind::Handover), 2);
    EXPECT_GT(happened.count(Kind::State), 20);
    EXPECT_GT(happened.count(Kind::Access), 1);
    EXPECT_GT(happened.count(Kind::Area), 1);
    EXPECT_GT(happened.count(Kind::Registration), 2);
    EXPECT_GT(happened.count(Kind::ContextUp), 2);
    EXPECT_GT(happened.count(Kind::ContextDown), 2);
    EXPECT_EQ(happened.count(Kind::ServiceBack), 1);
}

INSTANTIATE_TEST_SUITE_P(Seeds, GsmUmtsDrive, testing::Values(1, 2));

}  // namespace
}  // namespace kelvo::overview::test
