#include "telephony/simulation/GsmSimulation.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <deque>
#include <map>
#include <set>

#include "tests/telephony/simulation/Played.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::gsm;
using namespace std::chrono_literals;
using kelvo::test::Played;

namespace {

struct Written {
    Bytes log;
    std::map<std::uint32_t, int> counts;
    std::map<std::uint32_t, Time> first;
};

Written write(std::uint64_t seed, Time until) {
    GsmSimulation modem(seed);
    Written written;
    for (auto message = modem.next(); message.time < until; message = modem.next()) {
        const auto& bytes = message.bytes;
        const std::uint32_t code = (bytes[2] == 255 ? 0xff0000U : 0U) | bytes[5] | bytes[6] << 8U;
        ++written.counts[code];
        written.first.try_emplace(code, message.time);
        written.log.insert(written.log.end(), bytes.begin(), bytes.end());
    }
    return written;
}

/// Goes on, message by message, as long as `until` has not come; calls `look` after each.
template <class Look>
void watch(GsmSimulation& modem, Time until, Look look) {
    for (auto message = modem.next(); message.time < until; message = modem.next()) look(message.time);
}

}  // namespace

TEST(GsmSimulation, WritesTheSameLogForTheSameSeed) {
    const Bytes log = write(5, 60s).log;
    EXPECT_EQ(write(5, 60s).log, log);
    EXPECT_NE(write(6, 60s).log, log);
}

TEST(GsmSimulation, ReportsEveryRecordKindAtItsRate) {
    struct Range {
        std::uint32_t code;
        int low, high;  // in ten minutes, of which roughly half is spent in each system
    };
    // clang-format off
    constexpr Range kRanges[] = {
        {0x4005, 100, 500},  {0x4031, 100, 900},   {0x4116, 30, 250},    {0x4125, 300, 1300}, {0x4127, 30, 150},
        {0x4157, 20, 150},   {0x417a, 100, 600},   {0x4221, 20, 200},    {0x5072, 30, 400},   {0x5076, 30, 400},
        {0x512c, 1200, 1600}, {0x5134, 20, 150},   {0x5137, 100, 1000},  {0x51f4, 8, 60},     {0x51f5, 8, 60},
        {0x51f6, 8, 60},     {0x51f8, 5, 60},      {0x51fb, 8, 60},      {0x51fd, 8, 60},     {0x51ff, 20, 150},
        {0x7130, 600, 800},  {0x7131, 600, 800},   {0x7132, 600, 800},   {0x7135, 150, 300},  {0x7150, 30, 60},
        {0xff0000, 10, 60},  {0xff0001, 40, 120},  {0xff0002, 15, 60},
    };
    // clang-format on
    const auto counts = write(1, 10min).counts;
    EXPECT_EQ(counts.size(), std::size(kRanges));
    for (const auto& [code, low, high] : kRanges) {
        const auto found = counts.find(code);
        ASSERT_NE(found, counts.end()) << std::hex << code;
        EXPECT_GE(found->second, low) << std::hex << code;
        EXPECT_LE(found->second, high) << std::hex << code;
    }
}

TEST(GsmSimulation, WritesExactlyTheRecordsThatTheApplicationAsksFor) {
    std::set<std::uint32_t> written;
    for (const auto& [code, count] : write(1, 4min).counts) written.insert(code);
    EXPECT_EQ(written, kelvo::test::codesAskedFor(Technology::GSM));
}

TEST(GsmSimulation, FillsEveryScreenWithinTwoSeconds) {
    for (std::uint64_t seed = 1; seed <= 20; ++seed) {
        EXPECT_EQ(write(seed, 2s).counts.size(), 28U) << "seed " << seed;
    }
}

