#include "tools/RawRecords.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

std::vector<std::size_t> sizesOf(const RawRecords& records) {
    std::vector<std::size_t> sizes;
    for (ByteView message : records.messages) sizes.push_back(message.size());
    return sizes;
}

TEST(RawRecords, SplitsMessagesWithAndWithoutPrefix) {
    // Type 1, length 4 (itself and two bytes); the prefix, type 255, length 2; type 1, length 3.
    const Bytes bytes{1, 4, 0, 8, 9, 0x81, 0, 255, 2, 0, 1, 3, 0, 7};
    const RawRecords records = splitRawRecords(bytes);
    EXPECT_EQ(sizesOf(records), (std::vector<std::size_t>{5, 5, 4}));
    EXPECT_EQ(records.messages[1][0], 0x81);
    EXPECT_EQ(records.leftOver, 0U);
}

TEST(RawRecords, ReadsTheLengthLittleEndian) {
    Bytes bytes(1 + 0x0102);
    bytes[0] = 1;
    bytes[1] = 0x02;
    bytes[2] = 0x01;
    EXPECT_EQ(sizesOf(splitRawRecords(bytes)), (std::vector<std::size_t>{0x0103}));
}

TEST(RawRecords, NothingGivesNothing) {
    EXPECT_TRUE(splitRawRecords({}).messages.empty());
    EXPECT_EQ(splitRawRecords({}).leftOver, 0U);
}

TEST(RawRecords, StopsAtALengthThatDoesNotFit) {
    for (const Bytes& end : {Bytes{1, 5, 0, 9, 9}, Bytes{1, 0, 0, 9}, Bytes{1, 1, 0, 9}, Bytes{1, 0xff, 0xff},
                             Bytes{1, 2}, Bytes{1}, Bytes{0x81}, Bytes{0x81, 0, 1, 2}, Bytes{0x81, 0, 1, 0, 0}}) {
        Bytes bytes{1, 2, 0};
        bytes.insert(bytes.end(), end.begin(), end.end());
        const RawRecords records = splitRawRecords(bytes);
        EXPECT_EQ(sizesOf(records), (std::vector<std::size_t>{3}));
        EXPECT_EQ(records.leftOver, end.size());
    }
}

}  // namespace
}  // namespace kelvo
