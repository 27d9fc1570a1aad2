#include "LogGenerator/CDMA/C2K1xActiveSet.h"

#include <gtest/gtest.h>

#include "tests/support/Record.h"

namespace kelvo {
namespace {

using test::Record;

/// An active-set sub-packet that begins at offset 0 of its buffer, with the reference pilot 168.
Record activeSet(std::uint32_t n, std::uint32_t m, std::uint32_t e, std::uint32_t count, std::uint32_t extras) {
    return Record(0, 300).u16(4, n).u8(6, m).u8(7, e).u8(8, count).u8(9, extras).u16(10, 168);
}

/// With N = 4, M = 8 and E = 3 the ratio is X / 144 - 1/4.
Record plainSet(std::uint32_t count, std::uint32_t extras) { return activeSet(4, 8, 3, count, extras); }

DictionaryRef pilots(const Record& record) { return C2K1xActiveSet(RecordView(record.bytes()), 0); }

/// The level of a set's only pilot, PN 1, with the energy `x`.
std::string level(std::uint32_t n, std::uint32_t m, std::uint32_t e, std::uint32_t x) {
    const DictionaryRef list = pilots(activeSet(n, m, e, 1, 1).u16(12, 1).u16(28, x));
    return *(*list)["0;1"].string();
}

TEST(C2K1xActiveSet, ListsEveryPilotAndMarksTheReference) {
    const Record record = plainSet(3, 1).u16(12, 12).u16(28, 72).u16(32, 168).u16(48, 180).u16(52, 511).u16(68, 1476);
    EXPECT_EQ(*pilots(record), *Dictionary::make({{"_sorted", "_sorted"},
                                                  {"0;12", "-6.02 dB"},               // 1/2 - 1/4
                                                  {"1;168", "(ref pilot) +0.00 dB"},  // 5/4 - 1/4
                                                  {"2;511", "+10.00 dB"}}));          // 41/4 - 1/4
}

TEST(C2K1xActiveSet, MarksEveryPilotWithTheReferencesPn) {
    const Record record = plainSet(2, 1).u16(12, 168).u16(28, 180).u16(32, 168).u16(48, 72);
    EXPECT_EQ(*pilots(record),
              *Dictionary::make(
                  {{"_sorted", "_sorted"}, {"0;168", "(ref pilot) +0.00 dB"}, {"1;168", "(ref pilot) -6.02 dB"}}));
}

TEST(C2K1xActiveSet, IsAListEvenWithoutPilots) {
    EXPECT_EQ(*pilots(plainSet(0, 1)), *Dictionary::make({{"_sorted", "_sorted"}}));
    EXPECT_EQ(*C2K1xActiveSet(RecordView({}), 17), *Dictionary::make({{"_sorted", "_sorted"}}));
}

TEST(C2K1xActiveSet, CountsFromTheSubpacket) {
    const Record record = Record(0, 80).u16(24, 4).u8(26, 8).u8(27, 3).u8(28, 1).u8(29, 1).u16(32, 9).u16(48, 180);
    EXPECT_EQ(*C2K1xActiveSet(RecordView(record.bytes()), 20),
              *Dictionary::make({{"_sorted", "_sorted"}, {"0;9", "+0.00 dB"}}));
}

TEST(C2K1xActiveSet, WidensEntriesByTheirExtras) {
    // Without extras an entry is 12 bytes long and its energy lies where the next one's PN does.
    EXPECT_EQ(*pilots(plainSet(2, 0).u16(12, 1).u16(24, 180).u16(36, 72)),
              *Dictionary::make({{"_sorted", "_sorted"}, {"0;1", "+0.00 dB"}, {"1;180", "-6.02 dB"}}));
    EXPECT_EQ(*pilots(plainSet(2, 1).u16(12, 1).u16(28, 180).u16(32, 2).u16(48, 72)),
              *Dictionary::make({{"_sorted", "_sorted"}, {"0;1", "+0.00 dB"}, {"1;2", "-6.02 dB"}}));
    EXPECT_EQ(*pilots(plainSet(2, 2).u16(12, 1).u16(32, 180).u16(36, 2).u16(56, 72)),
              *Dictionary::make({{"_sorted", "_sorted"}, {"0;1", "+0.00 dB"}, {"1;2", "-6.02 dB"}}));
    EXPECT_EQ(*pilots(plainSet(2, 3).u16(12, 1).u16(36, 180).u16(44, 2).u16(68, 72)),
              *Dictionary::make({{"_sorted", "_sorted"}, {"0;1", "+0.00 dB"}, {"1;2", "-6.02 dB"}}));
}

TEST(C2K1xActiveSet, NeverGoesBelowItsFloor) {
    EXPECT_EQ(level(4, 8, 3, 37), "-21.58 dB");  // 1/144
    EXPECT_EQ(level(4, 8, 3, 36), "-50.00 dB");  // exactly nothing
    EXPECT_EQ(level(4, 8, 3, 35), "-50.00 dB");  // less than nothing
    EXPECT_EQ(level(4, 8, 3, 0), "-50.00 dB");
}

TEST(C2K1xActiveSet, ScalesByItsExponent) {
    EXPECT_EQ(level(1, 1, 0, 144), "+0.00 dB");     // 144 / 8 / 9 - 1
    EXPECT_EQ(level(1, 1, 1, 36), "+0.00 dB");      // 36 / 2 / 9 - 1
    EXPECT_EQ(level(1, 1, 4, 9), "+14.91 dB");      // 32 - 1
    EXPECT_EQ(level(1, 1, 255, 1), "+1516.68 dB");  // 2^507 / 9
    EXPECT_EQ(level(65535, 1, 20, 1), "+5.51 dB");  // 2^37 / (9 x 65535^2)
}

TEST(C2K1xActiveSet, SurvivesAScaleOfNothing) {
    EXPECT_EQ(level(0, 8, 3, 100), "-50.00 dB");  // infinity - infinity
    EXPECT_EQ(level(0, 0, 0, 0), "-50.00 dB");
    EXPECT_EQ(level(4, 0, 3, 0), "-50.00 dB");  // 0 / 0
    EXPECT_EQ(level(4, 0, 3, 1), "+inf dB");
}

TEST(C2K1xActiveSet, MakesUpNoPilotsBeyondTheEnd) {
    const Bytes bytes = plainSet(255, 1).u16(12, 1).u16(28, 180).u16(32, 2).u16(52, 3).cut(53);
    EXPECT_EQ(
        *C2K1xActiveSet(RecordView(bytes), 0),
        *Dictionary::make({{"_sorted", "_sorted"}, {"0;1", "+0.00 dB"}, {"1;2", "-50.00 dB"}, {"2;3", "-50.00 dB"}}));
}

}  // namespace
}  // namespace kelvo
