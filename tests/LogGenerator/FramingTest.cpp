#include "LogGenerator/Framing.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

Bytes owned(ByteView view) { return {view.begin(), view.end()}; }

Bytes stripped(const Bytes& message) { return owned(stripPrefix(message)); }

Bytes payload(const Bytes& packet) { return owned(payloadOf(packet)); }

LogCode code(std::uint8_t type, std::uint8_t low, std::uint8_t high) {
    const Bytes packet{type, 0xAA, 0xBB, low, high};
    return logCode(packet.data());
}

TEST(Framing, DropsTheTwoBytesOfAPrefix) {
    EXPECT_EQ(stripped({0x81, 7}), Bytes());
    EXPECT_EQ(stripped({0x81, 7, 1, 2}), (Bytes{1, 2}));
}

TEST(Framing, DropsOnePrefixAlone) { EXPECT_EQ(stripped({0x81, 0, 0x81, 9}), (Bytes{0x81, 9})); }

TEST(Framing, LeavesNothingOfHalfAPrefix) { EXPECT_EQ(stripped({0x81}), Bytes()); }

TEST(Framing, LeavesAMessageWithoutAPrefixAsItStands) {
    EXPECT_EQ(stripped({}), Bytes());
    EXPECT_EQ(stripped({0x82, 7}), (Bytes{0x82, 7}));
    EXPECT_EQ(stripped({0x01, 0x81, 7}), (Bytes{0x01, 0x81, 7}));
}

TEST(Framing, ReadsTheCodeLowByteFirst) { EXPECT_EQ(code(1, 0xD2, 0xC3), 0xC3D2U); }

TEST(Framing, ExtendsCodesOfType255Alone) {
    EXPECT_EQ(code(255, 0x10, 0x00), 0xff0010U);
    EXPECT_EQ(code(255, 0xD2, 0xC3), 0xffC3D2U);
    EXPECT_EQ(code(254, 0xD2, 0xC3), 0xC3D2U);
}

TEST(Framing, HasThePayloadBehindThirteenBytes) {
    EXPECT_EQ(payload({1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12, 13, 14, 15}), (Bytes{14, 15}));
    EXPECT_EQ(payload(Bytes(13)), Bytes());
    EXPECT_EQ(payload(Bytes(11)), Bytes());  // what a prefix leaves of the shortest message
}

}  // namespace
}  // namespace kelvo
