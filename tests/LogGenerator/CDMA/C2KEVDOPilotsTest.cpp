#include "LogGenerator/CDMA/C2KEVDOPilots.h"

#include <gtest/gtest.h>

#include "tests/support/C2KScreen.h"

namespace kelvo {
namespace {

using test::C2KScreen;
using test::Lines;
using test::Record;

Record activeSet(std::uint32_t count) { return Record(0x12b6, 25 + 12 * count).u8(15, count); }
Record fingers(std::uint32_t count) { return Record(0x108a, 23 + 14 * count).u8(22, count); }

TEST(C2KActiveSetPilots, ListsEveryPilotUnderItsPositionAndPn) {
    C2KScreen screen(activeSet(3).u16(25, 168).u16(27, 512).u16(37, 12).u16(39, 128).u16(49, 511).u16(51, 1024));
    EXPECT_EQ(*screen.list("kActiveSetPilots"),
              *Dictionary::make(
                  {{"_sorted", "_sorted"}, {"0;168", "+0.00 dB"}, {"1;12", "-6.02 dB"}, {"2;511", "+3.01 dB"}}));
    EXPECT_EQ(screen.log(), Lines{});
}

TEST(C2KActiveSetPilots, ShowsAnEnergyOfNothingAsMinusInfinity) {
    C2KScreen screen(activeSet(1).u16(25, 65535));
    EXPECT_EQ(screen.row("kActiveSetPilots", "0;65535"), "-inf dB");
}

TEST(C2KActiveSetPilots, ReadsEnergiesUpToTheirEnd) {
    C2KScreen screen(activeSet(2).u16(27, 1).u16(39, 65535));
    EXPECT_EQ(screen.row("kActiveSetPilots", "0;0"), "-27.09 dB");
    EXPECT_EQ(screen.row("kActiveSetPilots", "1;0"), "+21.07 dB");
}

TEST(C2KActiveSetPilots, SaysWhenThereIsNone) {
    C2KScreen screen(activeSet(1));
    screen.feed(activeSet(0));
    EXPECT_EQ(screen["kActiveSetPilots"], "(none)");
}

TEST(C2KActiveSetPilots, TakesALongerRecordButNoShorterOne) {
    C2KScreen screen(Record(0x12b6, 60).u8(15, 1).u16(25, 7).u16(27, 512));
    EXPECT_EQ(screen.list("kActiveSetPilots")->size(), 2U);
    screen.feed(Record(0x12b6, 48).u8(15, 2));
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code 0x12b6 is 48 bytes long, but has 2 substructs."}}));
    screen.feed(Record(0x12b6, 24));
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code 0x12b6 is 24 bytes long but must be at least 25 bytes."}}));
    screen.feed(Record(0x12b6, 25).u8(15, 255));
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code 0x12b6 is 25 bytes long, but has 255 substructs."}}));
    EXPECT_EQ(screen.row("kActiveSetPilots", "0;7"), "+0.00 dB");
}

TEST(C2KActiveSetPilots, ListsAsManyAsAByteCounts) {
    C2KScreen screen(activeSet(255).u16(25 + 12 * 254, 3).u16(27 + 12 * 254, 256));
    EXPECT_EQ(screen.list("kActiveSetPilots")->size(), 256U);
    EXPECT_EQ(screen.row("kActiveSetPilots", "254;3"), "-3.01 dB");
}

TEST(C2KFingerC2I, ListsEveryFingerUnderItsPositionAndPn) {
    C2KScreen screen(fingers(2).u16(23, 168).u16(29, 256).u16(37, 172).u16(43, 51));
    EXPECT_EQ(*screen.list("kFingerC2I"),
              *Dictionary::make({{"_sorted", "_sorted"}, {"0;168", "-3.01 dB"}, {"1;172", "-10.02 dB"}}));
    EXPECT_EQ(screen.log(), Lines{});
}

TEST(C2KFingerC2I, LeavesOutFingersWithoutAPilot) {
    C2KScreen screen(fingers(3).u16(23, 65535).u16(37, 172).u16(43, 512).u16(51, 65535));
    EXPECT_EQ(*screen.list("kFingerC2I"), *Dictionary::make({{"_sorted", "_sorted"}, {"1;172", "+0.00 dB"}}));
}

TEST(C2KFingerC2I, SaysWhenThereIsNone) {
    C2KScreen screen(fingers(2).u16(23, 65535).u16(29, 512).u16(37, 65535));
    EXPECT_EQ(screen["kFingerC2I"], "(none)");
    screen.feed(fingers(1).u16(23, 1));
    EXPECT_EQ(screen.row("kFingerC2I", "0;1"), "-inf dB");
    screen.feed(fingers(0));
    EXPECT_EQ(screen["kFingerC2I"], "(none)");
}

TEST(C2KFingerC2I, RefusesEveryLengthButItsOwn) {
    C2KScreen screen(fingers(1).u16(23, 1).u16(29, 512));
    screen.feed(Record(0x108a, 22));
    EXPECT_EQ(screen.log(), (Lines{{3, "Log code 0x108a is 22 bytes long but must be at least 23 bytes."}}));
    screen.feed(Record(0x108a, 36).u8(22, 1));
    EXPECT_EQ(screen.log(),
              (Lines{{3, "Log code 0x108a has bad length of 36 bytes, but has 1 substructs (size=23)."}}));
    screen.feed(Record(0x108a, 38).u8(22, 1));
    EXPECT_EQ(screen.log(),
              (Lines{{3, "Log code 0x108a has bad length of 38 bytes, but has 1 substructs (size=23)."}}));
    screen.feed(Record(0x108a, 24));
    EXPECT_EQ(screen.log(),
              (Lines{{3, "Log code 0x108a has bad length of 24 bytes, but has 0 substructs (size=23)."}}));
    EXPECT_EQ(screen.row("kFingerC2I", "0;1"), "+0.00 dB");
}

}  // namespace
}  // namespace kelvo
