#include "telephony/AdaptedStream.h"

#include <gtest/gtest.h>

#include <set>

#include "LogGenerator/Framing.h"
#include "telephony/SimulationStream.h"

using namespace kelvo;
using adaptation::Adapted;
using simulation::Generation;

namespace {

/// The ordinary codes among the next thousand packets; each must be in a fixed layout.
std::set<LogCode> fixedCodes(RecordStream& stream) {
    std::set<LogCode> codes;
    adaptation::RecordAdapter adapter;
    for (int i = 0; i < 1000; ++i) {
        const auto packet = stream.next();
        if (!packet) break;
        const ByteView stripped = stripPrefix(packet->bytes);
        EXPECT_EQ(adapter.adapt(stripped).outcome, Adapted::Outcome::Passed);
        if (logCode(stripped.data()) < 0xFF0000) codes.insert(logCode(stripped.data()));
    }
    return codes;
}

/// Plays the packets it has.
struct Packets final : RecordStream {
    explicit Packets(std::vector<Bytes> list) : packets(std::move(list)) {}
    Technology technology() const override { return Technology::LTE; }
    std::string description() const override { return "packets"; }
    std::optional<CapturePacket> next() override {
        if (given == packets.size()) return std::nullopt;
        return CapturePacket{CaptureTime(std::chrono::seconds(given)), packets[given++]};
    }
    std::vector<Bytes> packets;
    std::size_t given = 0;
};

}  // namespace

TEST(AdaptedStream, GivesANewerModemsDriveInTheFixedLayouts) {
    AdaptedStream stream(std::make_unique<SimulationStream>(Technology::LTE, 1, Generation::Of2018));
    EXPECT_EQ(stream.description(), "a simulated LTE modem of 2018, seed 1");
    EXPECT_EQ(stream.technology(), Technology::LTE);
    EXPECT_EQ(fixedCodes(stream), (std::set<LogCode>{0xB0C1, 0xB0C2, 0xB179, 0xB17F, 0xB180, 0xB186}));
}

TEST(AdaptedStream, LeavesOutWhatCannotBeTurned) {
    Bytes unknown(13 + 2);  // 0xB0C1 of two bytes, version 9
    unknown[0] = 1;
    unknown[1] = 14;
    unknown[3] = 0xC1;
    unknown[4] = 0xB0;
    unknown[13] = 9;
    Bytes fixed(13 + 9);
    fixed[0] = 1;
    fixed[1] = 21;
    fixed[3] = 0xC1;
    fixed[4] = 0xB0;
    fixed[13] = 1;
    AdaptedStream stream(std::make_unique<Packets>(std::vector{unknown, fixed, unknown}));
    const auto packet = stream.next();
    ASSERT_TRUE(packet);
    EXPECT_EQ(Bytes(packet->bytes.begin(), packet->bytes.end()), fixed);
    EXPECT_EQ(packet->time.time_since_epoch(), std::chrono::seconds(1));
    EXPECT_FALSE(stream.next());
}

TEST(SimulationStream, SaysItsGenerationUnlessItIsTheOneThatTheScreensRead) {
    EXPECT_EQ(SimulationStream(Technology::LTE, 7).description(), "a simulated LTE modem, seed 7");
    EXPECT_EQ(SimulationStream(Technology::GSM, 7, Generation::Of2014).description(),
              "a simulated GSM modem of 2014, seed 7");
}
