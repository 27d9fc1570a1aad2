#include "LogGenerator/OSKLogGenerator.h"

#include <gtest/gtest.h>

#include <chrono>

#include "LogGenerator/DLFVersionReport.h"
#include "platform/system/Environment.h"
#include "tests/support/ManualClock.h"
#include "tests/support/RecordingLog.h"

namespace kelvo {
namespace {

using Lines = std::vector<test::RecordingLog::Line>;

class Generator final : public OSKLogGenerator {
public:
    void updateState(Dictionary&, ByteView) override {}
    Value generateLogUsingState(Dictionary&) override { return {}; }
    DictionaryRef getStartCommand() override { return nullptr; }
};

DictionaryRef snapshot(Value displayState) {
    return Dictionary::make({{"DisplayState", std::move(displayState)}, {"Description", "Snapshot"}});
}

std::string textAt(const Bytes& bytes, std::size_t at) { return reinterpret_cast<const char*>(bytes.data() + at); }

/// `size` bytes from offset `at` on.
Bytes part(const Bytes& bytes, std::ptrdiff_t at, std::ptrdiff_t size) {
    return {bytes.begin() + at, bytes.begin() + at + size};
}

/// A zone 4 h 56 min 2 s west of UTC that does not know whether daylight-saving time is in effect.
class MeanTime final : public Clock {
public:
    TimePoint now() const override { return {}; }
    std::tm local(TimePoint) const override {
        std::tm broken{};
        broken.tm_gmtoff = -17762;
        broken.tm_isdst = -1;
        return broken;
    }
};

class Dlf : public testing::Test {
protected:
    Bytes dlf() { return OSKLogGenerator::generateDlfFromState(state).value_or(Bytes()); }

