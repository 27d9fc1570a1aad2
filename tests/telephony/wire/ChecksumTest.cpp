#include "telephony/wire/Checksum.h"

#include <gtest/gtest.h>

#include "tests/telephony/wire/PlainFrame.h"

namespace kelvo::wire {
namespace {

TEST(Checksum, OfTheDigitsIsTheOneInTheBooks) { EXPECT_EQ(checksum(bytesOf("123456789")), 0x906E); }

TEST(Checksum, OfNothingIsZero) { EXPECT_EQ(checksum({}), 0x0000); }

TEST(Checksum, OfReadyFramesStandsInThemLowByteFirst) {
    EXPECT_EQ(checksum(Bytes{0x00}), 0xF078);
    EXPECT_EQ(checksum(Bytes{0x7C}), 0x4993);
    EXPECT_EQ(checksum(Bytes{0x60, 0x00}), 0x6A12);
    EXPECT_EQ(checksum(Bytes{0x73, 0, 0, 0, 1, 0, 0, 0}), 0x9D61);
}

TEST(Checksum, IsTheSameBitByBitForEveryLength) {
    Bytes bytes;
    std::uint32_t state = 1;
    for (int i = 0; i < 100; ++i) {
        EXPECT_EQ(checksum(bytes), test::plainChecksum(bytes)) << bytes.size() << " bytes";
        state = state * 1'664'525 + 1'013'904'223;
        bytes.push_back(static_cast<std::uint8_t>(state >> 24));
    }
}

}  // namespace
}  // namespace kelvo::wire
