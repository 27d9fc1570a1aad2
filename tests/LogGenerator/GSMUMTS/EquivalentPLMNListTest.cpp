#include "LogGenerator/GSMUMTS/EquivalentPLMNList.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

/// Networks whose bytes count up from 1.
Record counting(std::uint32_t networks, std::size_t size) {
    Record record(0x7150, size);
    record.u8(16, networks);
    for (std::size_t at = 17; at < size; ++at) record.u8(at, static_cast<std::uint32_t>(at - 16));
    return record;
}

TEST(EquivalentPLMNList, ReadsSixBytesEveryThreeBytes) {
    Fed<EquivalentPLMNList> section(Array::make());
    section.feed(counting(2, 26));  // 1 2 3 4 5 6 7 8 9
    ASSERT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.row(0, "Mobile Country Code"), "135");
    EXPECT_EQ(section.row(0, "Mobile Network Code"), "246");
    EXPECT_EQ(section.row(1, "Mobile Country Code"), "468");
    EXPECT_EQ(section.row(1, "Mobile Network Code"), "579");
    EXPECT_EQ(section.log(), (Lines{{4, "Equivalent PLMN List"}}));
}

TEST(EquivalentPLMNList, CountsBytesOfMoreThanADigitInFull) {
    Fed<EquivalentPLMNList> section(Array::make());
    section.feed(Record(0x7150, 23).u8(16, 1).u16(17, 0xFFFF).u16(19, 0xFFFF).u16(21, 0xFFFF));
    EXPECT_EQ(section.row(0, "Mobile Country Code"), "28305");  // 255 * 111
    EXPECT_EQ(section.row(0, "Mobile Network Code"), "28305");
}

TEST(EquivalentPLMNList, ReadsZeroPastTheEndAndMakesUpNoNetworks) {
    Fed<EquivalentPLMNList> section(Array::make());
    section.feed(counting(200, 19));  // 1 2
    ASSERT_EQ(section.rowCount(), 1U);
    EXPECT_EQ(section.row(0, "Mobile Country Code"), "100");
    EXPECT_EQ(section.row(0, "Mobile Network Code"), "200");
    section.feed(counting(3, 17));
    EXPECT_EQ(section.rowCount(), 0U);
}

TEST(EquivalentPLMNList, IsEmptiedByARecordWithoutNetworks) {
    Fed<EquivalentPLMNList> section(Array::make());
    section.feed(counting(2, 26));
    section.feed(Record(0x7150, 26));
    EXPECT_EQ(section.rowCount(), 0U);
    section.feed(counting(2, 26));
    section.feed(counting(1, 26));
    EXPECT_EQ(section.rowCount(), 1U);
}

TEST(EquivalentPLMNList, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<EquivalentPLMNList> section(Array::make());
    section.feed(counting(2, 26));
    section.clearLog();
    section.feed(Record(0x7150, 16));
    section.feed(Record(0x7135, 40));
    EXPECT_EQ(section.rowCount(), 2U);
    EXPECT_EQ(section.log(), (Lines{{4, "Equivalent PLMN List"},
                                    {4, "Equivalent PLMN List"},
                                    {3, "Received an unknown log message: 28981"}}));
}

}  // namespace
}  // namespace kelvo
