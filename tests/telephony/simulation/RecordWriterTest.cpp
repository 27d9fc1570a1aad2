#include "telephony/simulation/RecordWriter.h"

#include <gtest/gtest.h>

using namespace kelvo;
using namespace kelvo::simulation;
using namespace std::chrono_literals;

TEST(RecordWriter, WritesPrefixHeaderAndLittleEndianValues) {
    const Bytes message = RecordWriter(0s, 0xB0C2, 18).u8(13, 0x11).u16(14, 0x2233).i16(16, -2).finish();
    // 2026-03-02 09:00:00 UTC is 1,456,477,200 s of CDMA system time: 1,165,181,760,000 units, 0x10f4a3eb200.
    const Bytes expected{0x81, 0x00, 0x01, 17,   0,    0xC2, 0xB0, 0,    0,    0x00,
                         0xB2, 0x3E, 0x4A, 0x0F, 0x01, 0x11, 0x33, 0x22, 0xFE, 0xFF};
    EXPECT_EQ(message, expected);
}

TEST(RecordWriter, CountsTheModemsTimeInUnitsOf1250Microseconds) {
    const Bytes message = RecordWriter(25ms, 0xB0C2).finish();
    EXPECT_EQ(message[9], 20);  // 25 ms later
}

TEST(RecordWriter, MarksExtendedRecordsByTheirLogType) {
    const Bytes message = RecordWriter(0s, 0xFF0002).finish();
    EXPECT_EQ(message[2], 255);
    EXPECT_EQ(message[5], 0x02);
    EXPECT_EQ(message[6], 0x00);
}

TEST(RecordWriter, GrowsToWhatIsWritten) {
    const Bytes message = RecordWriter(0s, 0xB0C2).u32(20, 0x01020304).finish();
    ASSERT_EQ(message.size(), 2 + 24U);
    EXPECT_EQ(message[3], 23);
    EXPECT_EQ(message[2 + 19], 0);
    EXPECT_EQ(message[2 + 20], 4);
}

TEST(RecordWriter, AppendsAPropertyListAfterTheHeader) {
    const Bytes message = propertyListRecord(0s, 0xFF0002, Value("x"));
    EXPECT_EQ(textOf(ByteView(message).subspan(15)).substr(0, 5), "<?xml");
}
