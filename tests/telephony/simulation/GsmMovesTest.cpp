#include <gtest/gtest.h>

#include <algorithm>
#include <deque>
#include <map>
#include <set>

#include "telephony/simulation/GSMUMTS/Simulation.h"
#include "tests/telephony/simulation/Played.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::gsm;
using namespace std::chrono_literals;
using kelvo::test::Played;

TEST(GsmMoves, MovesWithinGsmToANeighborThatWasShownAndHadRisen) {
    gsm::Simulation modem(10);  // mostly in GSM
    Played played(modem);
    std::size_t serving = 0;
    bool wasGsm = false;
    std::set<std::string> shown;
    std::deque<std::pair<Time, std::vector<double>>> history;
    int changes = 0;
    int risen = 0;
    while (played.time() < 12min) {
        const auto code = played.next();
        const Modem& phone = modem.modem();
        const bool isGsm = phone.isOn(Rat::GSM);
        if (isGsm && wasGsm && phone.serving() != serving) {
            ++changes;
            EXPECT_TRUE(shown.contains(std::to_string(modem.network().gsmCells[phone.serving()].arfcn)));
            const auto& then = history.front().second;
            const auto lead = [&](const auto& level) { return level(phone.serving()) - level(serving); };
            risen += lead([&](std::size_t sector) { return modem.air().gsmLevel(sector); }) >
                     lead([&](std::size_t sector) { return then[sector]; });
        }
        serving = phone.serving();
        wasGsm = isGsm;
        if (code != 0x5137) continue;
        shown.clear();
        for (std::size_t row = 0; row < played.rows("GSM Cell and Neighbours/Neighboring Cells"); ++row) {
            shown.insert(played.text("GSM Cell and Neighbours/Neighboring Cells/" + std::to_string(row) + "/ARFCN"));
        }
        std::vector<double> levels;
        for (std::size_t sector = 0; sector < modem.network().gsmCells.size(); ++sector) {
            levels.push_back(modem.air().gsmLevel(sector));
        }
        history.emplace_back(played.time(), std::move(levels));
        while (history.size() > 1 && history[1].first < played.time() - 10s) history.pop_front();
    }
    EXPECT_GE(changes, 8);               // one in one and a half minutes, so that a share of them means something
    EXPECT_GE(risen * 10, changes * 8);  // not all: half a dB of each reading is noise
}

