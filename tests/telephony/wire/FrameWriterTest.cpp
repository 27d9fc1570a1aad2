#include "telephony/wire/FrameWriter.h"

#include <gtest/gtest.h>

#include "telephony/wire/Protocol.h"

namespace kelvo::wire {
namespace {

TEST(FrameWriter, MakesTheFramesThatEveryModemKnows) {
    EXPECT_EQ(frameOf(kVersionRequest), (Bytes{0x00, 0x78, 0xF0, 0x7E}));
    EXPECT_EQ(frameOf(kBuildIdRequest), (Bytes{0x7C, 0x93, 0x49, 0x7E}));
    EXPECT_EQ(frameOf(kEventsOff), (Bytes{0x60, 0x00, 0x12, 0x6A, 0x7E}));
    EXPECT_EQ(frameOf(kRecordsOff), (Bytes{0x73, 0, 0, 0, 0, 0, 0, 0, 0xDA, 0x81, 0x7E}));
    EXPECT_EQ(frameOf(kTextsOff), (Bytes{0x7D, 0x5D, 0x05, 0, 0, 0, 0, 0, 0, 0x74, 0x41, 0x7E}));
}

TEST(FrameWriter, EscapesTheChecksumToo) {
    EXPECT_EQ(frameOf(Bytes{0x28, 0x18}), (Bytes{0x28, 0x18, 0x7D, 0x5D, 0x7D, 0x5E, 0x7E}));  // it is 0x7E7D
    EXPECT_EQ(frameOf(Bytes{0x7E}), (Bytes{0x7D, 0x5E, 0x81, 0x6A, 0x7E}));
}

TEST(FrameWriter, AppendsToWhatIsThere) {
    Bytes frames{0xAA};
    appendFrame(frames, kVersionRequest);
    appendFrame(frames, kEventsOff);
    EXPECT_EQ(frames, (Bytes{0xAA, 0x00, 0x78, 0xF0, 0x7E, 0x60, 0x00, 0x12, 0x6A, 0x7E}));
}

}  // namespace
}  // namespace kelvo::wire
