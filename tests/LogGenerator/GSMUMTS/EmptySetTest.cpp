#include "LogGenerator/GSMUMTS/EmptySet.h"

#include <gtest/gtest.h>

#include "LogGenerator/GSMUMTS/DetectedSet.h"
#include "LogGenerator/GSMUMTS/MonitoredSet.h"
#include "LogGenerator/GSMUMTS/VirtualActiveSet.h"
#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

/// Eight cells, one of each set type.
Record everySetType() {
    Record record(0x417a, 16 + 8 * (15 + 44));
    record.u8(15, 8);
    for (std::uint32_t i = 0; i < 8; ++i) record.u16(16 + 15 * i + 7, 100 + i + (i << 13));
    return record;
}

template <class SectionClass>
class EmptySetTest : public testing::Test {};

using Sections = testing::Types<DetectedSet, MonitoredSet, VirtualActiveSet>;
TYPED_TEST_SUITE(EmptySetTest, Sections);

TYPED_TEST(EmptySetTest, StaysEmptyWhateverTheSearcherReports) {
    Fed<TypeParam> section(Array::make({"row"}));
    section.feed(everySetType());
    EXPECT_EQ(section.rowCount(), 0U);
    EXPECT_EQ(section.log().size(), 1U);
}

TYPED_TEST(EmptySetTest, IsEmptiedByARecordWithoutCells) {
    Fed<TypeParam> section(Array::make({"row"}));
    section.feed(Record(0x417a, 16));
    EXPECT_EQ(section.rowCount(), 0U);
}

TYPED_TEST(EmptySetTest, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<TypeParam> section(Array::make({"row"}));
    section.feed(Record(0x417a, 15));
    section.feed(Record(0x4005, 40));
    EXPECT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.log().size(), 3U);
    EXPECT_EQ(section.log().back(), Lines::value_type(3, "Received an unknown log message: 16389"));
}

TEST(EmptySet, WritesTheTraceWordOfEachSet) {
    Fed<DetectedSet> detected(Record(0x417a, 16));
    EXPECT_EQ(detected.log(), (Lines{{4, "DetectedSet"}}));
    Fed<MonitoredSet> monitored(Record(0x417a, 16));
    EXPECT_EQ(monitored.log(), (Lines{{4, "MonitoredSet"}}));
    Fed<VirtualActiveSet> virtualActive(Record(0x417a, 16));
    EXPECT_EQ(virtualActive.log(), (Lines{{4, "VirtualActiveSet"}}));
}

}  // namespace
}  // namespace kelvo
