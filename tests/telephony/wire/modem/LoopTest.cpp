#include "tests/telephony/wire/modem/LoopFixture.h"

namespace kelvo::test {
namespace {

using modem::Fault;
using modem::Faults;

constexpr Technology kFamilies[] = {Technology::GSM, Technology::CDMA, Technology::LTE, Technology::UTRAN};

/// Where `part` stands in one piece in `whole`; the test fails where it does not.
std::size_t placeOf(const std::vector<Bytes>& part, const std::vector<Bytes>& whole) {
    const auto at = std::search(whole.begin(), whole.end(), part.begin(), part.end());
    EXPECT_NE(at, whole.end());
    return static_cast<std::size_t>(at - whole.begin());
}

/// Whether `part` are packets of `whole`, in its order.
bool isIn(const std::vector<Bytes>& part, const std::vector<Bytes>& whole) {
    auto from = whole.begin();
    for (const Bytes& packet : part) {
        from = std::find(from, whole.end(), packet);
        if (from == whole.end()) return false;
        ++from;
    }
    return true;
}

TEST_F(LoopTest, RecordsComeAsTheyAreOfEachFamilyAndSeveralSeeds) {
    for (const Technology technology : kFamilies) {
        for (const std::uint64_t seed : {1, 7, 12345}) {
            join(technology, {}, seed);
            playUntil(400);
            taken.resize(400);
            EXPECT_EQ(taken, straight(technology, seed, 400)) << namesOf(technology).name << ", seed " << seed;
            EXPECT_EQ(counts().damaged(), 0U);
        }
    }
}

// A modem of 2018 has two SIMs, whose codes lie beyond those of one.
TEST_F(LoopTest, RecordsOfNewerModemsComeAsTheyAre) {
    for (const Technology technology : {Technology::LTE, Technology::GSM}) {
        for (const Generation generation : {Generation::Of2014, Generation::Of2018}) {
            join(technology, {}, 1, generation);
            playUntil(400);
            taken.resize(400);
            EXPECT_EQ(taken, straight(technology, 1, 400, generation)) << namesOf(technology).name;
        }
    }
}

TEST_F(LoopTest, RecordsComeAsTheyAreUnderFaultsThatLoseNone) {
    for (const Technology technology : kFamilies) {
        const Packets all = straight(technology, 3, 2000);
        for (const Faults& faults :
             {Faults{Fault::Noise}, Faults{Fault::OversizedFrames}, Faults{Fault::Asynchronous},
              Faults{Fault::SlowAnswers}, Faults{Fault::MissingAnswers}, Faults{Fault::TwoSims}, Faults{Fault::Flood},
              Faults{Fault::EarlierSession}, Faults{Fault::EarlierSession, Fault::Asynchronous, Fault::SlowAnswers},
              Faults{Fault::TwoSims, Fault::Asynchronous, Fault::Noise, Fault::Flood}}) {
            join(technology, faults, 3);
            if (faults.has(Fault::SlowAnswers) || faults.has(Fault::MissingAnswers)) settleMasks();
            playUntil(300);
            ASSERT_GE(taken.size(), 300U) << _session->failure();
            finish();
            const std::size_t from = placeOf(taken, all);
            if (faults.has(Fault::EarlierSession)) continue;  // what came before it was asked is an earlier reader's
            EXPECT_TRUE(from == 0 || _settled);
            EXPECT_EQ(counts().records, tally().whole[0] + tally().whole[1]);
            EXPECT_LE(counts().frames.damaged(), tally().noise + tally().oversized);
            EXPECT_GE(counts().frames.damaged() + 4, tally().noise + tally().oversized);  // before it listens
        }
    }
}

TEST_F(LoopTest, ExactlyTheDamagedRecordsAreMissingAndCounted) {
    for (const Technology technology : kFamilies) {
        const Packets all = straight(technology, 5, 2000);
        for (const Faults& faults : {Faults{Fault::FlippedBits}, Faults{Fault::CutFrames}, Faults{Fault::BadEscapes},
                                     Faults{Fault::LyingLengths},
                                     Faults{Fault::FlippedBits, Fault::CutFrames, Fault::BadEscapes,
                                            Fault::LyingLengths, Fault::OversizedFrames, Fault::Asynchronous}}) {
            join(technology, faults, 5);
            playUntil(500);
            finish();
            const std::size_t sent = tally().whole[0] + tally().damaged();
            ASSERT_LE(sent, all.size());
            EXPECT_GT(tally().damaged(), 10U);
            EXPECT_EQ(taken.size(), sent - tally().damaged());
            EXPECT_TRUE(isIn(taken, Packets(all.begin(), all.begin() + static_cast<std::ptrdiff_t>(sent))));
            EXPECT_EQ(counts().frames.badChecksums, tally().flippedBits + tally().cutFrames);
            EXPECT_EQ(counts().frames.badEscapes, tally().badEscapes);
            EXPECT_EQ(counts().lyingLengths, tally().lyingLengths);
            EXPECT_EQ(counts().frames.oversized, tally().oversized);
            EXPECT_EQ(counts().frames.tooShort, 0U);
            EXPECT_EQ(counts().delivered, taken.size());
            EXPECT_TRUE(said("the modem: loses records: "));
        }
    }
}

TEST_F(LoopTest, AHundredHangUpsLoseTheRecordsThatWereCutAlone) {
    join(Technology::LTE, {Fault::HangUp, Fault::Asynchronous}, 2);
    while (tally().cutOff < 100) step();
    while (_session->state() == wire::Session::State::Running) step();
    while (_session->state() != wire::Session::State::Running) step();
    EXPECT_EQ(tally().cutOff, 100U);
    EXPECT_EQ(counts().sessions, 101U);
    EXPECT_EQ(counts().frames.unfinished, 100U);
    EXPECT_EQ(counts().frames.damaged(), 100U);
    EXPECT_EQ(taken.size(), tally().whole[0]);
    EXPECT_TRUE(isIn(taken, straight(Technology::LTE, 2, 20'000)));
}

TEST_F(LoopTest, TextsThatTheModemDroppedAreCounted) {
    join(Technology::GSM, {Fault::Asynchronous}, 4);
    playUntil(10);
    EXPECT_GT(counts().textsDropped, 0U);
    EXPECT_LE(counts().textsDropped, tally().droppedTexts);  // before the version nobody listens
}

TEST_F(LoopTest, OfTwoSimsTheFirstThatSendsIsShownAndTheOtherCounted) {
    join(Technology::LTE, {Fault::TwoSims}, 6);
    playUntil(300);
    finish();
    EXPECT_EQ(_session->subscription(), 1);
    EXPECT_EQ(taken.size(), tally().whole[0]);
    EXPECT_GT(counts().otherSubscriptions, 100U);
    EXPECT_EQ(counts().otherSubscriptions, tally().whole[1]);
}

TEST_F(LoopTest, AClockThatHasNotBeenSetChangesTheTimestampsAlone) {
    join(Technology::LTE, {Fault::Clock1980}, 6);
    playUntil(200);
    Packets expected = straight(Technology::LTE, 6, taken.size());
    for (Packets* packets : {&expected, &taken}) {
        for (Bytes& packet : *packets) std::fill(packet.begin() + 5, packet.begin() + 13, 0);
    }
    EXPECT_EQ(taken, expected);
}

TEST_F(LoopTest, EncryptedRecordsAreToldOnceAndCounted) {
    join(Technology::LTE, {Fault::Encrypted});
    for (const Time end = _now + std::chrono::seconds(10); _now < end;) step();
    EXPECT_TRUE(taken.empty());
    EXPECT_GT(counts().encrypted, 50U);
    EXPECT_EQ(counts().encrypted, tally().encrypted);
    EXPECT_EQ(std::ranges::count(lines(), "the modem: this modem encrypts its records"), 1);
    EXPECT_EQ(counts().damaged(), 0U);
}

TEST_F(LoopTest, RecordsThatTheModemHasNotAreTold) {
    for (const Technology technology : kFamilies) {
        join(technology, {Fault::SmallerRanges}, 8);
        _log.clear();
        playUntil(100);
        EXPECT_TRUE(said("the modem: this modem cannot send: "));
        EXPECT_GE(taken.size(), 100U);
    }
}

TEST_F(LoopTest, RecordsThatTheModemRefusesAreTold) {
    join(Technology::LTE, {Fault::SmallerMasks}, 8);
    playUntil(100);
    EXPECT_TRUE(said("the modem: the modem refuses record 0xb200"));  // the last of the 0x201 that it has
    EXPECT_GE(taken.size(), 100U);
}

TEST_F(LoopTest, OtherPortsOfTheModemAreNoDiagnosticPorts) {
    for (const Fault fault : {Fault::AtPort, Fault::Silent}) {
        join(Technology::LTE, {fault});
        playUntil(1);
        EXPECT_EQ(_session->failure(), "not a diagnostic port, or in use");
        EXPECT_TRUE(taken.empty());
    }
}

TEST_F(LoopTest, EveryRefusalIsToldInItsWords) {
    for (const auto& [fault, word, ranges] :
         {std::tuple(Fault::BadCommand, "bad command", true), std::tuple(Fault::BadMode, "bad mode", true),
          std::tuple(Fault::Locked, "locked", true), std::tuple(Fault::Security, "security", true),
          std::tuple(Fault::Transaction, "transaction", true), std::tuple(Fault::BadParameter, "bad parameter", false),
          std::tuple(Fault::BadLength, "bad length", false)}) {
        join(Technology::LTE, {fault});
        _log.clear();
        for (const Time end = _now + std::chrono::seconds(20); _now < end;) step();
        if (ranges) {
            EXPECT_EQ(_session->failure(), std::string("the modem refuses to tell which records it has: ") + word);
        } else {
            EXPECT_EQ(_session->failure(), "");
            EXPECT_TRUE(said(std::string("the modem: the modem refuses a mask: ") + word));
        }
        EXPECT_TRUE(taken.empty());
    }
}

TEST_F(LoopTest, LeavesAModemThatIsSilent) {
    join(Technology::LTE, {Fault::EarlierSession});
    playUntil(100);
    finish();
    const std::uint64_t whole = tally().whole[0];
    for (const Time end = _now + std::chrono::seconds(10); _now < end;) step();
    EXPECT_EQ(tally().whole[0], whole);
    EXPECT_TRUE(_modem->output(_now).empty());
}

TEST_F(LoopTest, AReaderThatWasKilledIsFollowedByOneThatGoesOn) {
    join(Technology::LTE, {}, 9);
    playUntil(100);
    const Packets before = std::exchange(taken, {});
    _session = std::make_unique<wire::Session>(
        *this, [this] { return _now; }, wire::Session::Options{.technology = Technology::LTE, .subscription = {}});
    wire::RecordCodes all;
    all.set();
    _session->want(all);
    _session->begin("the modem");  // which streams, to nobody
    playUntil(100);
    EXPECT_GE(taken.size(), 100U);
    Packets both = before;
    both.insert(both.end(), taken.begin(), taken.end());
    EXPECT_TRUE(isIn(both, straight(Technology::LTE, 9, 1000)));
    EXPECT_EQ(counts().damaged(), 0U);
}

}  // namespace
}  // namespace kelvo::test
