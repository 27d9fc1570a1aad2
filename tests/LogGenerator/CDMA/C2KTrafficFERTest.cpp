#include "LogGenerator/CDMA/C2KTrafficFER.h"

#include <gtest/gtest.h>

#include "tests/support/C2KScreen.h"
#include "tests/support/Subpackets.h"

namespace kelvo {
namespace {

using test::C2KScreen;
using test::Lines;
using test::Record;
using test::Subpackets;

Record frame(std::uint32_t erased) { return Subpackets(0x119d).add(3, 9).add(11, 25).u8(24, erased); }

TEST(C2KTrafficFER, CountsOneFrameIn64) {
    C2KScreen screen(frame(1));
    EXPECT_EQ(screen["k1xTrafficFER"], "1.56%");
    EXPECT_EQ(screen.state["TrafficFER"], Value(0.015625));
    screen.feed(frame(1));
    EXPECT_EQ(screen["k1xTrafficFER"], "3.10%");
    EXPECT_EQ(screen.state["TrafficFER"], Value(0.031005859375));  // 1/64 + 63/4096
    screen.feed(frame(0));
    EXPECT_EQ(screen["k1xTrafficFER"], "3.05%");
    EXPECT_EQ(screen.state["TrafficFER"], Value(0.030521392822265625));  // x 63/64: 8001/262144
    EXPECT_EQ(screen.log(), Lines{});
}

TEST(C2KTrafficFER, BeginsAtZeroWithAGoodFrame) {
    C2KScreen screen(frame(0));
    EXPECT_EQ(screen["k1xTrafficFER"], "0.00%");
    EXPECT_EQ(screen.state["TrafficFER"], Value(0.0));
}

TEST(C2KTrafficFER, TakesAnyByteButZeroAsAnErasedFrame) {
    EXPECT_EQ(C2KScreen(frame(255))["k1xTrafficFER"], "1.56%");
    EXPECT_EQ(C2KScreen(frame(2))["k1xTrafficFER"], "1.56%");
}

TEST(C2KTrafficFER, FiltersInSinglePrecision) {
    C2KScreen screen;
    screen.state.set("TrafficFER", 0.1);
    screen.feed(frame(0));
    // 0.1 is 13421773 / 2^27 in single precision; x 63 / 64 is 845571699 / 2^33, of which 24 bits stay.
    EXPECT_EQ(screen.state["TrafficFER"], Value(13212058.0 / 134217728.0));
}

TEST(C2KTrafficFER, RoundsTheProductAndThenTheSum) {
    C2KScreen screen;
    screen.state.set("TrafficFER", 0x1.eb8b7p-7);
    screen.feed(frame(1));
    EXPECT_EQ(screen.state["TrafficFER"], Value(0x1.f1eeap-6));  // rounded once it were 0x1.f1eea2p-6
}

TEST(C2KTrafficFER, StaysFullWhenEveryFrameIsErased) {
    C2KScreen screen;
    screen.state.set("TrafficFER", 1);  // a whole number is a number, too
    screen.feed(frame(1));
    EXPECT_EQ(screen["k1xTrafficFER"], "100.00%");
}

TEST(C2KTrafficFER, IgnoresARunningValueThatIsNoNumber) {
    C2KScreen screen;
    screen.state.set("TrafficFER", "0.5");
    screen.feed(frame(1));
    EXPECT_EQ(screen["k1xTrafficFER"], "1.56%");
}

TEST(C2KTrafficFER, ReadsAFramePastTheEndAsGood) {
    C2KScreen screen(Subpackets(0x119d).add(11, 24));
    EXPECT_EQ(screen["k1xTrafficFER"], "0.00%");
}

TEST(C2KTrafficFER, ChangesNothingWithoutItsSubpacket) {
    C2KScreen screen(frame(1));
    screen.feed(Subpackets(0x119d).add(3, 9));
    EXPECT_EQ(screen.log(), (Lines{{4, "Log code 0x119d: missing traffic demod subpacket."}}));
    screen.feed(Record(0x119d, 16));
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code 0x119d is 16 bytes long but must be at least 17 bytes."}}));
    Record record = frame(1);
    record.u16(19, 60000);
    screen.feed(record);
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code error in subpkt#0: bad size (60000)."},
                                   {4, "Log code 0x119d: missing traffic demod subpacket."}}));
    EXPECT_EQ(screen["k1xTrafficFER"], "1.56%");
    EXPECT_EQ(screen.state["TrafficFER"], Value(0.015625));
}

TEST(C2KTrafficFER, BeginsAnewAfterACallHasEnded) {
    C2KScreen screen(frame(1));
    endTrafficFER(screen.state, screen.lookup);
    EXPECT_EQ(screen["k1xTrafficFER"], "1.56% (old)");
    screen.feed(frame(1));
    EXPECT_EQ(screen["k1xTrafficFER"], "1.56%");
}

}  // namespace
}  // namespace kelvo
