#include "LogGenerator/LTE/NeighborMeasurementMisc.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "Neighbor Measurements";

TEST(NeighborMeasurementMisc, ShowsEveryField) {
    Fed<NeighborMeasurementMisc> section(Record(0xB180, 21).u8(13, 3).u16(17, 5780).u16(19, 0xFFC5));
    EXPECT_EQ(section["Version"], "3");
    EXPECT_EQ(section["E-ARFCN"], "5780");
    EXPECT_EQ(section["Qrxlevmin"], "-130 dBm");  // the upper bits of the word are the cell count
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
}

TEST(NeighborMeasurementMisc, CountsQrxlevminInStepsOfTwoFromMinus140) {
    Fed<NeighborMeasurementMisc> section(Record(0xB180, 21));
    EXPECT_EQ(section["Qrxlevmin"], "-140 dBm");
    section.feed(Record(0xB180, 21).u8(19, 63));
    EXPECT_EQ(section["Qrxlevmin"], "-14 dBm");
}

TEST(NeighborMeasurementMisc, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<NeighborMeasurementMisc> section(Record(0xB180, 20).u8(13, 3));
    section.feed(Record(0xB186, 40));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}, {3, "Received an unknown log message: 45446"}}));
}

}  // namespace
}  // namespace kelvo