TEST(GsmSimulation, FitsFourMinutesIntoAShortCapture) {
    const auto written = write(1, 4min);
    std::size_t messages = 0;
    for (const auto& [code, count] : written.counts) messages += static_cast<std::size_t>(count);
    EXPECT_LT(written.log.size() + 16 * messages, 260'000U);  // 16 bytes before each in a capture
    EXPECT_GT(messages, 10 * 240U);
}

TEST(GsmSimulation, ChangesCellsSystemsAreasAndUsesInThreeMinutes) {
    GsmSimulation modem(1);
    std::set<std::pair<Rat, std::size_t>> cells;
    std::set<int> areas;
    std::set<Use> uses;
    int systemChanges = -1;
    std::optional<Rat> last;
    watch(modem, 3min, [&](Time) {
        const Phone& phone = modem.phone();
        if (!phone.isCamped()) return;
        cells.insert({phone.rat(), phone.serving()});
        areas.insert(phone.area().lac);
        uses.insert(phone.use());
        if (last != phone.rat()) ++systemChanges;
        last = phone.rat();
    });
    EXPECT_GE(cells.size(), 6U);
    EXPECT_GE(areas.size(), 3U);
    EXPECT_EQ(uses.size(), 3U);
    EXPECT_GE(systemChanges, 3);
}

TEST(GsmSimulation, RegistersAgainSoonAfterEveryChangeOfArea) {
    GsmSimulation modem(2);
    Time unregisteredSince{0};
    int changes = 0;
    Area before{};
    watch(modem, 10min, [&](Time now) {
        const Phone& phone = modem.phone();
        if (!phone.isCamped()) return;
        if (phone.area() != before) ++changes;
        before = phone.area();
        const bool isRegistered = phone.registration().registered() == phone.area();
        if (isRegistered || phone.use() == Use::Voice) unregisteredSince = now;
        ASSERT_LT(now - unregisteredSince, 3s) << "at " << seconds(now);
    });
    EXPECT_GT(changes, 12);
}

TEST(GsmSimulation, ShowsARegistrationInAllThreeProcesses) {
    GsmSimulation modem(1);
    Played played(modem);
    std::set<std::string> states;
    while (played.time() < 3s) {
        played.next();
        for (const char* process : {"CS", "PS", "CO"}) {
            states.insert(
                played.text(std::string("Registration and Network/Process ") + process + "/MM Service State"));
        }
    }
    states.erase("–");
    EXPECT_EQ(states, (std::set<std::string>{"REG_STATE_AUTOMATIC_SEARCH", "REG_STATE_REGISTERING", "REG_STATE_IDLE"}));
}

TEST(GsmSimulation, MovesWithinGsmToANeighbourThatWasShownAndHadRisen) {
    GsmSimulation modem(10);  // mostly in GSM
    Played played(modem);
    std::size_t serving = 0;
    bool wasGsm = false;
    std::set<std::string> shown;
    std::deque<std::pair<Time, std::vector<double>>> history;
    int changes = 0;
    int risen = 0;
    while (played.time() < 12min) {
        const auto code = played.next();
        const Phone& phone = modem.phone();
        const bool isGsm = phone.isOn(Rat::GSM);
        if (isGsm && wasGsm && phone.serving() != serving) {
            ++changes;
            EXPECT_TRUE(shown.contains(std::to_string(modem.network().gsm[phone.serving()].arfcn)));
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
        for (std::size_t sector = 0; sector < modem.network().gsm.size(); ++sector) {
            levels.push_back(modem.air().gsmLevel(sector));
        }
        history.emplace_back(played.time(), std::move(levels));
        while (history.size() > 1 && history[1].first < played.time() - 10s) history.pop_front();
    }
    EXPECT_GE(changes, 8);
    EXPECT_GE(risen * 10, changes * 8);
}

TEST(GsmSimulation, MovesWithinUmtsToACellThatWasShownInItsSets) {
    GsmSimulation modem(5);  // mostly in UMTS
    Played played(modem);
    std::size_t serving = 0;
    bool wasUmts = false;
    bool wasConnected = false;
    std::set<std::string> shown;
    int changes = 0;
    while (played.time() < 10min) {
        const auto code = played.next();
        const Phone& phone = modem.phone();
        const bool isUmts = phone.isOn(Rat::UMTS);
        if (isUmts && wasUmts && !wasConnected && phone.serving() != serving) {
            ++changes;
            EXPECT_TRUE(shown.contains(std::to_string(modem.network().umts[phone.serving()].scramblingCode)));
        }
        serving = phone.serving();
        wasUmts = isUmts;
        wasConnected = phone.link() == Link::Open;
        if (code != 0x4005 && code != 0xff0001) continue;
        if (played.rows("UMTS Cells/UMTS Set") > 0) shown.clear();
        for (std::size_t row = 0; row < played.rows("UMTS Cells/UMTS Set"); ++row) {
            shown.insert(played.text("UMTS Cells/UMTS Set/" + std::to_string(row) + "/Scrambling Code"));
        }
    }
    EXPECT_GE(changes, 3);
}

TEST(GsmSimulation, LeavesUmtsWhereItIsWeakAndComesBackWhereItIsGood) {
    GsmSimulation modem(2);
    std::optional<Rat> last;
    double worst = 0;  // of the last three seconds
    std::deque<std::pair<Time, double>> recent;
    int left = 0;
    int back = 0;
    watch(modem, 10min, [&](Time now) {
        const Phone& phone = modem.phone();
        if (!phone.isCamped()) return;
        if (last && *last != phone.rat() && now > 2s) {
            if (phone.rat() == Rat::GSM) {
                ++left;
                EXPECT_LT(worst, -13) << "at " << seconds(now);
            } else {
                ++back;
                EXPECT_GT(modem.air().ecNo(phone.serving()), -16) << "at " << seconds(now);
            }
        }
        last = phone.rat();
        if (phone.rat() == Rat::UMTS) recent.emplace_back(now, modem.air().ecNo(phone.serving()));
        while (!recent.empty() && recent.front().first < now - 3s) recent.pop_front();
        worst = 0;
        for (const auto& [time, ecNo] : recent) worst = std::min(worst, ecNo);
    });
    EXPECT_GE(left, 5);
    EXPECT_GE(back, 5);
}

TEST(GsmSimulation, KeepsUpToThreeCloseCellsInSoftHandover) {
    GsmSimulation modem(3);
    std::set<std::size_t> sizes;
    int strays = 0;
    int looks = 0;
    watch(modem, 10min, [&](Time) {
        const Phone& phone = modem.phone();
        if (!phone.isDedicated(Rat::UMTS)) return;
        const auto& members = phone.activeSet().members();
        sizes.insert(members.size());
        EXPECT_TRUE(phone.activeSet().contains(phone.serving()));
        EXPECT_EQ(std::set(members.begin(), members.end()).size(), members.size());
        const double best = modem.air().ecNo(phone.activeSet().best(modem.air()));
        ++looks;
        strays += std::ranges::any_of(
            members, [&](std::size_t sector) { return modem.air().ecNo(sector) < best - ActiveSet::kDropWindow - 2; });
    });
    EXPECT_EQ(sizes, (std::set<std::size_t>{1, 2, 3}));
    EXPECT_LT(strays * 10, looks);  // only until the time to trigger has passed
}

TEST(GsmSimulation, HoldsItsLevelsWhileThePhoneStands) {
    GsmSimulation modem(1);
    double driven = -1;
    double low = 0;
    double high = 0;
    Time since{0};
    double widest = 0;
    int stops = 0;
    std::optional<std::size_t> strongest;
    watch(modem, 10min, [&](Time now) {
        const double level = modem.air().gsmLevel(0);
        if (modem.air().gsm().driven() != driven) {
            driven = modem.air().gsm().driven();
            since = now;
            strongest.reset();
            return;
        }
        if (now - since < 2s) {  // until the readings' filter has settled
            low = high = level;
            return;
        }
        if (!strongest) ++stops;
        strongest = 0;
        low = std::min(low, level);
        high = std::max(high, level);
        widest = std::max(widest, high - low);
    });
    EXPECT_GE(stops, 3);
    EXPECT_LT(widest, 6);  // readings spread by 0.8 dB about the mean
    EXPECT_GT(widest, 0.5);
}

TEST(GsmSimulation, LoadsFasterAndCleanerWhereTheSignalIsGood) {
    double goodBits = 0, goodErrors = 0, goodBlocks = 1;
    double poorBits = 0, poorErrors = 0, poorBlocks = 1;
    for (std::uint64_t seed : {1U, 3U}) {
        GsmSimulation modem(seed);
        for (auto message = modem.next(); message.time < 6min; message = modem.next()) {
            if (message.bytes[5] != 0x21 || message.bytes[6] != 0x42) continue;
            const bool isGood = modem.air().ecNo(modem.phone().serving()) > -11;
            for (const HarqProcess& process : modem.drawn().hsdpa.primary) {
                (isGood ? goodBits : poorBits) += process.bits;
                (isGood ? goodErrors : poorErrors) += process.blockErrors;
                (isGood ? goodBlocks : poorBlocks) += process.newTransmissions;
                EXPECT_LE(process.bits, 14.4e6 * 2.02 / 6);
                EXPECT_LE(process.blockErrors, process.newTransmissions);
            }
        }
    }
    EXPECT_GT(goodBits / goodBlocks, 1.5 * poorBits / poorBlocks);
    EXPECT_GT(poorErrors / poorBlocks, 1.1 * goodErrors / goodBlocks);
    EXPECT_NEAR(goodErrors / goodBlocks, 0.1, 0.04);
}

TEST(BlockErrorRate, IsOneHalfAtMinus16dBAndFallsWithQuality) {
    EXPECT_DOUBLE_EQ(blockErrorRate(-16), 0.5);
    EXPECT_NEAR(blockErrorRate(-10.5), 0.01, 0.001);
    EXPECT_GT(blockErrorRate(-18), blockErrorRate(-14));
}

TEST(DataRate, IsShannonsBoundWithItsAttenuationUpToTheFastestCategory) {
    EXPECT_NEAR(dataRate(0), 0.6 * 3.84e6, 1);  // log2(1 + 1) = 1
    EXPECT_EQ(dataRate(60), 14.4e6);
}
