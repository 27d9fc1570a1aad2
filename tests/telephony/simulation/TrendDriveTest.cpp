#include <gtest/gtest.h>

#include <map>

#include "model/Trends.h"
#include "telephony/simulation/IFX/Simulation.h"
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

using Truth = std::map<std::string, std::map<Trends::Time, double>>;  // by the trend's name

/// Every trend that the world knows is there, with the world's numbers to the step in which they are sent.
void expectTruth(const Trends& trends, const Truth& truth, std::string_view unit, double step) {
    for (const auto& [name, numbers] : truth) {
        const Trend trend = trends.trend(name);
        EXPECT_EQ(trend.unit, unit) << name;
        ASSERT_EQ(trend.points.size(), numbers.size()) << name;
        for (const Trend::Point& point : trend.points) {
            ASSERT_TRUE(numbers.contains(point.at)) << name;
            EXPECT_NEAR(point.number, numbers.at(point.at), step / 2 + 1e-9) << name << " at " << point.at.count();
        }
    }
}

}  // namespace

// Minutes of a drive, refreshed every two seconds: each point of a trend is the level that the modem's own world
// had when it sent the record, to the record's steps, and a neighbor's stays with its cell.
TEST(TrendDrive, HasTheNumbersThatTheSimulatorSent) {
    lte::Simulation modem(1);
    Played played(modem);
    Trends trends;
    Told told;
    const std::string servingLevel = "/Connected mode LTE Intra-frequency Measurement/Serving Filtered RSRP";
    Truth levels;
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
        levels[servingLevel][now] = told.serving;
        for (const auto& [pci, level] : told.neighbors) {
            levels["/Measured Neighbor Cells/PCI " + std::to_string(pci) + ", EARFCN " + std::to_string(told.channel) +
                   "/Filtered RSRP"][now] = level;
        }
    }

    EXPECT_GT(levels[servingLevel].size(), 100U);
    EXPECT_GT(levels.size(), 6U);
    expectTruth(trends, levels, "dBm", 0.25);
    EXPECT_GT(cells.size(), 2U);
    EXPECT_EQ(trends.servingCells(), cells);
    EXPECT_LT(trends.bytes(), 256U * 1024);
}

// The same of a cell monitor, which sends texts alone: on GSM and on UMTS, with what a connection reports.
TEST(TrendDrive, HasTheNumbersOfACellMonitorsTexts) {
    ifx::Simulation modem(1);
    Played played(modem);
    Trends trends;
    Truth levels;     // dBm
    Truth qualities;  // dB
    std::vector<TrendChange> cells;
    int marked = 0;  // the cell that served at the refresh before
    const auto inList = [](const char* list, const std::string& cell, const char* key) {
        return std::string("/Neighbours/") + list + "/" + cell + "/" + key;
    };
    for (Time refresh = 2s; refresh <= 600s; refresh += 2s) {
        while (played.time() < refresh) played.next();
        const auto now = std::chrono::duration_cast<Trends::Time>(refresh);
        trends.note(played.refresh(), now);
        const ifx::Status& status = modem.modem().status();
        const bool isGsm = status.access == ifx::RadioAccess::Gsm;
        if (status.access == ifx::RadioAccess::None) continue;
        if (isGsm) {
            levels["/Serving/RSSI"][now] = status.rssi;
        } else {
            levels["/Serving/RSCP"][now] = status.rscp;
            qualities["/Serving/ECN0"][now] = status.ecN0;
        }
        for (const auto& each : status.gsm) {
            const ifx::GsmCell& cell = modem.network().gsmCells[each.sector];
            std::string name = "ARFCN " + std::to_string(static_cast<int>(cell.arfcn));
            if (each.identified) name += ", BSIC " + std::to_string(static_cast<int>(cell.bsic));
            if (each.measured) levels[inList("GSM", name, "RSSI")][now] = each.rssi;
        }
        for (const auto& each : status.umts) {
            const int code = modem.network().umtsCells[each.sector].scramblingCode;
            levels[inList("UMTS", "PSC " + std::to_string(code), "RSCP")][now] = each.rscp;
            qualities[inList("UMTS", "PSC " + std::to_string(code), "ECN0")][now] = each.ecN0;
        }
        if (status.connection != ifx::Connection::Idle) levels["/Connection/TxPower"][now] = status.tx;
        const int cell =
            isGsm ? modem.network().gsmCells[status.serving].cellId : modem.network().umtsCells[status.serving].cellId;
        if (marked != 0 && cell != marked) cells.push_back({now, "cell " + std::to_string(cell)});
        marked = cell;
    }
    EXPECT_GT(levels["/Serving/RSSI"].size(), 20U);
    EXPECT_GT(levels["/Serving/RSCP"].size(), 20U);
    EXPECT_GT(levels["/Connection/TxPower"].size(), 20U);
    EXPECT_GT(levels.size(), 20U);
    expectTruth(trends, levels, "dBm", 1);
    expectTruth(trends, qualities, "dB", 0.5);
    EXPECT_GT(cells.size(), 2U);
    EXPECT_EQ(trends.servingCells(), cells);
    EXPECT_TRUE(trends.trend("/Serving/LAC").points.empty());
}
