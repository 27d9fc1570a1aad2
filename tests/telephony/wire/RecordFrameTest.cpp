#include "telephony/wire/RecordFrame.h"

#include <gtest/gtest.h>

namespace kelvo::wire {
namespace {

// Code 0xB0C2, three more in the modem, two bytes of payload: 14 bytes of record.
const Bytes kBody{0x10, 0x03, 0x0E, 0x00, 0x0E, 0x00, 0xC2, 0xB0, 0x9A,
                  0xA5, 0x35, 0xFD, 0x23, 0x23, 0x02, 0x01, 0xAA, 0xBB};

Bytes owned(ByteView view) { return {view.begin(), view.end()}; }

Bytes with(std::size_t at, std::uint8_t value) {
    Bytes body = kBody;
    body[at] = value;
    return body;
}

TEST(RecordFrame, SaysWhatItCarries) {
    const auto frame = parseRecord(kBody);
    ASSERT_TRUE(frame);
    EXPECT_EQ(frame->waiting, 3);
    EXPECT_EQ(frame->code, 0xB0C2);
    EXPECT_EQ(frame->timestamp, 0x01022323FD35A59AU);
    EXPECT_EQ(owned(frame->record),
              (Bytes{0x0E, 0x00, 0xC2, 0xB0, 0x9A, 0xA5, 0x35, 0xFD, 0x23, 0x23, 0x02, 0x01, 0xAA, 0xBB}));
}

TEST(RecordFrame, BecomesAPacket) {
    Bytes body = kBody;
    EXPECT_EQ(owned(packetOf(body)),
              (Bytes{0x01, 0x0E, 0x00, 0xC2, 0xB0, 0x9A, 0xA5, 0x35, 0xFD, 0x23, 0x23, 0x02, 0x01, 0xAA, 0xBB}));
}

TEST(RecordFrame, IsRefusedWhenItsLengthsLie) {
    EXPECT_FALSE(parseRecord(with(2, 0x0D)));
    EXPECT_FALSE(parseRecord(with(3, 0x01)));
    EXPECT_FALSE(parseRecord(with(4, 0x0F)));
    Bytes longer = kBody;
    longer.push_back(0);
    EXPECT_FALSE(parseRecord(longer));
    Bytes shorter = kBody;
    shorter.pop_back();
    EXPECT_FALSE(parseRecord(shorter));
}

TEST(RecordFrame, HasTwelveBytesOfRecordAtLeast) {
    Bytes shortest{0x10, 0x00, 0x0C, 0x00, 0x0C, 0x00, 0xC2, 0xB0, 1, 2, 3, 4, 5, 6, 7, 8};
    ASSERT_TRUE(parseRecord(shortest));
    EXPECT_EQ(parseRecord(shortest)->record.size(), 12U);
    shortest.pop_back();
    shortest[2] = shortest[4] = 0x0B;
    EXPECT_FALSE(parseRecord(shortest));
    EXPECT_FALSE(parseRecord({}));
}

TEST(RecordFrame, IsMadeAsItIsRead) {
    EXPECT_EQ(recordBody(3, ByteView(kBody).subspan(4)), kBody);
    const Bytes longest(65'535, 0xFF);
    EXPECT_EQ(recordBody(0, longest).size(), 65'539U);
}

}  // namespace
}  // namespace kelvo::wire
