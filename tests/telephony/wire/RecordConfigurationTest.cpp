#include "telephony/wire/RecordConfiguration.h"

#include <gtest/gtest.h>

namespace kelvo::wire {
namespace {

TEST(RecordConfiguration, AsksForRanges) { EXPECT_EQ(rangesRequest(), (Bytes{0x73, 0, 0, 0, 1, 0, 0, 0})); }

TEST(RecordConfiguration, AsksForAMask) {
    LogMask mask(5, 10);
    mask.set(0x5009);
    EXPECT_EQ(setMaskRequest(mask), (Bytes{0x73, 0, 0, 0, 3, 0, 0, 0, 5, 0, 0, 0, 10, 0, 0, 0, 0x00, 0x02}));
    EXPECT_EQ(getMaskRequest(0xB), (Bytes{0x73, 0, 0, 0, 4, 0, 0, 0, 0x0B, 0, 0, 0}));
}

TEST(RecordConfiguration, ReadsRequests) {
    const Bytes request{0x73, 0, 0, 0, 3, 0, 0, 0, 5, 0, 0, 0, 10, 0, 0, 0, 0x00, 0x02};
    const auto read = parseConfigurationRequest(request);
    ASSERT_TRUE(read);
    EXPECT_EQ(read->operation, Operation::SetMask);
    const auto mask = parseMask(read->data);
    ASSERT_TRUE(mask);
    EXPECT_EQ(mask->equipment(), 5U);
    EXPECT_EQ(mask->items(), 10U);
    EXPECT_TRUE(mask->test(0x5009));
    EXPECT_FALSE(parseConfigurationRequest(ByteView(request).first(7)));
    EXPECT_FALSE(parseConfigurationRequest(Bytes{0x7D, 0, 0, 0, 3, 0, 0, 0}));
}

// As a real modem answers.
TEST(RecordConfiguration, ReadsRanges) {
    const Bytes answer{0x73, 0,    0, 0, 1,    0,    0, 0, 0, 0, 0, 0,                    // good
                       0,    0,    0, 0, 2,    0x0A, 0, 0, 0, 0, 0, 0, 0,    0,    0, 0,  // 0 to 3
                       0x10, 0x09, 0, 0, 0x20, 0x04, 0, 0, 0, 0, 0, 0, 0xFF, 0x04, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0,
                       0x8A, 0x03, 0, 0, 0x01, 0x02, 0, 0, 0, 0, 0, 0, 0xFF, 0x01, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0};
    const auto read = parseConfigurationAnswer(answer);
    ASSERT_TRUE(read);
    EXPECT_EQ(read->operation, Operation::Ranges);
    EXPECT_EQ(read->status, 0U);
    EXPECT_EQ(parseRanges(read->data),
              (Ranges{0, 0xA02, 0, 0, 0x910, 0x420, 0, 0x4FF, 0, 0, 0x38A, 0x201, 0, 0x1FF, 0, 0}));
    EXPECT_FALSE(parseRanges(ByteView(answer).subspan(12, 63)));
}

TEST(RecordConfiguration, HasNoMoreItemsThanCodes) {
    Bytes data(64);
    data[3] = 0xFF;
    EXPECT_EQ((*parseRanges(data))[0], 4096U);
}

TEST(RecordConfiguration, ReadsTheMaskInForce) {
    const Bytes answer{0x73, 0, 0, 0, 3, 0, 0, 0, 0, 0, 0, 0, 0x0B, 0, 0, 0, 9, 0, 0, 0, 0x02, 0x01};
    const auto read = parseConfigurationAnswer(answer);
    ASSERT_TRUE(read);
    EXPECT_EQ(equipmentOf(read->data), 0x0BU);
    const auto mask = parseMask(read->data);
    ASSERT_TRUE(mask);
    EXPECT_TRUE(mask->test(0xB001));
    EXPECT_TRUE(mask->test(0xB008));
    EXPECT_FALSE(mask->test(0xB000));
}

TEST(RecordConfiguration, RefusesAnswersThatAreTooShort) {
    const Bytes answer{0x73, 0, 0, 0, 3, 0, 0, 0, 0, 0, 0, 0, 0x0B, 0, 0, 0, 9, 0, 0, 0, 0x02, 0x01};
    EXPECT_FALSE(parseConfigurationAnswer(ByteView(answer).first(11)));
    EXPECT_FALSE(equipmentOf(ByteView(answer).subspan(12, 3)));
    EXPECT_FALSE(parseMask(ByteView(answer).subspan(12, 7)));
    EXPECT_FALSE(parseMask(ByteView(answer).subspan(12, 9)));  // a byte of the mask is missing
    Bytes huge = answer;
    huge[19] = 0xFF;  // so many items that no frame could hold them
    EXPECT_FALSE(parseMask(ByteView(huge).subspan(12)));
}

TEST(RecordConfiguration, AnswersAsItReads) {
    EXPECT_EQ(configurationAnswer(Operation::AllOff, 0), (Bytes{0x73, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}));
    LogMask mask(0xB, 9);
    mask.set(0xB001);
    mask.set(0xB008);
    EXPECT_EQ(configurationAnswer(Operation::SetMask, 2, maskData(mask)),
              (Bytes{0x73, 0, 0, 0, 3, 0, 0, 0, 2, 0, 0, 0, 0x0B, 0, 0, 0, 9, 0, 0, 0, 0x02, 0x01}));
    Ranges ranges{};
    ranges[1] = 0xC94;
    const Bytes data = rangesData(ranges);
    ASSERT_EQ(data.size(), 64U);
    EXPECT_EQ(Bytes(data.begin() + 4, data.begin() + 8), (Bytes{0x94, 0x0C, 0, 0}));
}

}  // namespace
}  // namespace kelvo::wire
