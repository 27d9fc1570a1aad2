#include "LogGenerator/LTE/ConnectedModeMeasurementMisc.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "Connected mode LTE Intra-frequency Measurement";

TEST(ConnectedModeMeasurementMisc, ShowsEveryField) {
    Fed<ConnectedModeMeasurementMisc> section(
        Record(0xB179, 29).u16(17, 2075).u16(19, 112).u16(21, 9871).u16(23, 123).u16(25, 77));
    EXPECT_EQ(section["E-ARFCN"], "2075");
    EXPECT_EQ(section["Serving Physical Cell ID"], "112");
    EXPECT_EQ(section["Subframe Number"], "9871");
    EXPECT_EQ(section["Serving Filtered RSRP"], "-109.25 dBm");
    EXPECT_EQ(section["Serving Filtered RSRQ"], "-10.38 dB");  // -10.375: the tie goes to the even digit
    EXPECT_EQ(test::keysOf(section.part()),
              (std::vector<std::string>{"E-ARFCN", "Serving Physical Cell ID", "Subframe Number",
                                        "Serving Filtered RSRP", "Serving Filtered RSRQ"}));
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
}

TEST(ConnectedModeMeasurementMisc, RoundsEighthsToTheEvenHundredth) {
    Fed<ConnectedModeMeasurementMisc> section(Record(0xB179, 29).u16(25, 161));
    EXPECT_EQ(section["Serving Filtered RSRQ"], "0.12 dB");  // 0.125
    section.feed(Record(0xB179, 29).u16(25, 163));
    EXPECT_EQ(section["Serving Filtered RSRQ"], "0.38 dB");  // 0.375
    section.feed(Record(0xB179, 29).u16(25, 160));
    EXPECT_EQ(section["Serving Filtered RSRQ"], "0.00 dB");
    section.feed(Record(0xB179, 29).u16(23, 65535));
    EXPECT_EQ(section["Serving Filtered RSRP"], "16243.75 dBm");
}

TEST(ConnectedModeMeasurementMisc, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<ConnectedModeMeasurementMisc> section(Record(0xB179, 28).u16(17, 2075));
    section.feed(Record(0xB17F, 40));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}, {3, "Received an unknown log message: 45439"}}));
}

}  // namespace
}  // namespace kelvo
