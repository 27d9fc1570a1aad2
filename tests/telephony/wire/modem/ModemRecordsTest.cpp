#include <gtest/gtest.h>

#include "platform/host/Capture.h"
#include "telephony/wire/modem/FramesRecords.h"
#include "telephony/wire/modem/StreamRecords.h"
#include "tests/support/TemporaryDirectory.h"
#include "tests/telephony/wire/PlainFrame.h"

namespace kelvo::modem {
namespace {

using namespace std::chrono_literals;
using test::joined;
using test::plainFrame;

/// Packets that a test makes up, half a second apart.
class TestStream final : public RecordStream {
public:
    explicit TestStream(std::vector<Bytes> packets) : _packets(std::move(packets)) {}
    Technology technology() const override { return Technology::LTE; }
    std::string description() const override { return "a test"; }
    std::optional<CapturePacket> next() override {
        if (_next == _packets.size()) return std::nullopt;
        const CaptureTime time(1000s + _next * 500ms);
        return CapturePacket{time, _packets[_next++]};
    }

private:
    const std::vector<Bytes> _packets;
    std::size_t _next = 0;
};

const Bytes kRecord{14, 0, 0xC2, 0xB0, 1, 2, 3, 4, 5, 6, 7, 8, 0xAA, 0xBB};

std::vector<std::pair<std::chrono::nanoseconds, Bytes>> all(ModemRecords& records) {
    std::vector<std::pair<std::chrono::nanoseconds, Bytes>> read;
    while (const auto record = records.next())
        read.emplace_back(record->at, Bytes(record->bytes.begin(), record->bytes.end()));
    return read;
}

using Read = decltype(all(std::declval<ModemRecords&>()));

TEST(StreamRecords, AreThePacketsOfTheModemWithoutTheirFrame) {
    StreamRecords records(std::make_unique<TestStream>(std::vector<Bytes>{
        joined({{0x01}, kRecord}), joined({{0x81, 0x00, 0x01}, kRecord}), joined({{0xFF}, kRecord})}));
    EXPECT_EQ(all(records), (Read{{0ms, kRecord}, {500ms, kRecord}}));
}

TEST(StreamRecords, AreNothingThatIsNoRecord) {
    StreamRecords records(std::make_unique<TestStream>(std::vector<Bytes>{
        {}, {0x81}, {0x01, 3, 0, 0xC2}, joined({{0x02}, kRecord}), Bytes(70'000, 0x01), joined({{0x01}, kRecord})}));
    EXPECT_EQ(all(records), (Read{{2500ms, kRecord}}));
}

TEST(StreamRecords, HaveTheirOwnLength) {
    Bytes wrong = kRecord;
    wrong[0] = 99;
    StreamRecords records(std::make_unique<TestStream>(std::vector<Bytes>{joined({{0x01}, wrong})}));
    EXPECT_EQ(all(records), (Read{{0ms, kRecord}}));
}

class FramesRecordsTest : public testing::Test {
protected:
    Read read(const Bytes& file) {
        auto records = FramesRecords::open(_directory.write("some.frames", file));
        EXPECT_TRUE(records);
        return records ? all(**records) : Read{};
    }
    // A record so many seconds after 2023-12-06 04:04:26.
    static Bytes record(std::uint64_t seconds) {
        const std::uint64_t time = 72'659'535'985'485'082 + (seconds * 800 << 16);
        Bytes made = kRecord;
        for (int i = 0; i < 8; ++i) made[4 + i] = static_cast<std::uint8_t>(time >> (8 * i));
        return made;
    }
    static Bytes frame(const Bytes& record) { return plainFrame(joined({{0x10, 0, record[0], record[1]}, record})); }

    test::TemporaryDirectory _directory;
};

TEST_F(FramesRecordsTest, HaveTheTimeBetweenThemThatTheySay) {
    EXPECT_EQ(
        read(joined({frame(record(0)), frame(record(2)), frame(record(100)), frame(record(99)), frame(record(101))})),
        (Read{{0s, record(0)}, {2s, record(2)}, {7s, record(100)}, {7s, record(99)}, {8s, record(101)}}));
}

TEST_F(FramesRecordsTest, OfAClockThatIsNotSetComeWithTheOneBefore) {
    EXPECT_EQ(read(joined({frame(kRecord), frame(record(0)), frame(kRecord), frame(record(3))})),
              (Read{{0s, kRecord}, {0s, record(0)}, {0s, kRecord}, {3s, record(3)}}));
}

TEST_F(FramesRecordsTest, LeaveOutWhatIsDamagedAndWhatIsNoRecord) {
    Bytes damaged = frame(record(1));
    damaged[5] ^= 1;
    const Bytes wrapped = plainFrame(joined({{0x98, 1, 0, 0, 1, 0, 0, 0, 0x10, 0, 14, 0}, record(1)}));
    EXPECT_EQ(read(joined({frame(record(0)),
                           damaged,
                           plainFrame({0x60, 0, 0}),
                           {0x7E, 0x7E},
                           plainFrame({0x98, 1}),
                           plainFrame(joined({{0x10, 0, 15, 0}, record(1)})),
                           wrapped})),
              (Read{{0s, record(0)}, {1s, record(1)}}));
}

TEST_F(FramesRecordsTest, AreReadFromFilesLongerThanAChunk) {
    Bytes file;
    for (int i = 0; i < 4000; ++i) file = joined({std::move(file), frame(record(1))});
    EXPECT_EQ(read(file).size(), 4000U);
}

TEST_F(FramesRecordsTest, OfAFileWithoutAnyAreRefusedByItsName) {
    const std::string empty = _directory.write("empty.frames", {});
    EXPECT_EQ(FramesRecords::open(empty).error().reason, empty + ": holds no record as a diagnostic port frames it");
    const std::string missing = _directory.file("missing.frames");
    EXPECT_EQ(FramesRecords::open(missing).error().reason, missing + " cannot be read");
}

}  // namespace
}  // namespace kelvo::modem
