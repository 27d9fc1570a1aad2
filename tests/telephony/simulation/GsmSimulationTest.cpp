#include "telephony/simulation/GSMUMTS/Simulation.h"

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
    gsm::Simulation modem(seed);
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
void watch(gsm::Simulation& modem, Time until, Look look) {
    for (auto message = modem.next(); message.time < until; message = modem.next()) look(message.time);
}

}  // namespace

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
    gsm::Simulation modem(1);
    std::set<std::pair<Rat, std::size_t>> cells;
    std::set<int> areas;
    std::set<Activity> uses;
    int systemChanges = -1;
    std::optional<Rat> last;
    watch(modem, 3min, [&](Time) {
        const Modem& phone = modem.modem();
        if (!phone.isCamped()) return;
        cells.insert({phone.rat(), phone.serving()});
        areas.insert(phone.area().lac);
        uses.insert(phone.activity());
        if (last != phone.rat()) ++systemChanges;
        last = phone.rat();
    });
    EXPECT_GE(cells.size(), 6U);
    EXPECT_GE(areas.size(), 3U);
    EXPECT_EQ(uses.size(), 3U);
    EXPECT_GE(systemChanges, 3);
}

TEST(GsmSimulation, RegistersAgainSoonAfterEveryChangeOfArea) {
    gsm::Simulation modem(2);
    Time unregisteredSince{0};
    int changes = 0;
    Area before{};
    watch(modem, 10min, [&](Time now) {
        const Modem& phone = modem.modem();
        if (!phone.isCamped()) return;
        if (phone.area() != before) ++changes;
        before = phone.area();
        const bool isRegistered = phone.registration().registered() == phone.area();
        if (isRegistered || phone.activity() == Activity::Talking) unregisteredSince = now;
        ASSERT_LT(now - unregisteredSince, 3s) << "at " << seconds(now);
    });
    EXPECT_GT(changes, 12);
}

