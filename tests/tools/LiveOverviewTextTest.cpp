#include "tests/model/MonitoredModel.h"
#include "tools/OverviewText.h"
#include "tools/TrendBlocks.h"

namespace kelvo {
namespace {

using namespace std::chrono_literals;
using overview::LiveOverview;

std::string blanks(std::size_t count) { return std::string(count, ' '); }

TEST(TrendBlocks, AColumnIsThreeSecondsAndTheLastOneIsNow) {
    LiveOverview::Line line{.name = "RSRP", .unit = "dBm"};
    line.points = {{120s, -100}, {177s, -95}, {180s, -90.5}};
    EXPECT_EQ(trendBlocks(line, {}, 180s), blanks(19) + "▁" + blanks(18) + "▅█  -100 to -90 dBm");
    EXPECT_EQ(trendBlocks(line, {}, 181s), blanks(19) + "▁" + blanks(18) + "▅█  -100 to -90 dBm");
    EXPECT_EQ(trendBlocks(line, {}, 183s), blanks(18) + "▁" + blanks(18) + "▅█   -100 to -90 dBm");
}

TEST(TrendBlocks, ARangeHasAtLeastTenUnits) {
    LiveOverview::Line line{.name = "Ec/Io", .unit = "dB"};
    line.points = {{0s, -9}, {3s, -8}};
    EXPECT_EQ(trendBlocks(line, {}, 3s), blanks(38) + "▁▂  -10 to 0 dB");
    line.points = {{0s, -19}, {3s, 0}};
    EXPECT_EQ(trendBlocks(line, {}, 3s), blanks(38) + "▁█  -20 to 0 dB");
}

TEST(TrendBlocks, AnotherServingCellIsMarked) {
    LiveOverview::Line line{.name = "RSRP", .unit = {}};
    line.points = {{0s, 1}, {3s, 2}};
    EXPECT_EQ(trendBlocks(line, {{3s, "B"}}, 6s), blanks(37) + "▁│   0 to 10");
    EXPECT_EQ(trendBlocks({}, {{3s, "B"}}, 6s), "");
}

class LiveOverviewTextTest : public test::MonitoredModel {
protected:
    LiveOverviewTextTest() {
        model = std::make_unique<KelvoModel>(KelvoModel::Services{
            .queue = queue,
            .ports = ports,
            .telephony = telephony,
            .updateViewControllerFromModel = [this] { live->refreshed(); },
            .connectionChanged = [this] { live->connectionChanged(); },
        });
        live = std::make_unique<LiveOverview>(*model);
    }
    /// The serving cell in idle mode; levels in steps of a quarter from -140 dBm.
    static Bytes idle(std::uint32_t cell, std::uint32_t level) {
        return test::Record(0xB17F, 33).u16(17, 1300).u16(19, cell).u32(21, level | 80U << 18).bytes();
    }
    /// Cells around, from PCI 301 on, at -100 dBm.
    static Bytes around(std::uint32_t count) {
        test::Record record(0xB180, 21 + 20 * count);
        record.u16(17, 1300).u16(19, (count - 1) << 6);
        for (std::uint32_t i = 0; i < count; ++i) record.u32(21 + 20 * i, (301 + i) | 80U << 17);
        return record.bytes();
    }
    std::unique_ptr<LiveOverview> live;
};

TEST_F(LiveOverviewTextTest, SaysWhatACapturesSaysWithItsLines) {
    startLte();
    deliver(idle(84, 200));
    queue.advance(2s);
    queue.advance(5s);
    const std::vector<std::string> lines = LiveOverviewText(*live, true).lines();
    const std::vector<std::string> expected = {
        "LTE, idle",
        "  Cell            EARFCN 1300, PCI 84",
        "  RSRP            -90.00 dBm, good, 5 s ago",
        "                  " + blanks(38) + "▁   -90 to -80 dBm",
        "  RSRQ            -10.00 dB, excellent, 5 s ago",
        "                  " + blanks(38) + "▁   -10 to 0 dB",
        "  Band            3 (1815.0 MHz down, 1720.0 MHz up)",
        "What happened",
        "  1970-01-01T00:00:00.000Z  cell found  EARFCN 1300, PCI 84 (-90.00 dBm)",
    };
    EXPECT_EQ(lines, expected);
    EXPECT_EQ(LiveOverviewText(*live, false).lines()[3], "  RSRQ            -10.00 dB, excellent, 5 s ago");
}

TEST_F(LiveOverviewTextTest, WhatStandsBelowTheCellsStaysThere) {
    LiveOverviewText text(*live, false);
    const auto rowOfEvents = [&] {
        const auto lines = text.lines();
        return std::ranges::find(lines, "What happened") - lines.begin();
    };
    startLte();
    deliver(idle(84, 200));
    deliver(around(3));
    queue.advance(2s);
    EXPECT_EQ(text.lines()[6], "  Cell                    Level        Quality    To serving  Heard");
    EXPECT_EQ(text.lines()[7], "  EARFCN 1300, PCI 301    -100.00 dBm  -30.00 dB  -10.00 dB   0 s ago");
    EXPECT_EQ(rowOfEvents(), 10);
    queue.advance(50s);
    live->letPass();
    EXPECT_EQ(live->tracker().cells().size(), 0U);
    EXPECT_EQ(rowOfEvents(), 10);
}

}  // namespace
}  // namespace kelvo
