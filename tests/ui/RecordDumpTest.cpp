#include "ui/RecordDump.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

Bytes counting(std::size_t size) {
    Bytes bytes(size);
    for (std::size_t i = 0; i < size; ++i) bytes[i] = static_cast<std::uint8_t>(i);
    return bytes;
}
std::string dump(const Bytes& bytes, const Place& place) { return recordDump(bytes, place).toStdString(); }
std::string words(const Bytes& bytes, const Place& place) { return placeText(bytes, place).toStdString(); }

TEST(RecordDump, MarksTheFieldsBytes) {
    EXPECT_EQ(dump(counting(11), Place(7, 2, 0, 16, false)),
              "0000:&nbsp;00&nbsp;01&nbsp;02&nbsp;03&nbsp;04&nbsp;05&nbsp;06&nbsp;<b><u>07</u></b><br>"
              "0008:&nbsp;<b><u>08</u></b>&nbsp;09&nbsp;0a");
    EXPECT_EQ(words(counting(11), Place(7, 2, 0, 16, false)), "Bytes 7 to 8 of 11");
}

TEST(RecordDump, MarksTheFieldsBits) {
    const Bytes bytes = {0x00, 0x34, 0x12};
    EXPECT_EQ(dump(bytes, Place(1, 2, 4, 9, false)),  // 0x1234
              "0000:&nbsp;00&nbsp;<b><u>34</u></b>&nbsp;<b><u>12</u></b><br>000<b><u>10010&nbsp;0011</u></b>0100");
    EXPECT_EQ(words(bytes, Place(1, 2, 4, 9, false)), "Bytes 1 to 2 of 3, bits 4 to 12");
    EXPECT_EQ(dump(bytes, Place(1, 2, 15, 1, true)),  // 0x3412
              "0000:&nbsp;00&nbsp;<b><u>34</u></b>&nbsp;<b><u>12</u></b><br><b><u>0</u></b>0110100&nbsp;00010010");
    EXPECT_EQ(words(bytes, Place(2, 1, 3, 1, false)), "Byte 2 of 3, bit 3");
}

TEST(RecordDump, ReadsBitsBeyondTheEndAsZero) {
    const Bytes bytes = {0xff, 0xff};
    EXPECT_EQ(dump(bytes, Place(1, 2, 0, 9, false)),
              "0000:&nbsp;ff&nbsp;<b><u>ff</u></b><br>0000000<b><u>0&nbsp;11111111</u></b>");
    EXPECT_EQ(dump(bytes, Place(700, 1, 0, 4, false)), "0000:&nbsp;ff&nbsp;ff<br>0000<b><u>0000</u></b>");
}

TEST(RecordDump, ShowsTheLinesAroundTheFieldOfALongRecord) {
    const std::string shown = dump(counting(250), Place(160, 1, 0, 8, false));
    EXPECT_EQ(shown.substr(0, 14), "…<br>0112:&n");
    EXPECT_NE(shown.find("<b><u>a0</u></b>"), shown.npos);
    EXPECT_EQ(shown.substr(shown.size() - 7), "<br>…");
    EXPECT_EQ(dump(counting(250), Place()).substr(0, 8), "0000:&nb");
    EXPECT_EQ(words(counting(250), Place()), "250 bytes");
}

TEST(RecordDump, IsEmptyWithoutBytes) {
    EXPECT_EQ(dump({}, Place(1, 2, 0, 16, false)), "");
    EXPECT_EQ(words({}, Place(1, 2, 0, 16, false)), "");
}

}  // namespace
}  // namespace kelvo