TEST(GsmSimulation, ShowsARegistrationInAllThreeProcesses) {
    gsm::Simulation modem(1);
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

TEST(GsmSimulation, LeavesUmtsWhereItIsWeakAndComesBackWhereItIsGood) {
    int left = 0;
    int back = 0;
    for (std::uint64_t seed : {2U, 3U}) {
        gsm::Simulation modem(seed);
        std::optional<Rat> last;
        double worst = 0;  // of the last three seconds
        std::deque<std::pair<Time, double>> recent;
        watch(modem, 10min, [&](Time now) {
            const Modem& phone = modem.modem();
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
    }
    EXPECT_GE(left, 5);
    EXPECT_GE(back, 5);
}

TEST(GsmSimulation, KeepsUpToThreeCloseCellsInSoftHandover) {
    gsm::Simulation modem(3);
    std::set<std::size_t> sizes;
    int strays = 0;
    int looks = 0;
    watch(modem, 10min, [&](Time) {
        const Modem& phone = modem.modem();
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

TEST(GsmSimulation, BeginsAConnectionInUmtsWithOneCell) {
    int openings = 0;
    int widenings = 0;
    for (std::uint64_t seed = 1; seed <= 4; ++seed) {
        gsm::Simulation modem(seed);
        std::optional<Time> opened;
        watch(modem, 10min, [&](Time now) {
            const Modem& phone = modem.modem();
            if (!phone.isDedicated(Rat::UMTS)) return opened.reset();
            if (!opened) {
                ++openings;
                opened = now;
            }
            const bool isWide = phone.activeSet().members().size() > 1;
            if (now - *opened < 320ms) {  // time to trigger of event 1A
                EXPECT_FALSE(isWide) << seed << " at " << seconds(now);
            } else if (now - *opened < 640ms) {
                widenings += isWide;
            }
        });
    }
    EXPECT_GE(openings, 20);
    EXPECT_GE(widenings, 4);
}

TEST(GsmSimulation, WaitsForItsTimesToTriggerAnewAfterEveryChangeOfState) {
    struct Phase {
        bool isCamped;
        Rat rat;
        Link link;
        bool isMoving;
        bool operator==(const Phase&) const = default;
    };
    int reselections[2] = {};  // GSM, UMTS
    for (std::uint64_t seed = 1; seed <= 6; ++seed) {
        gsm::Simulation modem(seed);
        std::optional<Phase> phase;
        std::size_t serving = 0;
        Time since{0};
        watch(modem, 10min, [&](Time now) {
            const Modem& phone = modem.modem();
            const RrState state = phone.rrState();
            const bool isMoving = state == RrState::CellReselection || state >= RrState::W2gHandover;
            const Phase next{phone.isCamped(), phone.rat(), phone.link(), isMoving};
            const bool isIdleUmts = phone.isOn(Rat::UMTS) && phone.link() != Link::Open;
            if (phase == next) {
                if (isIdleUmts && phone.serving() != serving) {
                    ++reselections[1];
                    EXPECT_GE(now - since, 1s) << seed << " at " << seconds(now);
                }
            } else if (phase && state == RrState::CellReselection) {
                ++reselections[0];
                EXPECT_GE(now - since, 5s) << seed << " at " << seconds(now);
            }
            if (phase != next) since = now;
            phase = next;
            serving = phone.serving();
        });
    }
    EXPECT_GE(reselections[0], 10);
    EXPECT_GE(reselections[1], 12);
}

TEST(GsmSimulation, CountsBlocksOverTheTimeInWhichItReceivedThem) {
    int returns = 0;
    int windows = 0;
    for (const std::uint64_t seed : {1, 2, 3, 21}) {  // the last comes back from GSM into a call
        gsm::Simulation modem(seed);
        bool isHandover = false;
        bool wasInUmtsCall = false;  // and not out of a connection since
        for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
            const Modem& phone = modem.modem();
            if (phone.link() != Link::Open) wasInUmtsCall = false;
            if (phone.isDedicated(Rat::UMTS)) {
                returns += wasInUmtsCall && isHandover;
                wasInUmtsCall = true;
            }
            isHandover = phone.rrState() == RrState::G2wHandover;
            const unsigned code = message.bytes[5] | message.bytes[6] << 8U;
            const int size = modem.lastReports().blockErrors.windowSize;
            if (code == 0x4116) {
                ++windows;
                EXPECT_TRUE(size == 30 || size == 200) << size << " frames, seed " << seed;
            }
            if (code != 0x4221) continue;
            EXPECT_EQ(modem.lastReports().hsdpa.subFrames, 5 * size);  // of 2 ms, not 10
        }
    }
    EXPECT_GE(windows, 200);
    EXPECT_GE(returns, 1) << "by handover into a call that had begun in UMTS";
}

TEST(GsmSimulation, SendsInAllSlotsButOneAtMost) {
    int whole = 0;
    int broken = 0;
    for (std::uint64_t seed = 1; seed <= 4; ++seed) {
        gsm::Simulation modem(seed);
        for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
            if (message.bytes[5] != 0x31 || message.bytes[6] != 0x40) continue;
            const auto& slots = modem.lastReports().transmitPower;
            const auto gaps = std::ranges::count_if(slots, [](const auto& slot) { return !slot; });
            ASSERT_EQ(slots.size(), 3U);
            ASSERT_LE(gaps, modem.modem().isMeasuringGsm() ? 1 : 0);
            ++(gaps == 0 ? whole : broken);
        }
    }
    EXPECT_GT(whole, broken);
    EXPECT_GE(broken, 4);
}

TEST(GsmSimulation, HoldsItsLevelsWhileThePhoneStands) {
    gsm::Simulation modem(1);
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
        gsm::Simulation modem(seed);
        for (auto message = modem.next(); message.time < 6min; message = modem.next()) {
            if (message.bytes[5] != 0x21 || message.bytes[6] != 0x42) continue;
            const bool isGood = modem.air().ecNo(modem.modem().serving()) > -11;
            for (const HarqProcess& process : modem.lastReports().hsdpa.primary) {
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
