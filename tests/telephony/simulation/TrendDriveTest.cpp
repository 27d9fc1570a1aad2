#include <gtest/gtest.h>

#include <map>

#include "model/Trends.h"
#include "telephony/simulation/LTE/Simulation.h"
#include "tests/telephony/simulation/Played.h"

using namespace kelvo;
using namespace kelvo::simulation;
using namespace kelvo::test;
using namespace std::chrono_literals;

namespace {

/// What the simulated modem said it measured, as of the last record that tells of it.
struct Told {
    double serving = 0;
    bool anything = false;
    std::map<int, double> neighbors;  // by cell, on the serving cell's channel
    int channel = 0;
};

}  // namespace

// Minutes of a drive, refreshed every two seconds: each point of a trend is the level that the modem's own world
// had when it sent the record, to the record's steps, and a neighbor's stays with its cell.
TEST(TrendDrive, HasTheNumbersThatTheSimulatorSent) {
    lte::Simulation modem(1);
    Played played(modem);
    Trends trends;
    Told told;
    std::map<Trends::Time, double> serving;
    std::map<std::string, std::map<Trends::Time, double>> neighbors;
    std::vector<TrendChange> cells;
    std::string cell;    // that serves, as the records told
    std::string marked;  // as of the refresh before
    for (Time refresh = 2s; refresh <= 400s; refresh += 2s) {
        while (played.time() < refresh) {
            const std::uint32_t code = played.next();
            if (code == 0xB0C2) cell = "PCI " + std::to_string(static_cast<int>(modem.modem().serving().pci));
            if (code != 0xB179) continue;
            told = {.serving = modem.modem().reading().filteredRsrp, .anything = true, .neighbors = {}, .channel = 0};
            told.channel = modem.modem().serving().carrier.downlink;
            for (const auto& each : modem.modem().neighbors())
                told.neighbors[static_cast<int>(each.pci)] = each.reading.filteredRsrp;
        }
        const auto now = std::chrono::duration_cast<Trends::Time>(refresh);
        trends.note(played.refresh(), now);
        if (!marked.empty() && cell != marked) cells.push_back({now, cell});
        marked = cell;
        if (!told.anything) continue;
        serving[now] = told.serving;
        for (const auto& [pci, level] : told.neighbors) {
            neighbors["PCI " + std::to_string(pci) + ", EARFCN " + std::to_string(told.channel)][now] = level;
        }
    }

    constexpr double kStep = 0.25;
    const auto compare = [&](const std::string& name, const std::map<Trends::Time, double>& truth) {
        const Trend trend = trends.trend(name);
        EXPECT_EQ(trend.unit, "dBm") << name;
        ASSERT_EQ(trend.points.size(), truth.size()) << name;
        for (const Trend::Point& point : trend.points) {
            ASSERT_TRUE(truth.contains(point.at)) << name;
            EXPECT_NEAR(point.number, truth.at(point.at), kStep / 2 + 1e-9) << name << " at " << point.at.count();
        }
    };
    EXPECT_GT(serving.size(), 100U);
    compare("/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP", serving);
    EXPECT_GT(neighbors.size(), 5U);
    for (const auto& [name, truth] : neighbors) compare("/Measured Neighbor Cells/" + name + "/Filtered RSRP", truth);
    EXPECT_GT(cells.size(), 2U);
    EXPECT_EQ(trends.servingCells(), cells);
    EXPECT_LT(trends.bytes(), 256U * 1024);
}
