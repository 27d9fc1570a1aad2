#include "LogGenerator/GSMUMTS/ActiveSet.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

/// A searcher record of `cells` cells, its raw received power as given.
Record searcher(std::uint32_t cells, int power) {
    return Record(0x417a, 16 + cells * (15 + 44)).u16(13, static_cast<std::uint32_t>(power)).u8(15, cells);
}

/// Scrambling code and set type of cell `index`.
constexpr std::size_t cellAt(std::size_t index) { return 16 + 15 * index + 7; }
constexpr std::uint32_t cell(std::uint32_t scramblingCode, std::uint32_t setType) {
    return scramblingCode | setType << 13;
}

/// Where the energies of cell `index` of `cells` stand.
constexpr std::size_t energyAt(std::size_t index, std::size_t cells) { return 16 + 15 * cells + 44 * index + 32; }

Value row(const char* code, const char* rscp, const char* energy) {
    return Dictionary::make({{"Scrambling Code", code}, {"RSCP", rscp}, {"Energy Per Chip", energy}});
}

TEST(ActiveSet, ShowsLevelAndEnergyOfACell) {
    Fed<ActiveSet> section(Array::make());
    section.feed(searcher(1, -700).u16(cellAt(0), cell(301, 0)).u32(energyAt(0, 1), 90000));  // -8 dB
    EXPECT_EQ(section.part(), Value(Array::make({row("301", "-132 dB", "-8 dB")})));
    EXPECT_EQ(test::keysOf((*section.part().array())[0]),
              (std::vector<std::string>{"Scrambling Code", "RSCP", "Energy Per Chip"}));
    EXPECT_EQ(section.log(), (Lines{{4, "ActiveSet"}}));
}

TEST(ActiveSet, TruncatesTheReceivedPowerTowardZero) {
    Fed<ActiveSet> section(Array::make());
    section.feed(searcher(1, -517));  // -5 / 10
    EXPECT_EQ(section.row(0, "RSCP"), "-106 dB");
    section.feed(searcher(1, -503));  // 9 / 10
    EXPECT_EQ(section.row(0, "RSCP"), "-106 dB");
    section.feed(searcher(1, -32768));
    EXPECT_EQ(section.row(0, "RSCP"), "-3331 dB");
}

TEST(ActiveSet, TakesTheFirstEnergyThatIsThere) {
    Fed<ActiveSet> section(Array::make());
    section.feed(searcher(4, -512)
                     .u16(cellAt(0), cell(1, 0))
                     .u32(energyAt(0, 4), 420000)  // -1 dB
                     .u32(energyAt(0, 4) + 4, 90000)
                     .u16(cellAt(1), cell(2, 0))
                     .u32(energyAt(1, 4) + 4, 300000)  // -3 dB
                     .u32(energyAt(1, 4) + 8, 90000)
                     .u16(cellAt(2), cell(3, 0))
                     .u32(energyAt(2, 4) + 8, 4462)  // -21 dB
                     .u16(cellAt(3), cell(4, 0)));   // none
    EXPECT_EQ(section.part(), Value(Array::make({row("1", "-107 dB", "-1 dB"), row("2", "-109 dB", "-3 dB"),
                                                 row("3", "-127 dB", "-21 dB"), row("4", "-106 dB", "0 dB")})));
}

TEST(ActiveSet, LeavesOutCellsOfOtherSets) {
    Record record = searcher(8, -512);
    for (std::uint32_t i = 0; i < 8; ++i) record.u16(cellAt(i), cell(8191 - i, i));
    record.u16(cellAt(5), cell(77, 0));
    Fed<ActiveSet> section(Array::make());
    section.feed(record);
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(0, "Scrambling Code"), "8191");
    EXPECT_EQ(section.row(1, "Scrambling Code"), "77");
}

TEST(ActiveSet, ReadsMeasurementsBehindAllCellsOfAnySet) {
    Fed<ActiveSet> section(Array::make());
    section.feed(searcher(2, -512)
                     .u16(cellAt(0), cell(5, 1))
                     .u32(energyAt(0, 2), 90000)
                     .u16(cellAt(1), cell(6, 0))
                     .u32(energyAt(1, 2), 420000));
    EXPECT_EQ(section.part(), Value(Array::make({row("6", "-107 dB", "-1 dB")})));
}

TEST(ActiveSet, IsEmptiedByARecordWithoutCellsAndFillsAgain) {
    Fed<ActiveSet> section(Array::make());
    section.feed(searcher(3, 0));
    EXPECT_EQ(section.rowCount(), 3U);
    section.feed(searcher(0, 0));
    EXPECT_EQ(section.rowCount(), 0U);
    section.feed(searcher(2, 0));
    EXPECT_EQ(section.rowCount(), 2U);
}

TEST(ActiveSet, MakesUpNoCellsBeyondTheEnd) {
    Fed<ActiveSet> section(Array::make());
    section.feed(Record(0x417a, 16 + 2 * 15).u8(15, 255).u16(cellAt(0), 1).u16(cellAt(1), 2));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(1, "Energy Per Chip"), "0 dB");
}

TEST(ActiveSet, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<ActiveSet> section(Array::make({"row"}));
    section.feed(Record(0x417a, 15));
    section.feed(Record(0x4005, 40));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log(),
              (Lines{{4, "ActiveSet"}, {4, "ActiveSet"}, {3, "Received an unknown log message: 16389"}}));
}

}  // namespace
}  // namespace kelvo
