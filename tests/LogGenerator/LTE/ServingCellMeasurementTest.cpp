#include "LogGenerator/LTE/ServingCellMeasurement.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr std::uint32_t bits(std::uint32_t value, int low) { return value << low; }

TEST(ServingCellMeasurement, ShowsEveryField) {
    Fed<ServingCellMeasurement> section(
        Record(0xB17F, 33)
            .u8(13, 3)
            .u16(17, 2075)
            .u16(19, bits(301, 0) | bits(5, 9))
            .u32(21, bits(123, 0) | bits(125, 9) | bits(76, 18) | bits(81, 25))
            .u32(25, bits(115, 0) | bits(8, 9) | bits(53, 15) | bits(54, 22))
            .u32(29, bits(40, 0) | bits(3, 7) | bits(31, 13) | bits(4, 19) | bits(1, 25) | bits(9, 26)));
    EXPECT_EQ(section["Version"], "3");
    EXPECT_EQ(section["E-ARFCN"], "2075");
    EXPECT_EQ(section["Physical Cell ID"], "301");
    EXPECT_EQ(section["Serving Layer Priority"], "5");
    EXPECT_EQ(section["Measured RSRP"], "-109.25 dBm");
    EXPECT_EQ(section["Average RSRP"], "-108.75 dBm");
    EXPECT_EQ(section["Measured RSRQ"], "-11.00 dB");
    EXPECT_EQ(section["Average RSRQ"], "-9.75 dB");
    EXPECT_EQ(section["Measured RSSI"], "-82.50 dBm");
    EXPECT_EQ(section["Qrxlevmin"], "-124 dBm");
    EXPECT_EQ(section["P_Max"], "23 dBm");
    EXPECT_EQ(section["Max UE Tx Power"], "24 dBm");
    EXPECT_EQ(section["Srxlev"], "10 dBm");
    EXPECT_EQ(section["Num of Consecutive DRX Cycles of S < 0"], "3");
    EXPECT_EQ(section["S Intra Search"], "62 dB");
    EXPECT_EQ(section["S Non Intra Search"], "8 dBm");
    EXPECT_EQ(section["Measurement Rules Updated"], "True");
    EXPECT_EQ(section["Measurement Rules"], "9");
    EXPECT_EQ(test::keysOf(section.part()),
              (std::vector<std::string>{"Version", "E-ARFCN", "Physical Cell ID", "Serving Layer Priority",
                                        "Measured RSRP", "Average RSRP", "Measured RSRQ", "Average RSRQ",
                                        "Measured RSSI", "Qrxlevmin", "P_Max", "Max UE Tx Power", "Srxlev",
                                        "Num of Consecutive DRX Cycles of S < 0", "S Intra Search",
                                        "S Non Intra Search", "Measurement Rules Updated", "Measurement Rules"}));
    EXPECT_EQ(section.log(), (Lines{{4, "Serving Cell Measurements"}}));
}

TEST(ServingCellMeasurement, ShowsTheLowestValuesOfAnEmptyRecord) {
    Fed<ServingCellMeasurement> section(Record(0xB17F, 33));
    EXPECT_EQ(section["Measured RSRP"], "-140.00 dBm");
    EXPECT_EQ(section["Average RSRP"], "-140.00 dBm");
    EXPECT_EQ(section["Measured RSRQ"], "-30.00 dB");
    EXPECT_EQ(section["Measured RSSI"], "-140.00 dBm");
    EXPECT_EQ(section["Qrxlevmin"], "-140 dBm");
    EXPECT_EQ(section["P_Max"], "-30 dBm");
    EXPECT_EQ(section["Srxlev"], "-30 dBm");
    EXPECT_EQ(section["Measurement Rules Updated"], "False");
}

TEST(ServingCellMeasurement, KeepsNeighboringBitFieldsApart) {
    Fed<ServingCellMeasurement> section(
        Record(0xB17F, 33).u16(19, 0xFFFF).u32(21, 0xFFFFFFFF).u32(25, 0xFFFFFFFF).u32(29, 0xFFFFFFFF));
    EXPECT_EQ(section["Physical Cell ID"], "511");
    EXPECT_EQ(section["Serving Layer Priority"], "15");
    EXPECT_EQ(section["Measured RSRP"], "-12.25 dBm");
    EXPECT_EQ(section["Average RSRP"], "-12.25 dBm");
    EXPECT_EQ(section["Measured RSRQ"], "1.75 dB");
    EXPECT_EQ(section["Average RSRQ"], "1.75 dB");
    EXPECT_EQ(section["Measured RSSI"], "115.50 dBm");
    EXPECT_EQ(section["Qrxlevmin"], "-14 dBm");
    EXPECT_EQ(section["P_Max"], "97 dBm");
    EXPECT_EQ(section["Max UE Tx Power"], "33 dBm");
    EXPECT_EQ(section["Srxlev"], "97 dBm");
    EXPECT_EQ(section["Num of Consecutive DRX Cycles of S < 0"], "63");
    EXPECT_EQ(section["S Intra Search"], "126 dB");
    EXPECT_EQ(section["S Non Intra Search"], "126 dBm");
    EXPECT_EQ(section["Measurement Rules"], "15");
}

TEST(ServingCellMeasurement, SaysWhatTheNetworkDoesNotSend) {
    Fed<ServingCellMeasurement> section(Record(0xB17F, 33).u32(25, bits(64, 15)).u32(29, bits(32, 13) | bits(32, 19)));
    EXPECT_EQ(section["P_Max"], "Not Present");
    EXPECT_EQ(section["S Intra Search"], "Not Present");
    EXPECT_EQ(section["S Non Intra Search"], "Not Present");
}

TEST(ServingCellMeasurement, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<ServingCellMeasurement> section(Record(0xB17F, 32).u8(13, 3));
    section.feed(Record(0xB17E, 40));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, "Serving Cell Measurements"},
                                    {4, "Serving Cell Measurements"},
                                    {3, "Received an unknown log message: 45438"}}));
}

}  // namespace
}  // namespace kelvo