namespace {

/// The levels in dBm of the UMTS cells that the screens have listed in the last five seconds, by their sectors.
class UmtsListings {
public:
    void forget() { _listings.clear(); }
    void look(Played& played, const gsm::Simulation& modem, const std::string& list) {
        Listing listing{played.time(), {}};
        for (std::size_t row = 0; row < played.rows(list); ++row) {
            const std::string cell = list + "/" + std::to_string(row);
            if (played.text(cell + "/RSCP").empty()) continue;  // told of, but not found
            const auto code = static_cast<int>(played.number(cell + "/Scrambling Code"));
            const auto& cells = modem.network().umtsCells;
            const auto at = std::ranges::find(cells, code, &UmtsCell::scramblingCode);
            listing.levels[static_cast<std::size_t>(at - cells.begin())] = played.number(cell + "/RSCP");
        }
        const std::size_t serving = modem.modem().serving();
        listing.levels.try_emplace(serving, modem.air().rscp(serving));  // the cell array tells no level of it
        _listings.push_back(std::move(listing));
        while (_listings.front().time < played.time() - 5s) _listings.pop_front();
    }
    /// How far `next` stood above `own` in the first of the listings that has both; none when there is none.
    std::optional<double> firstLead(std::size_t next, std::size_t own) const {
        for (const auto& [time, levels] : _listings) {
            if (levels.contains(next) && levels.contains(own)) return levels.at(next) - levels.at(own);
        }
        return std::nullopt;
    }

private:
    struct Listing {
        Time time;
        std::map<std::size_t, double> levels;
    };
    std::deque<Listing> _listings;
};

/// Changes of the serving cell within UMTS, out of a connection or in one, in drives of ten minutes. Each must be
/// to a cell that was listed together with the one that is left. Counted are all, and those to a cell that has risen
/// against it since.
///
/// At least 8, so that a share of them means something. Three of four must have risen, not all: half a dB of each
/// reading is noise, and levels are listed as whole dB.
void expectRisingMovesWithinUmts(bool isConnected, std::uint64_t drives) {
    int all = 0;
    int risen = 0;
    for (std::uint64_t seed = 3; seed < 3 + drives; ++seed) {
        gsm::Simulation modem(seed);
        Played played(modem);
        std::optional<std::size_t> serving;
        bool wasConnected = false;
        UmtsListings listings;
        while (played.time() < 10min) {
            const auto code = played.next();
            const Modem& phone = modem.modem();
            if (!phone.isOn(Rat::UMTS)) {
                serving.reset();
                listings.forget();
                continue;
            }
            if (serving && *serving != phone.serving() && wasConnected == isConnected) {
                const auto before = listings.firstLead(phone.serving(), *serving);
                ASSERT_TRUE(before) << "seed " << seed << " at " << seconds(played.time());
                ++all;
                risen += modem.air().rscp(phone.serving()) - modem.air().rscp(*serving) > *before;
            }
            serving = phone.serving();
            wasConnected = phone.link() == Link::Open;
            if (code == 0x417a) listings.look(played, modem, "UMTS Cells/Active Set");
            if (code == 0x4005 || code == 0xff0001) listings.look(played, modem, "UMTS Cells/UMTS Set");
        }
    }
    EXPECT_GE(all, 8);
    EXPECT_GE(risen * 4, all * 3) << all;
}

}  // namespace

TEST(GsmMoves, ReselectsInUmtsACellThatWasShownAndHasRisen) {
    expectRisingMovesWithinUmts(false, 8);  // a phone is seldom idle in UMTS for long
}

TEST(GsmMoves, IsServedInAUmtsConnectionByACellThatWasShownAndHasRisen) { expectRisingMovesWithinUmts(true, 3); }

TEST(GsmMoves, MovesBetweenTheSystemsToACellThatIsListed) {
    std::map<RrState, int> moves;
    for (std::uint64_t seed = 1; seed <= 5; ++seed) {
        gsm::Simulation modem(seed);
        Played played(modem);
        std::optional<Rat> last;
        RrState move = RrState::Idle;
        std::set<int> gsm;
        std::set<int> umts;
        const auto shown = [&](const std::string& list, const std::string& name) {
            std::set<int> names;
            for (std::size_t row = 0; row < played.rows(list); ++row) {
                names.insert(static_cast<int>(played.number(list + "/" + std::to_string(row) + "/" + name)));
            }
            return names;
        };
        while (played.time() < 10min) {
            const auto code = played.next();
            const Modem& phone = modem.modem();
            if (!phone.isCamped()) continue;
            if (last && *last != phone.rat()) {
                ++moves[move];
                if (phone.rat() == Rat::GSM) {
                    EXPECT_TRUE(gsm.contains(modem.network().gsmCells[phone.serving()].arfcn))
                        << seed << " at " << seconds(played.time()) << " by " << static_cast<int>(move);
                } else {
                    EXPECT_TRUE(umts.contains(modem.network().umtsCells[phone.serving()].scramblingCode))
                        << seed << " at " << seconds(played.time()) << " by " << static_cast<int>(move);
                }
            }
            last = phone.rat();
            move = phone.rrState();
            if (code != 0xff0001) continue;
            gsm = shown("GSM Cell and Neighbours/Neighboring Cells", "ARFCN");
            umts = shown("UMTS Cells/UMTS Set", "Scrambling Code");
        }
    }
    for (const RrState each : {RrState::W2gHandover, RrState::W2gReselection, RrState::W2gCellChangeOrder,
                               RrState::G2wReselection, RrState::G2wHandover}) {
        EXPECT_GE(moves[each], 1) << static_cast<int>(each);
    }
}
