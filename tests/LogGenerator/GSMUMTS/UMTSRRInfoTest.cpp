#include "LogGenerator/GSMUMTS/UMTSRRInfo.h"

#include <gtest/gtest.h>

#include <cstdio>
#include <initializer_list>

#include "tests/support/CellArray.h"
#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

using test::cell;
using test::cellArray;

/// A record with one entry for each raw transmit power.
Record transmitPowers(std::initializer_list<std::uint32_t> powers) {
    Record record(0x4031, 16 + 14 * powers.size());
    record.u8(14, static_cast<std::uint32_t>(powers.size()));
    std::size_t at = 16 + 4;
    for (std::uint32_t power : powers) {
        record.u16(at, power);
        at += 14;
    }
    return record;
}

TEST(UMTSRRInfo, NamesTheRadioStates) {
    test::expectNames<UMTSRRInfo>(0x4125, 14, 13, "RRC State",
                                  {{0, "Disconnected"},
                                   {1, "Connecting"},
                                   {2, "CELL_FACH"},
                                   {3, "CELL_DCH"},
                                   {4, "CELL_PCH"},
                                   {5, "URA_PCH"},
                                   {6, "Unknown"},
                                   {255, "Unknown"}});
}

TEST(UMTSRRInfo, AveragesTheTransmitPowersThatAreThere) {
    Fed<UMTSRRInfo> section(Record(0x4031, 16 + 3 * 14)
                                .u8(14, 3)
                                .u16(16 + 4, 100)                                        // 61 - 70
                                .u16(16 + 2 * 14 + 4, static_cast<std::uint32_t>(-5)));  // 50 - 70
    EXPECT_EQ(section["Transmit Power"], "-14.50 dBm");
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSRRInfo"}}));
}

TEST(UMTSRRInfo, TruncatesATransmitPowerTowardZero) {
    Fed<UMTSRRInfo> section(Record(0x4031, 30).u8(14, 1).u16(20, static_cast<std::uint32_t>(-517)));  // -5 / 10
    EXPECT_EQ(section["Transmit Power"], "-70.00 dBm");
    section.feed(Record(0x4031, 58).u8(14, 3).u16(20, 100).u16(34, 100).u16(48, 110));  // -9, -9, -8
    EXPECT_EQ(section["Transmit Power"], "-8.67 dBm");
    section.feed(Record(0x4031, 30).u8(14, 1).u16(20, 750));  // 126 - 70
    EXPECT_EQ(section["Transmit Power"], "56.00 dBm");
}

TEST(UMTSRRInfo, RoundsATransmitPowerBetweenTwoHundredthsToTheEvenOne) {
    Fed<UMTSRRInfo> section;
    section.feed(transmitPowers({110, 110, 110, 110, 110, 110, 110, 100}));
    EXPECT_EQ(section["Transmit Power"], "-8.12 dBm");  // seven of -8 and one of -9: -8.125
    section.feed(transmitPowers({100, 100, 100, 100, 100, 100, 100, 110}));
    EXPECT_EQ(section["Transmit Power"], "-8.88 dBm");  // -8.875
}

TEST(UMTSRRInfo, ShowsNotANumberWhenNoTransmitPowerIsThere) {
    for (const Record& record : {Record(0x4031, 44).u8(14, 2), Record(0x4031, 16), Record(0x4031, 16).u8(14, 255)}) {
        Fed<UMTSRRInfo> section(record);
        EXPECT_EQ(section["Transmit Power"], "-nan dBm");  // on every processor
    }
}

TEST(UMTSRRInfo, ShowsTheCellsIdentityAndFrequenciesAsSigned) {
    Fed<UMTSRRInfo> section(Record(0x4127, 29).u32(13, 9612).u32(17, 10562).u32(21, 12345678).u16(25, 65535));
    EXPECT_EQ(section["Uplink Frequency"], "9612");
    EXPECT_EQ(section["Downlink Frequency"], "10562");
    EXPECT_EQ(section["Cell ID"], "12345678");
    EXPECT_EQ(section["URA ID"], "65535");
    EXPECT_EQ(test::keysOf(section.part()),
              (std::vector<std::string>{"Cell ID", "Downlink Frequency", "Uplink Frequency", "URA ID"}));
    section.feed(Record(0x4127, 29).u32(13, 0xFFFFFFFF).u32(17, 0xFFFFFFFE).u32(21, 0x80000000));
    EXPECT_EQ(section["Uplink Frequency"], "-1");
    EXPECT_EQ(section["Downlink Frequency"], "-2");
    EXPECT_EQ(section["Cell ID"], "-2147483648");
}

TEST(UMTSRRInfo, SaysWhetherTheConnectionIsCiphered) {
    test::expectNames<UMTSRRInfo>(0x4157, 19, 13, "Ciphering", {{0, "Disabled"}, {1, "Enabled"}, {255, "Enabled"}});
}

