#include <gtest/gtest.h>

#include "platform/system/Environment.h"
#include "telephony/ModemSource.h"
#include "telephony/SimulationStream.h"
#include "telephony/wire/modem/ModemPlayer.h"
#include "telephony/wire/modem/StreamRecords.h"
#include "tests/support/ManualClock.h"
#include "tests/support/ManualQueue.h"
#include "tests/support/RecordingLog.h"
#include "tests/telephony/PlayedModemCable.h"

namespace kelvo::test {
namespace {

using namespace std::chrono_literals;
using modem::Fault;
using modem::Faults;

/// The service's source at a played modem of a fault, for as long as a test lets time pass, and a client that takes
/// all.
class ModemSourceFaultsTest : public testing::Test, public RecordSink {
protected:
    void play(const char* faults, std::chrono::nanoseconds time) {
        _source.reset();
        const auto cable = std::make_shared<Cable>();
        const auto now = [this] { return _queue.now() + 1000s; };
        const auto drive = [](std::uint64_t seed) {
            return std::make_unique<modem::StreamRecords>(std::make_unique<SimulationStream>(Technology::LTE, seed));
        };
        const Faults chosen = *Faults::parse(faults);
        _player = std::make_unique<modem::ModemPlayer>(
            std::make_unique<modem::PlayedModem>(drive(1), chosen.has(Fault::TwoSims) ? drive(2) : nullptr, chosen, 1),
            std::make_unique<CablePort>(cable, _queue), _queue, now, [](const std::string&) {});
        _log.clear();
        _taken = 0;
        ASSERT_TRUE(_player->start());
        _source = std::make_unique<ModemSource>(
            std::make_unique<CableLines>(cable, _queue),
            wire::Session::Options{.technology = Technology::LTE, .subscription = {}}, _queue, now);
        _source->start(*this);
        ClientsWishes wishes{.streaming = true, .ordinary = {}};
        for (const std::size_t code : {0xB0C1, 0xB0C2, 0xB179, 0xB17F, 0xB180, 0xB186, 0xB200})
            wishes.ordinary.set(code);
        _source->clientsWant(wishes);
        _queue.advance(time);
    }
    bool take(ByteView) override { return ++_taken > 0; }
    bool isHungry() const override { return true; }

    std::vector<std::string> lines() const {
        std::vector<std::string> texts;
        for (const auto& line : _log.lines()) texts.push_back(line.second);
        return texts;
    }
    std::int64_t count(const char* key) const { return (*_source->portStatus())[key].number()->integer(); }
    /// What the service counts is what the modem knows it has sent and spoilt.
    void expectCountsOf(Fault fault) {
        const auto counted = [this](const char* key) { return static_cast<std::uint64_t>(count(key)); };
        const modem::Tally& sent = _player->tally();
        for (int i = 0; i < 10 && counted("Unfinished") < sent.cutOff; ++i) _queue.advance(100ms);  // while it hangs up
        EXPECT_EQ(counted("Delivered"), _taken);
        EXPECT_EQ(counted("Records"), counted("Delivered") + counted("OtherSubscriptions"));
        EXPECT_EQ(counted("OtherSubscriptions"), sent.whole[1]);
        EXPECT_EQ(counted("BadEscapes"), sent.badEscapes);
        EXPECT_EQ(counted("LyingLengths"), sent.lyingLengths);
        EXPECT_EQ(counted("Encrypted"), sent.encrypted);
        EXPECT_EQ(counted("Unfinished"), sent.cutOff);
        EXPECT_EQ(counted("Oversized"), sent.oversized);
        EXPECT_EQ(counted("StrangeWrappers"), 0U);
        // What came before it was asked counts for nothing, and a flood has always more on its way.
        EXPECT_TRUE(fault == Fault::EarlierSession || fault == Fault::Flood || _taken == sent.whole[0]) << _taken;
        const std::uint64_t noisy = counted("BadChecksums") + counted("TooShort");
        EXPECT_LE(noisy, sent.flippedBits + sent.cutFrames + sent.noise);
        EXPECT_GE(noisy + (sent.noise > 0 ? 4 : 0), sent.flippedBits + sent.cutFrames + sent.noise);
    }
    std::string portState() const { return *(*_source->portStatus())["State"].string(); }

