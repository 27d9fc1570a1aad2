#include "telephony/simulation/UTRAN/Simulation.h"

#include <gtest/gtest.h>

#include <map>
#include <set>

#include "tests/telephony/simulation/Sightings.h"
#include "tests/telephony/simulation/Standing.h"
#include "tests/telephony/simulation/UtranShown.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::simulation::utran;
using namespace kelvo::test;
using namespace std::chrono_literals;

TEST(UtranSimulation, ShowsTheWorldItPlays) {
    utran::Simulation modem(1);
    Played played(modem);
    UtranShown shown(played, modem.modem());
    do {
        played.clearLog();
        const std::uint32_t code = played.next();
        shown.compare(code);
        for (const auto& [level, text] : played.log()) EXPECT_NE(level, 3) << text;
        ASSERT_FALSE(HasFailure()) << "after " << seconds(played.time()) << " s, record " << std::hex << code;
    } while (played.time() < 10min);
}

TEST(UtranSimulation, SendsEveryRecordThatTheApplicationAsksFor) {
    utran::Simulation modem(3);
    std::map<std::uint32_t, int> counts;
    std::set<std::uint32_t> codes;  // of the first four minutes
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        const auto& bytes = message.bytes;
        const std::uint32_t code = (bytes[5] | bytes[6] << 8U) | (bytes[2] == 255 ? 0xff0000U : 0U);
        if (message.time < 4min) codes.insert(code);
        ++counts[code];
    }
    EXPECT_EQ(codes, codesAskedFor(Technology::UTRAN));
    EXPECT_TRUE(between(counts[0xD0E0], 3000, 3300)) << counts[0xD0E0];  // 5 a second and with each change
    EXPECT_TRUE(between(counts[0xD0E2], 600, 700)) << counts[0xD0E2];    // each second and with each change
    EXPECT_EQ(counts[0xD00A], 625);                                      // every 960 ms
    EXPECT_EQ(counts[0xD00E], 625);
    EXPECT_TRUE(between(counts[0xD00C], 120, 500)) << counts[0xD00C];    // as often with a dedicated channel
    EXPECT_TRUE(between(counts[0xFF0000], 10, 40)) << counts[0xFF0000];  // every minute and with each area
    EXPECT_TRUE(between(counts[0xFF0001], 35, 80)) << counts[0xFF0001];  // every 20 s and with each cell
    EXPECT_TRUE(between(counts[0xFF0002], 20, 70)) << counts[0xFF0002];  // every 30 s and with each change
    EXPECT_EQ(counts.size(), 8U);
}

TEST(UtranSimulation, FillsEveryScreenWithinTwoSeconds) {
    utran::Simulation modem(1);
    Played played(modem);
    while (played.time() < 2s) played.next();
    for (const char* list : {"Neighbor Cell List", "TRCH BLER", "CCTRCH SIR", "PDP Context Info"}) {
        EXPECT_GT(played.rows(list), 0U) << list;
    }
    for (const char* value : {"RRC Info/State", "Serving Cell Info/Cell ID", "Serving Cell Info/Local Area Code",
                              "Serving Cell Info/Cell Scrambling Code", "SIM Info/EF-ICCID"}) {
        EXPECT_NE(played.text(value), "–") << value;
    }
}

TEST(UtranSimulation, HasALivelyFirstThreeMinutesInLittleSpace) {
    utran::Simulation modem(1);
    Played played(modem);
    std::set<std::string> seen;
    std::set<std::size_t> sizes;
    Reported<std::size_t> serving;
    int cells = -1;  // the first is no change
    while (played.time() < 3min) {
        played.next();
        cells += serving.isDue(played.time(), modem.modem().servingIndex());
        for (const char* value : {"RRC Info/State", "Serving Cell Info/Allowed Access", "Neighbor Cell List/0/Status",
                                  "Neighbor Cell List/1/Status", "Neighbor Cell List/2/Status",
                                  "Neighbor Cell List/1/inJDCS", "Serving Cell Info/Local Area Code"}) {
            seen.insert(played.text(value));
        }
        sizes.insert(played.rows("Neighbor Cell List"));
    }
    EXPECT_GE(cells, 3);
    EXPECT_GE(sizes.size(), 3U);
    EXPECT_EQ(played.rows("GSM Neighbor Cell List"), 0U);
    for (const char* text :
         {"Disconnected", "Connecting", "Cell Fach", "Cell DCH", "Cell PCH", "Cell URA PCH", "All Calls",
          "Emergency Calls Only", "ASET", "MSET", "DSET", "TRUE", "FALSE", "2101", "2102"}) {
        EXPECT_TRUE(seen.contains(text)) << text;
    }
    EXPECT_LT(captureBytes<utran::Simulation>(1, 3min), 180U * 1024);
}

