#include "telephony/adaptation/AdaptationMeter.h"

#include <gtest/gtest.h>

#include "tests/telephony/adaptation/Sent.h"

namespace kelvo::test {
namespace {

class AdaptationMeter : public testing::Test {
protected:
    std::optional<std::string> feed(const Sent& sent) { return meter.count(adapter.adapt(sent.bytes())); }

    adaptation::RecordAdapter adapter;
    adaptation::AdaptationMeter meter;
};

TEST_F(AdaptationMeter, NamesEachKindOnceAndCountsThemAll) {
    EXPECT_EQ(feed(Sent(0xB0C2, 33).u8(0, 4)), "0xB0C2 version 4, 33 bytes: not known");
    EXPECT_EQ(feed(Sent(0xB0C2, 33).u8(0, 4)), std::nullopt);
    EXPECT_EQ(feed(Sent(0xB0C2, 34).u8(0, 4)), "0xB0C2 version 4, 34 bytes: not known");
    EXPECT_EQ(feed(Sent(0xB179, 28).u8(0, 4).u8(4, 1)), "0xB179 version 4, 28 bytes: a secondary cell's");
    EXPECT_EQ(feed(Sent(0xB0C2, 25).u8(0, 2)), std::nullopt);
    EXPECT_EQ(meter.refused(), 4U);
    EXPECT_EQ(meter.passed(), 1U);
    ASSERT_EQ(meter.refusals().size(), 3U);
    EXPECT_EQ(meter.refusals()[0].code, 0xB0C2U);
    EXPECT_EQ(meter.refusals()[0].what, "0xB0C2 version 4, 33 bytes: not known");
    EXPECT_EQ(meter.refusals()[0].records, 2U);
}

TEST_F(AdaptationMeter, TellsWhatTurnedRecordsLack) {
    feed(Sent(0xB0C1, 11).u8(0, 2).u32(3, 66586));
    feed(Sent(0xB193, 100).u8(0, 1).u8(1, 1).u8(4, 25).u8(5, 18).u16(6, 96).u32(8, 1825));
    feed(Sent(0x7150, 19).u8(0, 1).u8(3, 3).u8(4, 0x64).u8(5, 0xF0).u8(6, 0x70));
    EXPECT_EQ(meter.turned(), 3U);
    EXPECT_EQ(meter.derived(), 1U);
    EXPECT_EQ(meter.neutral(), 1U);
    EXPECT_EQ(meter.extendedChannels(), 1U);
    EXPECT_EQ(meter.lastExtendedChannel(), 66586U);
    EXPECT_EQ(meter.leftOut(), 2U);
    EXPECT_EQ(meter.lines(),
              (std::vector<std::string>{
                  "3 turned from newer layouts", "1 of them 0xB17F derived from 0xB193",
                  "1 of those without a 0xB17F of their cell: no priority, limits, search thresholds and rules",
                  "1 with an extended channel, shown as 65535; the last is 66586", "2 list entries left out"}));
}

TEST_F(AdaptationMeter, NamesNoMoreThanAThousandKinds) {
    for (std::uint32_t bytes = 0; bytes < 1500; ++bytes) feed(Sent(0xB0C2, bytes).u8(0, 9));
    EXPECT_EQ(meter.refusals().size(), 1000U);
    EXPECT_EQ(meter.refused(), 1500U);
}

}  // namespace
}  // namespace kelvo::test
