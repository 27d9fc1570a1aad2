#include "telephony/wire/FrameReader.h"

#include <gtest/gtest.h>

#include "tests/telephony/wire/PlainFrame.h"

namespace kelvo::wire {
namespace {

using test::joined;
using test::plainFrame;

using Bodies = std::vector<Bytes>;

const Bytes kEnd{0x7E};
const Bytes kVersion{0x00, 0x78, 0xF0, 0x7E};

/// Reads a stream in pieces of `piece` bytes.
struct Read {
    explicit Read(Bytes stream, std::size_t piece = SIZE_MAX) {
        for (std::size_t at = 0; at < stream.size(); at += piece) {
            Bytes copy(stream.begin() + static_cast<std::ptrdiff_t>(at),
                       stream.begin() + static_cast<std::ptrdiff_t>(at + std::min(piece, stream.size() - at)));
            MutableBytes input(copy);
            while (const auto body = reader.next(input)) {
                bodies.emplace_back(body->begin(), body->end());
                std::ranges::fill(*body, 0xEE);  // it may be written to
            }
            EXPECT_TRUE(input.empty());
        }
    }
    FrameReader reader;
    Bodies bodies;
    const FrameReader::Counts& counts = reader.counts();
};

TEST(FrameReader, ReadsTheFramesThatEveryModemKnows) {
    const Read read({0x00, 0x78, 0xF0, 0x7E, 0x7C, 0x93, 0x49, 0x7E, 0x60, 0x00, 0x12, 0x6A,
                     0x7E, 0x73, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0xDA, 0x81, 0x7E,  //
                     0x7D, 0x5D, 0x05, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x74, 0x41, 0x7E});
    EXPECT_EQ(read.bodies,
              (Bodies{{0x00}, {0x7C}, {0x60, 0x00}, {0x73, 0, 0, 0, 0, 0, 0, 0}, {0x7D, 5, 0, 0, 0, 0, 0, 0}}));
    EXPECT_EQ(read.counts.frames, 5U);
    EXPECT_EQ(read.counts.bytes, 36U);
    EXPECT_EQ(read.counts.damaged(), 0U);
}

TEST(FrameReader, TakesEscapesOutOfBodyAndChecksum) {
    const Read read({0x28, 0x18, 0x7D, 0x5D, 0x7D, 0x5E, 0x7E, 0x7D, 0x5E, 0x81, 0x6A, 0x7E});
    EXPECT_EQ(read.bodies, (Bodies{{0x28, 0x18}, {0x7E}}));
}

TEST(FrameReader, IgnoresEmptyFrames) {
    const Read read({0x7E, 0x7E, 0x00, 0x78, 0xF0, 0x7E, 0x7E, 0x7E, 0x00, 0x78, 0xF0, 0x7E});
    EXPECT_EQ(read.bodies, (Bodies{{0x00}, {0x00}}));
    EXPECT_EQ(read.counts.damaged(), 0U);
}

TEST(FrameReader, CountsADamagedFirstFrameForNothing) {
    for (const Bytes& partial : {Bytes{0x78, 0xF0, 0x7E}, Bytes{0xF0, 0x7E}, Bytes{0x01, 0x7D, 0x33, 0xF0, 0x7E}}) {
        const Read read(joined({partial, kVersion}));
        EXPECT_EQ(read.bodies, Bodies{{0x00}});
        EXPECT_EQ(read.counts.damaged(), 0U);
    }
    Bytes endless(200'000, 0x11);
    const Read read(joined({endless, kEnd, kVersion}), 1'000);
    EXPECT_EQ(read.bodies, Bodies{{0x00}});
    EXPECT_EQ(read.counts.damaged(), 0U);
}

TEST(FrameReader, ABadChecksumCostsThatFrameAlone) {
    const Read read(joined({kVersion, {0x00, 0x78, 0xF1, 0x7E}, {0x60, 0x00, 0x12, 0x6A, 0x7E}}));
    EXPECT_EQ(read.bodies, (Bodies{{0x00}, {0x60, 0x00}}));
    EXPECT_EQ(read.counts.badChecksums, 1U);
    EXPECT_EQ(read.counts.damaged(), 1U);
    EXPECT_EQ(read.counts.frames, 2U);
}

TEST(FrameReader, RefusesAnEscapeOfAnythingElse) {
    const Read read(joined({kVersion, {0x01, 0x7D, 0x5F, 0x02, 0x03, 0x7E}, {0x01, 0x02, 0x03, 0x7D, 0x7E}, kVersion}));
    EXPECT_EQ(read.bodies, (Bodies{{0x00}, {0x00}}));
    EXPECT_EQ(read.counts.badEscapes, 2U);
    EXPECT_EQ(read.counts.damaged(), 2U);
}

TEST(FrameReader, DropsFramesOfFewerThanThreeBytes) {
    // The third has three on the wire and two once they are read: the checksum of nothing would be right.
    const Read read(joined({kVersion, {0x00, 0x7E}, {0x00, 0x00, 0x7E}, {0x7D, 0x5D, 0x00, 0x7E}, kVersion}));
    EXPECT_EQ(read.bodies, (Bodies{{0x00}, {0x00}}));
    EXPECT_EQ(read.counts.tooShort, 3U);
    EXPECT_EQ(read.counts.damaged(), 3U);
}

// 65,549 bytes that are all escaped, and a checksum of two: with the end mark 131,101, and 131,105 are allowed.
TEST(FrameReader, ReadsTheLongestFrameThatThereIs) {
    const Bytes longest(65'549, 0x7D);
    const Bytes frame = plainFrame(longest);
    ASSERT_GE(frame.size(), 2U * 65'549 + 3);
    for (const std::size_t piece : {SIZE_MAX, std::size_t{4096}}) {
        const Read read(joined({kVersion, frame, kVersion}), piece);
        EXPECT_EQ(read.bodies, (Bodies{{0x00}, longest, {0x00}}));
        EXPECT_EQ(read.counts.damaged(), 0U);
    }
}

TEST(FrameReader, DropsALongerOneOnceAndGoesOnBehindIt) {
    for (const std::size_t piece : {SIZE_MAX, std::size_t{4096}, std::size_t{1}}) {
        const Bytes noise(131'105, 0x20);
        const Read read(joined({kVersion, noise, kEnd, kVersion}), piece);
        EXPECT_EQ(read.bodies, (Bodies{{0x00}, {0x00}}));
        EXPECT_EQ(read.counts.oversized, 1U);
        EXPECT_EQ(read.counts.damaged(), 1U);
        EXPECT_EQ(read.counts.bytes, 131'114U);
    }
    const Bytes whole(131'104, 0x20);  // not too long: its checksum is wrong
    const Read read(joined({kVersion, whole, kEnd}), 4096);
    EXPECT_EQ(read.counts.oversized, 0U);
    EXPECT_EQ(read.counts.badChecksums, 1U);
}

TEST(FrameReader, CountsAnEndlessFrameOnce) {
    const Read read(joined({kVersion, Bytes(1'000'000, 0x42)}), 10'000);
    EXPECT_EQ(read.counts.oversized, 1U);
    EXPECT_EQ(read.counts.bytes, 1'000'004U);
}

// A stream with every fault in it, cut into reads of every size and at random: always the same frames and counts.
TEST(FrameReader, GivesTheSameWhereverReadsAreCut) {
    std::uint32_t state = 7;
    const auto random = [&state](std::uint32_t below) {
        state = state * 1'664'525 + 1'013'904'223;
        return (state >> 8) % below;
    };
    Bytes stream{0xF0, 0x7E};
    Bodies bodies;
    for (int i = 0; i < 300; ++i) {
        Bytes body(1 + random(40));
        for (std::uint8_t& byte : body)
            byte = static_cast<std::uint8_t>(random(4) == 0 ? 0x7D + random(2) : random(256));
        Bytes frame = plainFrame(body);
        switch (random(8)) {
            case 0: frame = {0x7E}; break;
            case 1: frame = {0x01, 0x7E}; break;
            case 2: frame = {0x01, 0x02, 0x7D, 0x20, 0x7E}; break;
            case 3: frame = {0x01, 0x02, 0x03, 0x04, 0x7E}; break;
            default: bodies.push_back(body);
        }
        stream.insert(stream.end(), frame.begin(), frame.end());
    }
    const Read whole(stream);
    EXPECT_EQ(whole.bodies, bodies);
    EXPECT_GT(whole.counts.tooShort, 0U);
    EXPECT_GT(whole.counts.badEscapes, 0U);
    EXPECT_GT(whole.counts.badChecksums, 0U);
    for (std::size_t piece = 1; piece < 64; ++piece) {
        const Read cut(stream, piece);
        EXPECT_EQ(cut.bodies, bodies) << piece;
        EXPECT_EQ(cut.counts, whole.counts) << piece;
    }
}

}  // namespace
}  // namespace kelvo::wire
