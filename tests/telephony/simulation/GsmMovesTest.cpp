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
    EXPECT_GE(changes, 8);
    EXPECT_GE(risen * 10, changes * 8);
}

TEST(GsmMoves, MovesWithinUmtsToACellThatWasShownAndHadRisen) {
    struct Listing {
        Time time;
        std::map<std::size_t, double> levels;  // dBm, of the sectors shown
    };
    struct Count {
        int changes = 0;
        int risen = 0;
    };
    Count counts[2];  // idle, connected
    for (std::uint64_t seed : {3U, 5U, 7U}) {
        gsm::Simulation modem(seed);
        Played played(modem);
        std::optional<std::size_t> serving;
        bool wasConnected = false;
        std::deque<Listing> listings;
        while (played.time() < 10min) {
            const auto code = played.next();
            const Modem& phone = modem.modem();
            if (!phone.isOn(Rat::UMTS)) {
                serving.reset();
                continue;
            }
            if (serving && *serving != phone.serving()) {
                std::vector<double> leads;
                for (const auto& [time, levels] : listings) {
                    const auto next = levels.find(phone.serving());
                    const auto own = levels.find(*serving);
                    if (next != levels.end() && own != levels.end()) leads.push_back(next->second - own->second);
                }
                ASSERT_FALSE(leads.empty()) << "seed " << seed << " at " << seconds(played.time());
                const double lead = modem.air().rscp(phone.serving()) - modem.air().rscp(*serving);
                Count& count = counts[wasConnected];
                ++count.changes;
                count.risen += lead > leads.front();
            }
            serving = phone.serving();
            wasConnected = phone.link() == Link::Open;
            if (code != 0x417a && code != 0x4005 && code != 0xff0001) continue;
            const std::string list = code == 0x417a ? "UMTS Cells/Active Set" : "UMTS Cells/UMTS Set";
            Listing listing{played.time(), {}};
            for (std::size_t row = 0; row < played.rows(list); ++row) {
                const std::string cell = list + "/" + std::to_string(row);
                if (played.text(cell + "/RSCP").empty()) continue;  // told of, but not found
                const auto at = std::ranges::find(modem.network().umtsCells,
                                                  static_cast<int>(played.number(cell + "/Scrambling Code")),
                                                  &UmtsCell::scramblingCode);
                listing.levels[static_cast<std::size_t>(at - modem.network().umtsCells.begin())] =
                    played.number(cell + "/RSCP");
            }
            listing.levels.try_emplace(*serving, modem.air().rscp(*serving));  // the cell array tells no level of it
            listings.push_back(std::move(listing));
            while (listings.front().time < played.time() - 5s) listings.pop_front();
        }
    }
    for (const Count& count : counts) {
        EXPECT_GE(count.changes, 8);
        EXPECT_GE(count.risen * 4, count.changes * 3) << count.changes;
    }
}

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