TEST(UMTSRRInfo, TakesTheFirstServingUmtsCellOfTheCellArray) {
    Fed<UMTSRRInfo> section(cellArray({
        cell("GSM", "Serving", {{"kPLCellMonitorCellId", 1}}),
        cell("UMTS", "Neighbor", {{"kPLCellMonitorCellId", 2}}),
        cell("UMTS", "Serving",
             {{"kPLCellMonitorCellId", 12345678}, {"kPLCellMonitorUARFCN", 10562}, {"kPLCellMonitorSCN", 301}}),
        cell("UMTS", "Serving", {{"kPLCellMonitorCellId", 3}}),
    }));
    EXPECT_EQ(section["Cell ID"], "12345678");
    EXPECT_EQ(section["UARFCN"], "10562");
    EXPECT_EQ(section["Scrambling Code"], "301");
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSRRInfo"}}));
}

TEST(UMTSRRInfo, TakesNothingFromASecondServingCell) {
    Fed<UMTSRRInfo> section(cellArray({
        cell("UMTS", "Serving", {{"kPLCellMonitorSCN", 301}}),
        cell("UMTS", "Serving", {{"kPLCellMonitorCellId", 3}, {"kPLCellMonitorUARFCN", 4}, {"kPLCellMonitorSCN", 5}}),
    }));
    EXPECT_EQ(section.part(), Value(Dictionary::make({{"Scrambling Code", "301"}})));
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSRRInfo"},
                                    {3, "UMTSRRInfo: Failed to retrieve Cell ID\n"},
                                    {3, "UMTSRRInfo: Failed to retrieve UARFCN\n"}}));
}

TEST(UMTSRRInfo, KeepsTheValuesThatALaterCellLacks) {
    Fed<UMTSRRInfo> section(cellArray(
        {cell("UMTS", "Serving",
              {{"kPLCellMonitorCellId", 12345678}, {"kPLCellMonitorUARFCN", 10562}, {"kPLCellMonitorSCN", 301}})}));
    section.clearLog();
    section.feed(cellArray({cell("UMTS", "Serving", {{"kPLCellMonitorUARFCN", 10563}})}));
    EXPECT_EQ(section["Cell ID"], "12345678");
    EXPECT_EQ(section["UARFCN"], "10563");
    EXPECT_EQ(section["Scrambling Code"], "301");
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSRRInfo"},
                                    {3, "UMTSRRInfo: Failed to retrieve Cell ID\n"},
                                    {3, "UMTSRRInfo: Failed to retrieve Scrambling Code\n"}}));
}

TEST(UMTSRRInfo, TakesItsOwnFrequenciesOverTheCellArraysUarfcn) {
    Fed<UMTSRRInfo> section(
        cellArray({cell("UMTS", "Serving", {{"kPLCellMonitorUARFCN", 10562}, {"kPLCellMonitorSCN", 301}})}));
    ASSERT_EQ(section["UARFCN"], "10562");
    section.feed(Record(0x4127, 28));
    ASSERT_EQ(section["UARFCN"], "10562");
    section.feed(Record(0x4127, 29));
    EXPECT_EQ(section["UARFCN"], "(absent)");
    EXPECT_EQ(section["Scrambling Code"], "301");
}

TEST(UMTSRRInfo, SaysWhichValueTheServingCellLacks) {
    Fed<UMTSRRInfo> section(cellArray({cell("UMTS", "Serving")}));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSRRInfo"},
                                    {3, "UMTSRRInfo: Failed to retrieve Cell ID\n"},
                                    {3, "UMTSRRInfo: Failed to retrieve UARFCN\n"},
                                    {3, "UMTSRRInfo: Failed to retrieve Scrambling Code\n"}}));
}

TEST(UMTSRRInfo, ChangesNothingWithoutAServingUmtsCell) {
    Fed<UMTSRRInfo> section(cellArray({}));
    section.feed(cellArray({cell("UMTS", "Neighbor"), cell("LTE", "Serving")}));
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSRRInfo"}, {4, "UMTSRRInfo"}}));
    section.clearLog();
    section.feed(Record(0xff0001, 20));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, "UMTSRRInfo"},
                                    {3, "Cell Info Array data could not be constructed"},
                                    {3, "Failed to get Cell Array\n"}}));
}

TEST(UMTSRRInfo, IgnoresShortRecordsAndReportsACodeOfOthers) {
    Fed<UMTSRRInfo> section(Record(0x4125, 13));
    section.feed(Record(0x4031, 15));
    section.feed(Record(0x4127, 28));
    section.feed(Record(0x4157, 18));
    EXPECT_EQ(section.log(), (Lines(4, {4, "UMTSRRInfo"})));
    section.feed(Record(0x4005, 40));
    EXPECT_EQ(section.log().back(), Lines::value_type(3, "Received an unknown log message: 16389"));
    EXPECT_TRUE(section.part().dictionary()->empty());
}

}  // namespace
}  // namespace kelvo
