#include "LogGenerator/CDMA/C2KDataRates.h"

#include <gtest/gtest.h>

#include <array>

#include "tests/support/C2KScreen.h"

namespace kelvo {
namespace {

using test::C2KScreen;
using test::Lines;
using test::Record;

/// A record whose only counter is the one of 1024 bits, index 3.
Record forward(std::uint32_t seq, std::uint32_t packets) {
    return Record(0x1192, 241).u32(13, seq).u32(17 + 4 * 3, packets);
}
/// A record whose only counter is the first of the rate of 1024 bits, index 4, in the first block.
Record reverse(std::uint32_t seq, std::uint32_t packets) {
    return Record(0x127e, 1750).u32(14, seq).u32(18 + 24 * 4, packets);
}

TEST(C2KForwardDataRate, ShowsNothingForTheFirstRecord) {
    C2KScreen screen(forward(7, 100));
    EXPECT_EQ(screen["kFLDataRate"], "");
    EXPECT_EQ(screen.kept("FLDataSeqNum"), 7);
    EXPECT_EQ(screen.kept("FLDataSent"), 102400);
    EXPECT_EQ(screen.extra("FLDataSeqNum1"), 7);
    EXPECT_EQ(screen.extra("FLDataSent1"), 102400);
    EXPECT_EQ(screen.extra("FLDataSeqNum2"), -1);
    EXPECT_EQ(screen.extra("FLDataSent2"), -1);
    EXPECT_EQ(screen.log(), Lines{});
}

TEST(C2KForwardDataRate, DividesTheGrowthOfBitsByThatOfTheSequence) {
    C2KScreen screen(forward(7, 100));
    screen.feed(forward(8, 350));
    EXPECT_EQ(screen["kFLDataRate"], "250.00 kbps");
    screen.feed(forward(12, 351));  // 1024 bits over 4 x 1024
    EXPECT_EQ(screen["kFLDataRate"], "0.25 kbps");
    EXPECT_EQ(screen.kept("FLDataSeqNum"), 12);
    EXPECT_EQ(screen.kept("FLDataSent"), 359424);
    EXPECT_EQ(screen.extra("FLDataSeqNum1"), 12);
    EXPECT_EQ(screen.extra("FLDataSent1"), 359424);
    EXPECT_EQ(screen.extra("FLDataSeqNum2"), 8);
    EXPECT_EQ(screen.extra("FLDataSent2"), 358400);
    screen.feed(forward(13, 351));
    EXPECT_EQ(screen["kFLDataRate"], "0.00 kbps");
}

TEST(C2KForwardDataRate, WeighsEveryCounter) {
    // The bits that one count of each counter is worth, one row a group.
    const std::array<std::int64_t, 56> bits = {128,  256,  512,  1024, 0,  //
                                               128,  256,  512,  1024, 0,  //
                                               128,  256,  512,  1024, 0,  //
                                               128,  256,  512,  1024, 0,  //
                                               128,  256,  512,  1024, 0,  // 0 to 24
                                               512,  1024, 2048, 0,        // 25 to 28
                                               128,  256,  512,  1024, 0,  // 29 to 33
                                               512,  1024, 2048, 0,        // 34 to 37
                                               1024, 3072, 0,              // 38 to 40
                                               512,  1024, 2048, 0,        // 41 to 44
                                               4096, 0,    1024, 3072, 0, 4096,
                                               0,    5120, 0,    5120, 0};  // 45, 47, 50, 52, 54
    for (std::size_t i = 0; i < bits.size(); ++i) {
        C2KScreen screen(Record(0x1192, 241).u32(17 + 4 * i, 3));
        EXPECT_EQ(screen.kept("FLDataSent"), 3 * bits[i]) << i;
    }
    Record all(0x1192, 241);
    for (std::size_t i = 0; i < bits.size(); ++i) all.u32(17 + 4 * i, 1);
    EXPECT_EQ(C2KScreen(all).kept("FLDataSent"), 48896);
}

TEST(C2KForwardDataRate, AddsBeyond32Bits) {
    C2KScreen screen(Record(0x1192, 241).u32(17 + 4 * 52, 0xFFFFFFFF).u32(17 + 4 * 54, 0xFFFFFFFF));
    EXPECT_EQ(screen.kept("FLDataSent"), 43980465100800);  // 2 x 5120 x 4294967295
    screen.feed(Record(0x1192, 241).u32(13, 1000000));
    screen.feed(Record(0x1192, 241).u32(13, 1000001).u32(17 + 4 * 52, 0xFFFFFFFF));
    EXPECT_EQ(screen["kFLDataRate"], "21474836475.00 kbps");  // 5 x 4294967295
}

TEST(C2KForwardDataRate, KeepsTheRateOfASequenceThatHasNotGrown) {
    C2KScreen screen(forward(7, 100));
    screen.feed(forward(8, 350));
    screen.feed(forward(8, 900));
    EXPECT_EQ(screen["kFLDataRate"], "250.00 kbps");
    EXPECT_EQ(screen.kept("FLDataSent"), 921600);
    EXPECT_EQ(screen.extra("FLDataSent1"), 921600);
    EXPECT_EQ(screen.extra("FLDataSeqNum2"), 8);
    EXPECT_EQ(screen.extra("FLDataSent2"), 358400);
    screen.feed(forward(3, 1000));
    EXPECT_EQ(screen["kFLDataRate"], "250.00 kbps");
    EXPECT_EQ(screen.kept("FLDataSeqNum"), 3);
    screen.feed(forward(4, 1001));
    EXPECT_EQ(screen["kFLDataRate"], "1.00 kbps");
}

TEST(C2KForwardDataRate, FollowsTheSequenceAroundItsEnd) {
    C2KScreen screen(forward(0xFFFFFFFF, 10));
    EXPECT_EQ(screen.kept("FLDataSeqNum"), 4294967295);
    screen.feed(forward(1, 14));
    EXPECT_EQ(screen["kFLDataRate"], "2.00 kbps");
    EXPECT_EQ(screen.extra("FLDataSeqNum2"), 4294967295);
    screen.feed(forward(0x80000001, 999));  // 2^31 steps on are as many back
    EXPECT_EQ(screen["kFLDataRate"], "2.00 kbps");
    screen.feed(forward(0, 999 + 1024));  // 2^31 - 1 steps
    EXPECT_EQ(screen["kFLDataRate"], "0.00 kbps");
}

TEST(C2KForwardDataRate, GoesNegativeWhenTheTotalShrinks) {
    C2KScreen screen(forward(1, 100));
    screen.feed(forward(2, 40));
    EXPECT_EQ(screen["kFLDataRate"], "-60.00 kbps");
    screen.feed(forward(3, 50));
    EXPECT_EQ(screen["kFLDataRate"], "10.00 kbps");
}

TEST(C2KForwardDataRate, BeginsAgainWhenARunningValueIsMissing) {
    for (const char* key : {"FLDataSeqNum", "FLDataSent"}) {
        C2KScreen screen(forward(1, 100));
        screen.feed(forward(2, 200));
        screen.state.remove(key);
        screen.feed(forward(3, 300));
        EXPECT_EQ(screen["kFLDataRate"], "") << key;
        EXPECT_EQ(screen.extra("FLDataSeqNum2"), 1) << key;
        EXPECT_EQ(screen.kept("FLDataSeqNum"), 3) << key;
        EXPECT_EQ(screen.kept("FLDataSent"), 307200) << key;
    }
}

TEST(C2KForwardDataRate, GoesOnWithoutABookkeeper) {
    C2KScreen screen;
    screen.state.remove("ExtraInfo");
    screen.feed(forward(1, 100));
    screen.feed(forward(2, 200));
    EXPECT_EQ(screen["kFLDataRate"], "100.00 kbps");
    EXPECT_FALSE(screen.state["ExtraInfo"]);
}

TEST(C2KForwardDataRate, ChangesNothingForAShortRecord) {
    C2KScreen screen(forward(1, 100));
    screen.feed(Record(0x1192, 240).u32(13, 2));
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code 0x1192 is 240 bytes long but must be at least 241 bytes."}}));
    EXPECT_EQ(screen.kept("FLDataSeqNum"), 1);
    EXPECT_EQ(screen.extra("FLDataSeqNum1"), 1);
    screen.feed(Record(0x1192, 400).u32(13, 2));
    EXPECT_EQ(screen.kept("FLDataSeqNum"), 2);
}

TEST(C2KReverseDataRate, CountsPacketsOfEverySize) {
    const std::array<std::int64_t, 12> bits = {128, 256, 512, 768, 1024, 1536, 2048, 3072, 4096, 6144, 8192, 12288};
    for (std::size_t rate = 0; rate < bits.size(); ++rate) {
        for (std::size_t block = 0; block < 6; ++block) {
            const std::size_t at = 18 + 288 * block + 24 * rate;
            C2KScreen screen(Record(0x127e, 1750)
                                 .u32(at, 1)
                                 .u32(at + 4, 2)
                                 .u32(at + 8, 4)
                                 .u32(at + 12, 8)
                                 .u32(at + 16, 100)
                                 .u32(at + 20, 100));
            EXPECT_EQ(screen.kept("RLDataSent"), 15 * bits[rate]) << rate << " in block " << block;
        }
    }
}

TEST(C2KReverseDataRate, AddsBeyond32Bits) {
    Record record(0x127e, 1750);
    for (std::size_t at = 18; at < 18 + 6 * 288; at += 4) record.u32(at, 0xFFFFFFFF);
    // 24 counters of 4294967295 for each rate; the sizes add up to 40064 bits.
    EXPECT_EQ(C2KScreen(record).kept("RLDataSent"), 4129765672965120);
}

TEST(C2KReverseDataRate, KeepsItsOwnRunningValues) {
    C2KScreen screen(reverse(7, 100));
    screen.feed(forward(50, 1));
    EXPECT_EQ(screen["kRLDataRate"], "");
    screen.feed(reverse(9, 400));
    EXPECT_EQ(screen["kRLDataRate"], "150.00 kbps");
    EXPECT_EQ(screen["kFLDataRate"], "");
    EXPECT_EQ(screen.kept("RLDataSeqNum"), 9);
    EXPECT_EQ(screen.kept("RLDataSent"), 409600);
    EXPECT_EQ(screen.extra("RLDataSeqNum1"), 9);
    EXPECT_EQ(screen.extra("RLDataSent1"), 409600);
    EXPECT_EQ(screen.extra("RLDataSeqNum2"), 7);
    EXPECT_EQ(screen.extra("RLDataSent2"), 102400);
    EXPECT_EQ(screen.kept("FLDataSeqNum"), 50);
    EXPECT_EQ(screen.extra("FLDataSeqNum2"), -1);
}

TEST(C2KReverseDataRate, FollowsTheSequenceAroundItsEndAndKeepsStill) {
    C2KScreen screen(reverse(0xFFFFFFFE, 10));
    screen.feed(reverse(2, 18));
    EXPECT_EQ(screen["kRLDataRate"], "2.00 kbps");
    screen.feed(reverse(2, 90));
    EXPECT_EQ(screen["kRLDataRate"], "2.00 kbps");
    EXPECT_EQ(screen.kept("RLDataSent"), 92160);
}

TEST(C2KReverseDataRate, ChangesNothingForAShortRecord) {
    C2KScreen screen(reverse(1, 100));
    screen.feed(Record(0x127e, 1749).u32(14, 2));
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code 0x127e is 1749 bytes long but must be at least 1750 bytes."}}));
    EXPECT_EQ(screen.kept("RLDataSeqNum"), 1);
}

}  // namespace
}  // namespace kelvo