    ManualQueue _queue;
    RecordingLog _log;
    ManualClock _clock{1'700'000'000};
    Environment::Scope _scope{Environment{.log = &_log, .clock = &_clock}};
    std::uint64_t _taken = 0;
    std::unique_ptr<modem::ModemPlayer> _player;
    std::unique_ptr<ModemSource> _source;
};

}  // namespace

// What the service says, counts and does next; a line may go on after what stands here.
TEST_F(ModemSourceFaultsTest, EachIsToldCountedAndMetInItsWay) {
    enum Next { GoesOn, TriesAgain };
    struct Row {
        const char* fault;
        std::chrono::milliseconds time;
        Next next;
        bool givesRecords;
        std::vector<std::string> lines;
    };
    const std::string all = "0xb0c1, 0xb0c2, 0xb179, 0xb17f, 0xb180, 0xb186, 0xb200";
    const auto again = [](const std::string& trouble) { return "the modem at line: " + trouble + "; trying again"; };
    const auto noRanges = [&](const char* why) {
        return again(std::string("the modem refuses to tell which records it has: ") + why);
    };
    const std::vector<Row> rows{
        {"noise", 10s, GoesOn, true, {"line: loses records: 1 "}},
        {"flipped-bits", 10s, GoesOn, true, {"line: loses records: 1 bad checksum"}},
        {"cut-frames", 10s, GoesOn, true, {"line: loses records: 1 bad checksum"}},
        {"bad-escapes", 10s, GoesOn, true, {"line: loses records: 1 bad escape"}},
        {"lying-lengths", 10s, GoesOn, true, {"line: loses records: 1 lying length"}},
        {"oversized-frames", 30s, GoesOn, true, {"line: loses records: 1 oversized frame", "line: no longer loses"}},
        {"asynchronous",
         10s,
         GoesOn,
         true,
         {"line: loses texts: 2 texts dropped by the modem",
          "line: no longer loses texts; it was 18 texts dropped by the modem"}},
        {"slow-answers", 40s, GoesOn, true, {}},
        {"missing-answers", 60s, GoesOn, true, {}},
        {"bad-command", 10s, TriesAgain, false, {noRanges("bad command")}},
        {"bad-parameter",
         10s,
         GoesOn,
         false,
         {"line: the modem refuses a mask: bad parameter", "line: the modem refuses record " + all}},
        {"bad-length",
         10s,
         GoesOn,
         false,
         {"line: the modem refuses a mask: bad length", "line: the modem refuses record " + all}},
        {"bad-mode", 10s, TriesAgain, false, {noRanges("bad mode")}},
        {"locked", 10s, TriesAgain, false, {noRanges("locked")}},
        {"security", 10s, TriesAgain, false, {noRanges("security")}},
        {"transaction", 10s, TriesAgain, false, {noRanges("transaction")}},
        {"smaller-ranges", 10s, GoesOn, true, {"line: this modem cannot send: 0xb180, 0xb186, 0xb200"}},
        {"smaller-masks", 10s, GoesOn, true, {"line: the modem refuses record 0xb200"}},
        {"earlier-session", 10s, GoesOn, true, {}},
        {"encrypted", 10s, GoesOn, false, {"line: this modem encrypts its records"}},
        {"two-sims", 10s, GoesOn, true, {}},
        {"clock-1980", 10s, GoesOn, true, {}},
        {"hang-up",
         20s,
         GoesOn,
         true,
         {"Unplugged", "line: loses records: 1 unfinished frame",
          "line: no longer loses records; it was 1 unfinished frame", again("the modem has gone: it hung up"),
          "line: the modem is back"}},
        {"at-port", 10s, TriesAgain, false, {again("not a diagnostic port, or in use")}},
        {"silent", 10s, TriesAgain, false, {again("not a diagnostic port, or in use")}},
        {"flood", 700ms, GoesOn, true, {}},
    };
    ASSERT_EQ(rows.size(), modem::allFaults().size());
    for (std::size_t i = 0; i < rows.size(); ++i) {
        const Row& row = rows[i];
        SCOPED_TRACE(row.fault);
        EXPECT_EQ(row.fault, modem::allFaults()[i].name);
        play(row.fault, row.time);
        EXPECT_TRUE(std::ranges::equal(lines(), row.lines, [](const auto& said, const auto& beginning) {
            return said.starts_with(beginning);
        })) << testing::PrintToString(lines());
        EXPECT_EQ(_taken > 0, row.givesRecords);
        if (row.next == TriesAgain) {
            EXPECT_EQ(again(_source->state()), row.lines.back());
            EXPECT_GT(count("Openings"), 2);
        } else {
            EXPECT_EQ(_source->state(), "");
            EXPECT_EQ(portState(), "running");
        }
        expectCountsOf(modem::allFaults()[i].fault);
    }
}

}  // namespace kelvo::test