TEST(UtranSimulation, GoesOnlyToCellsThatItHasShownBeforeAndThatCameCloser) {
    utran::Simulation modem(2);
    Played played(modem);
    Sightings sightings;
    int serving = modem.modem().serving().parameterId;
    while (played.time() < 10min) {
        const auto code = played.next();
        if (modem.modem().serving().parameterId != serving) {
            serving = modem.modem().serving().parameterId;
            ASSERT_NO_FATAL_FAILURE(sightings.goTo(serving, played.time()));
        }
        if (code != 0xD00A) continue;
        EXPECT_EQ(played.number("Neighbor Cell List/0/Cell ID"), serving);
        const double own = 256 * played.number("Neighbor Cell List/0/Filter RSCP");
        for (std::size_t i = 1; i < played.rows("Neighbor Cell List"); ++i) {
            const std::string row = "Neighbor Cell List/" + std::to_string(i);
            const int cell = static_cast<int>(played.number(row + "/Cell ID"));
            sightings.see(cell, played.time(), 256 * played.number(row + "/Filter RSCP") - own);
        }
    }
    EXPECT_GE(sightings.changes(), 12);
    EXPECT_GE(sightings.risen(), sightings.changes() * 3 / 4) << sightings.changes();
}

TEST(UtranSimulation, MayOnlyCallForHelpUntilItIsRegistered) {
    utran::Simulation modem(4);
    const Modem& world = modem.modem();
    Time since = 0s;
    int registrations = 0;
    int last = world.registeredArea();
    Reported<std::size_t> serving;
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        const bool hasMoved = serving.isDue(message.time, world.servingIndex());
        if (world.isRegistered() || hasMoved) since = message.time;
        ASSERT_LE(message.time - since, 3s);
        if (world.registeredArea() == last) continue;
        last = world.registeredArea();
        EXPECT_TRUE(world.rrcState() == RrcState::CellFach || world.rrcState() == RrcState::CellDch);
        ++registrations;
    }
    EXPECT_GE(registrations, 4);
}

TEST(UtranSimulation, GoesThroughTheStatesOfAConnectionInTheirOrder) {
    utran::Simulation modem(2);
    using enum RrcState;
    const std::set<std::pair<RrcState, RrcState>> allowed = {
        {Disconnected, Connecting}, {Connecting, CellDch}, {Connecting, CellFach}, {CellDch, CellFach},
        {CellDch, Disconnected},    {CellFach, CellDch},   {CellFach, CellPch},    {CellFach, Disconnected},
        {CellPch, UraPch},          {CellPch, CellFach},   {UraPch, Disconnected}, {UraPch, CellFach}};
    RrcState last = Disconnected;
    int changes = 0;
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        const RrcState state = modem.modem().rrcState();
        EXPECT_EQ(modem.modem().transportChannels().empty() || state == CellDch, true);
        if (state == last) continue;
        EXPECT_TRUE(allowed.contains({last, state})) << static_cast<int>(last) << " " << static_cast<int>(state);
        last = state;
        ++changes;
    }
    EXPECT_GE(changes, 60);
}

TEST(UtranSimulation, HasMoreBlockErrorsWhereInterferenceIsStronger) {
    utran::Simulation modem(1);
    double good = 0;
    double bad = 0;
    int goods = 0;
    int bads = 0;
    for (auto message = modem.next(); message.time < 10min; message = modem.next()) {
        const Modem& world = modem.modem();
        if (!world.hasMeasured() || world.composites().empty() || world.composites()[0].timeslots != 3) continue;
        const double sir = *world.composites()[0].sir[5];
        (sir >= 9.5 ? good : bad) += world.transportChannels()[0].blockErrors;
        ++(sir >= 9.5 ? goods : bads);
    }
    ASSERT_GT(goods, 20);
    ASSERT_GT(bads, 5);
    EXPECT_LT(good / goods, 0.05);
    EXPECT_GT(bad / bads, 1.5 * good / goods);
}

TEST(UtranSimulation, KeepsTheLevelWhileThePhoneStands) {
    utran::Simulation modem(1);
    const Modem& world = modem.modem();
    const int steady = checkStanding(modem, 6s, [&](double level) {  // until then the filter still remembers the road
        EXPECT_NEAR(world.measurements()[0].rscp, level, 5);
    });
    EXPECT_GT(steady, 100);
}
