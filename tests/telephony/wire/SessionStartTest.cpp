#include "tests/telephony/wire/SessionFixture.h"

using namespace kelvo;
using namespace kelvo::test;

namespace {

const Bytes kEventsOff{0x60, 0x00, 0x12, 0x6A, 0x7E};
const Bytes kRecordsOff{0x73, 0, 0, 0, 0, 0, 0, 0, 0xDA, 0x81, 0x7E};
const Bytes kTextsOff{0x7D, 0x5D, 0x05, 0, 0, 0, 0, 0, 0, 0x74, 0x41, 0x7E};
const Bytes kVersion{0x00, 0x78, 0xF0, 0x7E};

}  // namespace

TEST_F(SessionTest, SilencesWhatAnEarlierReaderLeftRunning) {
    session->begin("port");
    EXPECT_EQ(sent, (std::vector<Bytes>{kEventsOff, kRecordsOff, kTextsOff}));
    sent.clear();
    pass(199ms);
    EXPECT_TRUE(sent.empty());
    pass(1ms);
    EXPECT_EQ(sent, std::vector<Bytes>{kVersion});
}

TEST_F(SessionTest, WaitsUntilTwoHundredMillisecondsWereQuiet) {
    open();
    pass(150ms);
    say(recordOf(0xB0C2));
    pass(150ms);
    EXPECT_TRUE(sent.empty());
    EXPECT_EQ(session->deadline(), now + 50ms);
    pass(50ms);
    EXPECT_EQ(sent, std::vector<Bytes>{kVersion});
    EXPECT_EQ(session->counts().frames.bytes, 0U);  // an earlier reader's are not counted
}

TEST_F(SessionTest, WaitsForQuietForTwoSecondsAtMost) {
    open();
    for (int i = 0; i < 19; ++i) {
        say(recordOf(0xB0C2));
        pass(100ms);
    }
    EXPECT_TRUE(sent.empty());
    sayRaw({0x10, 0x00, 0x33});  // of a frame that is not over
    pass(100ms);
    EXPECT_EQ(sent, std::vector<Bytes>{kVersion});
    sayRaw({0x44, 0x55, 0x7E});
    EXPECT_EQ(session->counts().damaged(), 0U);
    say(kVersionAnswer);
    EXPECT_EQ(session->state(), State::Naming);
}

