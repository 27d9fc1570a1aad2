#include "tests/telephony/port/PortFixture.h"

using namespace kelvo;
using namespace kelvo::test;

namespace {

constexpr std::size_t kRecords = 250;

struct Drive {
    const char* family;
    const char* seed;
    const std::vector<int>* codes;
    const char* name;
};

class PortLoopTest : public PortTest, public testing::WithParamInterface<Drive> {};

INSTANTIATE_TEST_SUITE_P(
    Drives, PortLoopTest,
    testing::Values(Drive{"gsm", "1", &kGsmCodes, "GsmSeed1"}, Drive{"gsm", "7", &kUmtsCodes, "UmtsSeed7"},
                    Drive{"gsm", "12345", &kMobilityCodes, "MobilitySeed12345"},
                    Drive{"cdma", "1", &kCdmaCodes, "CdmaSeed1"}, Drive{"cdma", "7", &kCdmaCodes, "CdmaSeed7"},
                    Drive{"lte", "1", &kLteCodes, "LteSeed1"}, Drive{"lte", "7", &kLteCodes, "LteSeed7"},
                    Drive{"utran", "1", &kUtranCodes, "UtranSeed1"}, Drive{"utran", "7", &kUtranCodes, "UtranSeed7"}),
    [](const auto& info) { return std::string(info.param.name); });

}  // namespace

TEST_P(PortLoopTest, RecordsAreThoseOfTheSimulationByteForByte) {
    const auto [family, seed, codes, name] = GetParam();
    const Records expected = straight({"--simulate", family, "--seed", seed}, *codes, kRecords);
    plugModemIn({"--simulate", family, "--seed", seed, "--faults", "flood"});
    serve(family, *codes);
    ASSERT_TRUE(receive(kRecords)) << state();
    EXPECT_EQ(Records(client->records.begin(), client->records.begin() + kRecords), expected);
    EXPECT_EQ(count("BadChecksums"), 0);
    EXPECT_EQ(count("LyingLengths"), 0);
    EXPECT_EQ(lines().size(), 1U) << _logged;  // what it serves
}

TEST_F(PortTest, ARecordingOfThePortIsACaptureOfWhatTheClientHad) {
    const std::string recorded = _temporary.file("recorded.pcap");
    const std::string frames = _temporary.file("recorded.frames");
    plugModemIn({"--replay", captureOf("lte"), "--faults", "flood"});
    stream({"--port", link(), "--technology", "lte", "--record", QString::fromStdString(recorded), "--record-frames",
            QString::fromStdString(frames)},
           kLteCodes);
    const Records expected = ordinaryRecords("lte");
    ASSERT_TRUE(receive(expected.size())) << client->records.size();
    EXPECT_EQ(client->records, expected);
    stopDaemon();
    auto capture = CaptureReader::open(recorded);
    ASSERT_TRUE(capture);
    EXPECT_EQ(capture->technology(), Technology::LTE);
    Records packets;
    while (const auto packet = *capture->next()) packets.emplace_back(textOf(packet->bytes));
    EXPECT_EQ(packets, expected);
    tally();

    leave();  // the frames are a modem in their turn
    _modem.setArguments({});
    plugModemIn({"--replay", QString::fromStdString(frames), "--faults", "flood"});
    serve("lte", kLteCodes);
    ASSERT_TRUE(receive(expected.size())) << client->records.size();
    EXPECT_EQ(client->records, expected);
}

// What comes is whole under faults that lose nothing: noise costs itself, of two SIMs the first is shown.
TEST_F(PortTest, FaultsThatLoseNoRecordLoseNone) {
    const Records expected = ordinaryRecords("utran");
    plugModemIn({"--replay", captureOf("utran"), "--faults", "noise,oversized-frames,asynchronous,two-sims,flood",
                 "--seed", "3"});
    serve("utran", kUtranCodes);
    ASSERT_TRUE(receive(expected.size())) << client->records.size();
    const auto size = static_cast<std::int64_t>(expected.size());
    EXPECT_TRUE(runUntil([&] { return count("Records") == 2 * size; }));
    EXPECT_EQ(client->records, expected);
    EXPECT_EQ(count("Delivered"), size);
    EXPECT_EQ(count("OtherSubscriptions"), size);
    EXPECT_EQ(count("LyingLengths"), 0);
    const std::int64_t oversized = count("Oversized");
    const std::int64_t noise = count("BadChecksums") + count("TooShort");
    auto sent = tally();
    EXPECT_EQ(sent["whole"], size);
    EXPECT_EQ(sent["whole-second-sim"], size);
    EXPECT_EQ(oversized, sent["oversized"]);
    EXPECT_LE(noise, sent["noise"]);
    EXPECT_GE(noise + 4, sent["noise"]);  // before it listens
}

TEST_F(PortTest, OfAFaultyLineTheDamagedFramesAloneAreMissingAndCounted) {
    const Records all = ordinaryRecords("lte");
    plugModemIn({"--replay", captureOf("lte"), "--faults",
                 "flipped-bits,cut-frames,bad-escapes,lying-lengths,oversized-frames,flood", "--seed", "5"});
    serve("lte", kLteCodes);
    const auto sum = [this] {
        return count("Records") + count("BadChecksums") + count("BadEscapes") + count("LyingLengths");
    };
    ASSERT_TRUE(runUntil([&] { return sum() == static_cast<std::int64_t>(all.size()); })) << sum();
    const std::int64_t whole = count("Records");
    const std::int64_t badChecksums = count("BadChecksums");
    const std::int64_t badEscapes = count("BadEscapes");
    const std::int64_t lyingLengths = count("LyingLengths");
    const std::int64_t oversized = count("Oversized");
    ASSERT_TRUE(receive(static_cast<std::size_t>(whole)));
    auto sent = tally();
    EXPECT_EQ(whole, sent["whole"]);
    EXPECT_EQ(badChecksums, sent["flipped-bits"] + sent["cut-frames"]);
    EXPECT_EQ(badEscapes, sent["bad-escapes"]);
    EXPECT_EQ(lyingLengths, sent["lying-lengths"]);
    EXPECT_EQ(oversized, sent["oversized"]);
    EXPECT_GT(sent["flipped-bits"], 0);
    EXPECT_GT(sent["cut-frames"], 0);
    EXPECT_GT(sent["bad-escapes"], 0);
    EXPECT_GT(sent["lying-lengths"], 0);
    EXPECT_GT(sent["oversized"], 0);
    EXPECT_EQ(static_cast<std::int64_t>(client->records.size()), whole);
    EXPECT_TRUE(isIn(client->records, all));
}