    test::RecordingLog log;
    test::ManualClock clock{0x4D70AF46, -300, true};
    Environment::Scope environment{{.log = &log, .clock = &clock, .version = "1.0"}};
    Dictionary state;
    const ArrayRef history = Array::make();
};

TEST_F(Dlf, BeginsWithTheVersionReport) {
    const Bytes bytes = dlf();
    ASSERT_EQ(bytes.size(), 161U);
    Bytes expected(161);
    const auto put = [&](std::size_t at, const Bytes& with) {
        std::copy(with.begin(), with.end(), expected.begin() + at);
    };
    put(0, {161, 0, 0xfd, 0x1f});                // length, log code 0x1ffd
    put(12, {1, 0, 1, 0});                       // two version numbers
    put(16, {'K', 'e', 'l', 'v', 'o', ' ', 0});  // cut to six characters
    put(23, {'E', 'X', 'E', 'C', 'U', 'T', 'A', 'B', 'L', 'E', '_', 'N', 'A', 'M', 'E', 0});
    put(63, {'M', 'a', 'r', ' ', ' ', '7', ' ', '2', '0', '1', '9', ' ', '2', '2', ':', '3', '5', 0});
    put(81, {0x46, 0xAF, 0x70, 0x4D});  // now
    put(85, {0xD4, 0xFE});              // -300 minutes
    put(87, {1});                       // daylight saving
    EXPECT_EQ(bytes, expected);
}

TEST_F(Dlf, TellsAZoneEastOfUtcWithoutDaylightSaving) {
    const test::ManualClock east{0, 345, false};
    const Environment::Scope there({.clock = &east});
    EXPECT_EQ(part(dlf(), 85, 3), (Bytes{0x59, 0x01, 0}));
}

TEST_F(Dlf, CutsTheSecondsOfAZoneTowardsZero) {
    const MeanTime west;
    const Environment::Scope there({.clock = &west});
    EXPECT_EQ(part(dlf(), 85, 3), (Bytes{0xD8, 0xFE, 0}));  // -296 minutes
}

TEST_F(Dlf, DropsTheFractionOfASecond) {
    clock.advance(std::chrono::milliseconds(900));
    EXPECT_EQ(part(dlf(), 81, 4), (Bytes{0x46, 0xAF, 0x70, 0x4D}));
}

TEST_F(Dlf, SaysThatTheApplicationHasNoVersion) {
    const Environment::Scope unversioned({.clock = &clock});
    EXPECT_EQ(textAt(dlf(), 16), "(none)");
}

TEST_F(Dlf, DropsTheFirstByteOfEachSnapshotAlone) {
    history->append(snapshot(Bytes{1, 10, 11, 1, 12}));
    history->append(snapshot(Bytes{7}));
    history->append(Dictionary::make());
    history->append(snapshot(Bytes{}));
    history->append(snapshot(Bytes{255, 20}));
    state.set("History", history);
    const Bytes bytes = dlf();
    EXPECT_EQ(Bytes(bytes.begin() + 161, bytes.end()), (Bytes{10, 11, 1, 12, 20}));
}

TEST_F(Dlf, IsAbandonedWhenASnapshotHoldsNoData) {
    history->append(snapshot(Bytes{1, 2, 3}));
    history->append(snapshot("text"));
    state.set("History", history);
    EXPECT_EQ(OSKLogGenerator::generateDlfFromState(state), std::nullopt);
    EXPECT_EQ(log.lines(), (Lines{{16, "Got wrong class writing history to DLF; aborting writing the DLF file"}}));

    Generator generator;
    EXPECT_EQ(Value(generator.getSaveContentsFromState(state)), Value(history));  // the snapshots are still saved
}

TEST_F(Dlf, IsNotMadeWithoutRoomForItsVersionReport) {
    history->append(snapshot(Bytes{1, 2, 3}));
    state.set("History", history);
    EXPECT_EQ(OSKLogGenerator::generateDlfFromState(state, 160), std::nullopt);
    EXPECT_EQ(log.lines(), (Lines{{16, "Could not write DLF header (result=3)"}}));
}

TEST_F(Dlf, FollowsTheHistoryInTheSaveContents) {
    Generator generator;
    ArrayRef contents = generator.getSaveContentsFromState(state);
    ASSERT_EQ(contents->size(), 1U);
    EXPECT_EQ((*(*contents)[0].dictionary())["Description"], Value("DLF binary (161 bytes)"));
    EXPECT_EQ((*(*contents)[0].dictionary())["DLF"].data()->size(), 161U);

    history->append(snapshot(Bytes{1, 2, 3}));
    state.set("History", history);
    contents = generator.getSaveContentsFromState(state);
    ASSERT_EQ(contents->size(), 2U);
    EXPECT_EQ((*contents)[0], (*history)[0]);
    EXPECT_EQ((*(*contents)[1].dictionary())["Description"], Value("DLF binary (163 bytes)"));
    EXPECT_EQ(history->size(), 1U);
}

TEST_F(Dlf, CutsTextsToTheirFields) {
    Bytes buffer(161, 0xFF);
    std::size_t written = 0;
    const std::string longText(100, 'x');
    EXPECT_EQ(DLFAddVersionReport(buffer.data(), buffer.size(), written, 2, 3, longText, longText, longText, {}),
              kDLFSuccess);
    EXPECT_EQ(written, 161U);
    EXPECT_EQ(textAt(buffer, 16), std::string(6, 'x'));
    EXPECT_EQ(textAt(buffer, 23), std::string(15, 'x'));
    EXPECT_EQ(textAt(buffer, 63), std::string(17, 'x'));
    EXPECT_EQ(buffer[12], 2);
    EXPECT_EQ(buffer[14], 3);
}

TEST_F(Dlf, LeavesTheFieldsOfEmptyTextsEmpty) {
    Bytes buffer(161, 0xFF);
    std::size_t written = 0;
    EXPECT_EQ(DLFAddVersionReport(buffer.data(), buffer.size(), written, 1, 1, {}, {}, {}, {}), kDLFSuccess);
    EXPECT_EQ(part(buffer, 16, 65), Bytes(65));
}

TEST_F(Dlf, WritesVersionNumbersLowByteFirst) {
    Bytes buffer(161);
    std::size_t written = 0;
    EXPECT_EQ(DLFAddVersionReport(buffer.data(), buffer.size(), written, 0x0102, 0x0304, "", "", "", {}), kDLFSuccess);
    EXPECT_EQ(part(buffer, 12, 4), (Bytes{2, 1, 4, 3}));
}

TEST_F(Dlf, RefusesABufferThatIsTooSmall) {
    Bytes buffer(160, 0xFF);
    std::size_t written = 7;
    EXPECT_EQ(DLFAddVersionReport(buffer.data(), buffer.size(), written, 1, 1, "", "", "", {}), 3);
    EXPECT_EQ(written, 0U);
    EXPECT_EQ(buffer, Bytes(160, 0xFF));
}

}  // namespace
}  // namespace kelvo
