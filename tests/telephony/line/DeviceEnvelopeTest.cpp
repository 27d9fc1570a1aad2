#include "telephony/line/DeviceEnvelope.h"

#include <gtest/gtest.h>

namespace kelvo {
namespace {

struct Read {
    explicit Read(Bytes bytes) {
        good = DeviceEnvelope::unwrap(
            bytes, [this](std::span<std::uint8_t> piece) { pieces.emplace_back(piece.begin(), piece.end()); });
    }
    bool good = false;
    std::vector<Bytes> pieces;
};

}  // namespace

TEST(DeviceEnvelope, StandsBeforeEveryFrame) {
    EXPECT_EQ(DeviceEnvelope::wrap(Bytes{0x00, 0x78, 0xF0, 0x7E}), (Bytes{32, 0, 0, 0, 0x00, 0x78, 0xF0, 0x7E}));
}

TEST(DeviceEnvelope, HoldsSeveralPieces) {
    const Read read({32, 0, 0, 0, 2, 0, 0, 0, 3, 0, 0, 0, 0xA, 0xB, 0xC, 1, 0, 0, 0, 0xD});
    EXPECT_TRUE(read.good);
    EXPECT_EQ(read.pieces, (std::vector<Bytes>{{0xA, 0xB, 0xC}, {0xD}}));
}

TEST(DeviceEnvelope, GivesWhatIsWholeWhenItBreaksOff) {
    const Read read({32, 0, 0, 0, 2, 0, 0, 0, 1, 0, 0, 0, 0xA, 5, 0, 0, 0, 0xD});
    EXPECT_FALSE(read.good);
    EXPECT_EQ(read.pieces, std::vector<Bytes>{{0xA}});
    EXPECT_FALSE(Read({32, 0, 0, 0, 0xFF, 0xFF, 0xFF, 0xFF, 1, 0}).good);
}

TEST(DeviceEnvelope, RefusesOtherKinds) {
    EXPECT_FALSE(Read({33, 0, 0, 0, 1, 0, 0, 0, 1, 0, 0, 0, 0xA}).good);
    EXPECT_FALSE(Read({32, 0, 0}).good);
    EXPECT_TRUE(Read({33, 0, 0, 0, 1, 0, 0, 0, 1, 0, 0, 0, 0xA}).pieces.empty());
}

}  // namespace kelvo