TEST_F(SessionTest, AsksOneThingAtATimeAndInThisOrder) {
    want({0xB0C2, 0x5134});
    comeToRanges();
    EXPECT_EQ(session->target(), "TARGET9");
    EXPECT_EQ(session->buildId(), "B-7");
    tellRanges();
    for (std::uint32_t id = 0; id < 16; ++id) {
        const Bytes asked = request();
        const std::uint32_t items = id == 1 ? 0x200 : id == 4 ? 0x210 : id == 5 ? 0x220 : id == 0xB ? 0x201 : 0;
        EXPECT_EQ(asked, joined({{0x73, 0, 0, 0, 3, 0, 0, 0}, little32(id), little32(items), Bytes((items + 7) / 8)}));
        EXPECT_EQ(session->state(), State::Emptying);
        say(maskAnswer(asked));
    }
    Bytes gsm(0x44);
    gsm[0x134 / 8] = 1 << 0x134 % 8;
    EXPECT_EQ(sent.size(), 1U);
    EXPECT_EQ(plainBody(sent[0]), joined({{0x73, 0, 0, 0, 3, 0, 0, 0}, little32(5), little32(0x220), gsm}));
    agree();
    Bytes lte(0x41);
    lte[0x0C2 / 8] = 1 << 0x0C2 % 8;
    EXPECT_EQ(plainBody(sent[0]), joined({{0x73, 0, 0, 0, 3, 0, 0, 0}, little32(0xB), little32(0x201), lte}));
    agree();
    EXPECT_TRUE(sent.empty());
    EXPECT_FALSE(session->deadline());
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(SessionTest, AsksForTheVersionTwiceAndThenCallsThePortNoDiagnosticOne) {
    open();
    beQuiet();
    EXPECT_EQ(request(), Bytes{0x00});
    pass(999ms);
    EXPECT_TRUE(sent.empty());
    sayRaw({'\r', '\n', 'E', 'R', 'R', 'O', 'R', '\r', '\n'});
    pass(1ms);
    EXPECT_EQ(request(), Bytes{0x00});
    pass(1s);
    EXPECT_EQ(session->failure(), "not a diagnostic port, or in use");
    EXPECT_EQ(sent, (std::vector<Bytes>{kEventsOff, kRecordsOff, kTextsOff}));
    EXPECT_EQ(session->state(), State::Ending);
    pass(200ms);
    EXPECT_EQ(session->state(), State::Closed);
    EXPECT_EQ(session->failure(), "not a diagnostic port, or in use");
}

TEST_F(SessionTest, TakesAPortThatSendsBackWhatItIsAskedForNoModem) {
    open();
    beQuiet();
    sayRaw(kVersion);
    EXPECT_EQ(session->state(), State::Identifying);
    pass(1s);
    sayRaw(kVersion);
    pass(1s);
    EXPECT_EQ(session->failure(), "not a diagnostic port, or in use");
}

TEST_F(SessionTest, GetsAlongWithAModemBehindAnEcho) {
    want({0xB0C2});
    open();
    beQuiet();
    for (const Bytes& answer : {kVersionAnswer, kBuildIdAnswer, rangesAnswer()}) {
        const Bytes asked = request();
        say(asked);
        say(answer);
    }
    for (int i = 0; i < 17; ++i) {
        say(plainBody(sent.back()));
        agree();
    }
    EXPECT_EQ(session->state(), State::Running);
    EXPECT_TRUE(sent.empty());
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(SessionTest, NeedsFortySevenBytesOfVersion) {
    open();
    beQuiet();
    say(Bytes(46));
    EXPECT_EQ(session->state(), State::Identifying);
    EXPECT_EQ(lines(), std::vector<std::string>{"port: an answer of 46 bytes is too short"});
    say(Bytes(47));
    EXPECT_EQ(session->state(), State::Naming);
}

TEST_F(SessionTest, GoesOnWithoutABuildId) {
    open();
    beQuiet();
    tellVersion();
    EXPECT_EQ(request(), Bytes{0x7C});
    pass(2s);
    tellRanges();
    EXPECT_EQ(session->state(), State::Emptying);
    EXPECT_EQ(session->buildId(), "");
}

TEST_F(SessionTest, GoesOnWhenItIsRefusedVersionAndBuildId) {
    open();
    beQuiet();
    sent.clear();
    say({0x47, 0x00});
    EXPECT_EQ(request(), Bytes{0x7C});
    say({0x13, 0x7C});
    tellRanges();
    EXPECT_EQ(session->state(), State::Emptying);
    EXPECT_EQ(lines(), std::vector<std::string>{"port: the modem refuses to tell its version: security"});
}

TEST_F(SessionTest, AsksForRangesThreeTimesFiveSecondsApart) {
    comeToRanges();
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(request(), (Bytes{0x73, 0, 0, 0, 1, 0, 0, 0}));
        EXPECT_EQ(session->deadline(), now + 5s);
        pass(4999ms);
        EXPECT_TRUE(sent.empty());
        pass(1ms);
    }
    EXPECT_EQ(session->failure(), "the modem does not tell which records it has");
    EXPECT_EQ(session->state(), State::Ending);
}

TEST_F(SessionTest, EndsWhenTheModemRefusesItsRanges) {
    for (const auto& [first, text] : std::vector<std::pair<std::uint8_t, std::string>>{{0x13, "bad command"},
                                                                                       {0x14, "bad parameter"},
                                                                                       {0x15, "bad length"},
                                                                                       {0x18, "bad mode"},
                                                                                       {0x42, "locked"},
                                                                                       {0x47, "security"},
                                                                                       {0x94, "transaction"}}) {
        comeToRanges();
        say({first, 0x73, 0, 0, 0, 1, 0, 0, 0});
        EXPECT_EQ(session->failure(), "the modem refuses to tell which records it has: " + text);
        session->lose();
    }
    comeToRanges();
    say({0x73, 0, 0, 0, 1, 0, 0, 0, 5, 0, 0, 0});
    EXPECT_EQ(session->failure(), "the modem refuses to tell which records it has: status 5");
}

TEST_F(SessionTest, PassesByEverythingThatIsNotTheAnswer) {
    const std::vector<Bytes> others{
        recordOf(0xB0C2),                // an earlier reader's
        {0x60, 0x00, 0x01, 0x02},        // an event
        {0x60, 0x00},                    // the late answer to "events off"
        {0x79, 0x00, 0x00, 0x00, 0x01},  // a text
        {0x92, 0x01},
        {0x99, 0x01},
        {0x9D, 0x01},                             // compressed ones
        {0x73, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0},  // the late answer to "records off"
        {0x7D, 0x05, 0, 0, 1, 0, 0, 0, 0},        // the late answer to "texts off"
        {0x13, 0x60, 0x00},                       // a late refusal
        {0x15, 0x7D, 0x05, 0, 0, 0, 0, 0, 0, 0},  // another
        {0x13},
        {0x47},  // refusals of nothing
    };
    const auto sayOthers = [&] {
        for (const Bytes& other : others) {
            say(other);
            say(wrapped(1, other));
        }
    };
    want({0xB0C2});
    open();
    beQuiet();
    for (const Bytes& answer : {kVersionAnswer, kBuildIdAnswer, rangesAnswer()}) {
        sayOthers();
        ASSERT_EQ(sent.size(), 1U);
        sent.clear();
        say(answer);
    }
    for (int id = 0; id < 16; ++id) {
        sayOthers();
        agree();
    }
    EXPECT_EQ(session->state(), State::Running);
    EXPECT_TRUE(taken.empty());
    EXPECT_EQ(session->counts().records, 0U);
    EXPECT_EQ(session->counts().damaged(), 0U);
}

TEST_F(SessionTest, TakesAnswersOfWhateverSubscription) {
    want({0xB0C2});
    open();
    beQuiet();
    std::uint32_t subscription = 0;
    for (const Bytes& answer : {kVersionAnswer, kBuildIdAnswer, rangesAnswer()}) {
        sent.clear();
        say(wrapped(subscription++, answer));
    }
    for (int id = 0; id < 17; ++id) say(wrapped(0xFFFFFFFF, maskAnswer(request())));
    EXPECT_EQ(session->state(), State::Running);
    EXPECT_TRUE(sent.empty());
}

TEST_F(SessionTest, PassesByTheMaskOfAnotherEquipment) {
    comeToRanges();
    tellRanges();
    agree();  // 0
    const Bytes one = request();
    say({0x73, 0, 0, 0, 3, 0, 0, 0, 0, 0, 0, 0, 2, 0, 0, 0, 0, 0, 0, 0});
    EXPECT_TRUE(sent.empty());
    say({0x14, 0x73, 0, 0, 0, 3, 0, 0, 0, 2, 0, 0, 0, 0, 0, 0, 0});
    EXPECT_TRUE(sent.empty());
    say(maskAnswer(one));
    EXPECT_EQ(request()[8], 2);
}

TEST_F(SessionTest, DoesNotWaitLongForEquipmentThatTheModemDoesNotHave) {
    comeToRanges();
    tellRanges();
    EXPECT_EQ(request()[8], 0);  // none of it
    pass(1s);
    const Bytes one = request();
    EXPECT_EQ(one[8], 1);
    pass(1s);
    EXPECT_TRUE(sent.empty());
    say({0x14, 0x73, 0, 0, 0, 3, 0, 0, 0, 1, 0, 0, 0});  // refused: it is empty all the same
    EXPECT_EQ(request()[8], 2);
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(SessionTest, GivesUpOnAModemThatAnswersNoMask) {
    comeToRanges();
    tellRanges();
    agree();  // 0
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(request()[8], 1);
        pass(5s);
    }
    EXPECT_EQ(session->failure(), "the modem does not answer any more");
}

// After a repeat answers come twice, the second one while the next question to the same equipment waits.
TEST_F(SessionTest, TakesNoAnswerToAnEarlierQuestionForThatToALaterOne) {
    want({0xB0C2});
    comeToRanges();
    tellRanges();
    for (int id = 0; id < 0xB; ++id) agree();
    const Bytes empty = request();
    pass(5s);  // asked again
    EXPECT_EQ(request(), empty);
    say(maskAnswer(empty));
    for (int id = 0xC; id < 16; ++id) agree();
    const Bytes wanted = request();
    say(maskAnswer(empty));  // the second answer
    EXPECT_TRUE(log.lines().empty());
    say(maskAnswer(wanted));
    EXPECT_TRUE(log.lines().empty());
    EXPECT_FALSE(session->deadline());
}

TEST_F(SessionTest, BeginsAnewWhenThePortIsOpenedAgain) {
    runWith();
    session->lose();
    EXPECT_EQ(session->state(), State::Closed);
    EXPECT_FALSE(session->deadline());
    runWith();
    say(recordOf(0xB0C2));
    EXPECT_EQ(taken.size(), 1U);
    EXPECT_EQ(session->counts().sessions, 2U);
}
