#include "LogGenerator/CDMA/C2KFindSubpacket.h"

#include <gtest/gtest.h>

#include "platform/system/Environment.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/Subpackets.h"

namespace kelvo {
namespace {

using test::Record;
using test::Subpackets;
using Lines = std::vector<test::RecordingLog::Line>;
using Found = std::optional<std::size_t>;

class C2KSubpackets : public testing::Test {
protected:
    test::RecordingLog log;
    Environment::Scope environment{{.log = &log}};
};

TEST_F(C2KSubpackets, WalksFromSizeToSize) {
    const Subpackets packet = Subpackets(0x119c).add(1, 5).add(2, 300).add(9, 4);
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 1), Found(17));
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 2), Found(22));
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 9), Found(322));
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 3), Found());
    EXPECT_EQ(log.lines(), Lines{});
}

TEST_F(C2KSubpackets, TakesTheFirstOfTwo) {
    const Subpackets packet = Subpackets(0x119c).add(7, 6).add(3, 8).add(3, 8);
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 3), Found(23));
}

TEST_F(C2KSubpackets, LooksNoFurtherThanTheCount) {
    Record packet = Subpackets(0x119c).add(1, 8).add(2, 8);
    packet.u8(14, 1);
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 1), Found(17));
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 2), Found());
    packet.u8(14, 0).u16(19, 9999);
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 1), Found());
    EXPECT_EQ(log.lines(), Lines{});
}

TEST_F(C2KSubpackets, CountsTheLimitFromTheFirstSubpacket) {
    Record packet(0x119c, 40);  // the limit is 57
    packet.u8(14, 1).u8(17, 4).u16(19, 39);
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 4), Found(17));
    EXPECT_EQ(log.lines(), Lines{});
    packet.u16(19, 40);
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 4), Found());
    EXPECT_EQ(log.lines(), (Lines{{3, "Log code error in subpkt#0: bad size (40)."}}));
}

TEST_F(C2KSubpackets, SaysWhichSubpacketHasABadSize) {
    Record packet = Subpackets(0x119c).add(1, 8).add(2, 8).add(3, 8);
    packet.u16(17 + 16 + 2, 65535);
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 2), Found(25));
    EXPECT_EQ(log.lines(), Lines{});
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 3), Found());
    EXPECT_EQ(log.lines(), (Lines{{3, "Log code error in subpkt#2: bad size (65535)."}}));
}

TEST_F(C2KSubpackets, EndsWhenASizeOfZeroStaysInPlace) {
    Record packet(0x119c, 20);
    packet.u8(14, 255).u8(17, 6);
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 6), Found(17));
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 5), Found());
    EXPECT_EQ(log.lines(), Lines{});
}

TEST_F(C2KSubpackets, FollowsSizesThatAreSmallerThanAHeader) {
    Record packet(0x119c, 30);  // at 17 the id 1 with size 1, so that the next header is at 18: id 2, size 256
    packet.u8(14, 2).u8(17, 1).u8(18, 2).u16(19, 1);
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 1), Found(17));
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 2), Found(18));
}

TEST_F(C2KSubpackets, ReadsHeadersPastTheEndAsZero) {
    Record packet(0x119c, 17);
    packet.u8(14, 3);
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 0), Found(17));
    EXPECT_EQ(C2KFindSubpacket(packet.bytes(), 1), Found());
    EXPECT_EQ(C2KFindSubpacket(ByteView(), 1), Found());
    EXPECT_EQ(log.lines(), Lines{});
}

}  // namespace
}  // namespace kelvo
