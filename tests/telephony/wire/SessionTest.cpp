#include "tests/telephony/wire/SessionFixture.h"

using namespace kelvo;
using namespace kelvo::test;

TEST_F(SessionTest, HandsRecordsOverAsClientsKnowThem) {
    runWith();
    Bytes body = recordOf(0xB0C2, 9, 3);
    say(body);
    EXPECT_EQ(taken, std::vector<Bytes>{packetOf(0xB0C2, 9)});
    EXPECT_EQ(timestamps, std::vector<std::uint64_t>{0x0102000000000000});
    EXPECT_EQ(session->counts().records, 1U);
    EXPECT_EQ(session->counts().delivered, 1U);
    EXPECT_EQ(session->counts().waiting, 3);
    say(recordOf(0xB0C2, 10, 1));
    EXPECT_EQ(session->counts().waiting, 1);
    EXPECT_EQ(session->counts().mostWaiting, 3);
}

TEST_F(SessionTest, LosesNoRecordThatComesBeforeAnAnswer) {
    want({0xB0C2});
    run();
    say(recordOf(0xB0C2, 1));  // before the answer to the mask
    say(wrapped(1, recordOf(0xB0C2, 2)));
    agree();
    say(recordOf(0xB0C2, 3));
    EXPECT_EQ(taken, (std::vector<Bytes>{packetOf(0xB0C2, 1), packetOf(0xB0C2, 2), packetOf(0xB0C2, 3)}));
}

TEST_F(SessionTest, CountsRecordsForNobody) {
    runWith();
    hasClient = false;
    say(recordOf(0xB0C2));
    EXPECT_EQ(session->counts().forNobody, 1U);
    EXPECT_EQ(session->counts().delivered, 0U);
}

TEST_F(SessionTest, FollowsWhatClientsWant) {
    want({0xB0C2, 0x5134});
    run();
    agree();
    agree();
    want({0xB0C2, 0xB0C1, 0x5134});
    Bytes lte(0x41);
    lte[0x0C1 / 8] = 1 << 0x0C1 % 8 | 1 << 0x0C2 % 8;
    const Bytes asked = request();
    EXPECT_EQ(asked, joined({{0x73, 0, 0, 0, 3, 0, 0, 0}, little32(0xB), little32(0x201), lte}));
    want({0xB0C1});  // meanwhile: one at a time
    EXPECT_TRUE(sent.empty());
    say(maskAnswer(asked));
    EXPECT_EQ(request(), joined({{0x73, 0, 0, 0, 3, 0, 0, 0}, little32(5), little32(0x220), Bytes(0x44)}));
    say(joined({{0x73, 0, 0, 0, 3, 0, 0, 0, 0, 0, 0, 0}, little32(5), little32(0x220), Bytes(0x44)}));
    lte[0x0C1 / 8] = 1 << 0x0C1 % 8;
    EXPECT_EQ(request(), joined({{0x73, 0, 0, 0, 3, 0, 0, 0}, little32(0xB), little32(0x201), lte}));
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(SessionTest, SaysWhatThisModemCannotSendAndGoesOnWithTheRest) {
    want({0xB0C2, 0xB201, 0xD00A});
    run();
    EXPECT_EQ(lines(), std::vector<std::string>{"port: this modem cannot send: 0xb201, 0xd00a"});
    agree();
    EXPECT_TRUE(sent.empty());
    want({0xB0C1, 0xB201, 0xD00A, 0xD00C});
    EXPECT_EQ(lines().back(), "port: this modem cannot send: 0xd00c");
}

TEST_F(SessionTest, SaysWhichRecordTheModemRefuses) {
    want({0xB0C2, 0xB17F});
    run();
    Bytes answer = maskAnswer(request());
    answer[20 + 0x17F / 8] = 0;
    say(answer);
    EXPECT_EQ(lines(), std::vector<std::string>{"port: the modem refuses record 0xb17f"});
    EXPECT_EQ(session->state(), State::Running);
}

TEST_F(SessionTest, TakesASmallerMaskForARefusalOfWhatIsMissing) {
    want({0xB0C2, 0xB17F});
    run();
    const Bytes asked = request();
    say(joined({{0x73, 0, 0, 0, 3, 0, 0, 0, 0, 0, 0, 0},
                little32(0xB),
                little32(0x100),
                Bytes(asked.begin() + 16, asked.begin() + 16 + 0x20)}));
    EXPECT_EQ(lines(), std::vector<std::string>{"port: the modem refuses record 0xb17f"});
}

TEST_F(SessionTest, GoesOnWhenAWholeMaskIsRefused) {
    want({0xB0C2, 0x5134});
    run();
    sent.clear();
    say({0x73, 0, 0, 0, 3, 0, 0, 0, 1, 0, 0, 0});  // a status, and nothing else
    EXPECT_EQ(lines(), std::vector<std::string>{"port: the modem refuses record 0x5134"});
    const Bytes lte = request();
    EXPECT_EQ(lte[8], 0xB);
    say(joined({{0x14}, lte}));
    EXPECT_EQ(lines().back(), "port: the modem refuses record 0xb0c2");
    EXPECT_EQ(session->state(), State::Running);
    EXPECT_FALSE(session->deadline());
}

TEST_F(SessionTest, AsksAgainWhenAnAnswerBreaksOff) {
    want({0xB0C2});
    run();
    const Bytes asked = request();
    const Bytes answer = maskAnswer(asked);
    say(Bytes(answer.begin(), answer.end() - 1));
    say(Bytes(answer.begin(), answer.begin() + 14));
    say(Bytes(answer.begin(), answer.begin() + 4));
    EXPECT_EQ(lines(), std::vector<std::string>{"port: an answer of 84 bytes is too short"});
    pass(5s);
    EXPECT_EQ(request(), asked);
    say(answer);
    EXPECT_FALSE(session->deadline());
}

TEST_F(SessionTest, CountsLengthsThatLie) {
    runWith();
    Bytes lying = recordOf(0xB0C2);
    lying[2] = 15;
    say(lying);
    say({0x10, 0x00});
    EXPECT_EQ(session->counts().lyingLengths, 2U);
    EXPECT_EQ(session->counts().records, 0U);
    EXPECT_TRUE(taken.empty());
}

TEST_F(SessionTest, CountsWrappersThatHoldNothing) {
    runWith();
    say({0x98, 1, 0, 0, 1, 0, 0, 0});
    say({0x98, 2, 0, 0, 1, 0, 0, 0, 0x10});
    EXPECT_EQ(session->counts().strange, 2U);
}

TEST_F(SessionTest, SaysOnceThatTheModemEncryptsItsRecords) {
    runWith();
    say({0x9E, 1, 2, 3});
    say(wrapped(1, {0x9E, 1, 2, 3}));
    EXPECT_EQ(lines(), std::vector<std::string>{"port: this modem encrypts its records"});
    EXPECT_EQ(session->counts().encrypted, 2U);
    EXPECT_EQ(session->counts().damaged(), 0U);
    EXPECT_TRUE(session->isEncrypted());
    session->lose();
    runWith();
    say({0x9E, 1, 2, 3});
    EXPECT_EQ(log.lines().size(), 1U);
}

TEST_F(SessionTest, ShowsTheSimThatSendsFirst) {
    runWith();
    say(wrapped(2, recordOf(0xB0C2, 1)));
    say(wrapped(1, recordOf(0xB0C2, 2)));
    say(wrapped(2, recordOf(0xB0C2, 3)));
    EXPECT_EQ(taken, (std::vector<Bytes>{packetOf(0xB0C2, 1), packetOf(0xB0C2, 3)}));
    EXPECT_EQ(session->counts().otherSubscriptions, 1U);
    EXPECT_EQ(session->subscription(), 2);
    session->lose();
    runWith();
    say(wrapped(1, recordOf(0xB0C2, 4)));  // the choice holds when the modem comes back
    EXPECT_EQ(taken.size(), 2U);
}

TEST_F(SessionTest, ShowsTheSimThatWasChosen) {
    make({.technology = Technology::LTE, .subscription = 1});
    runWith();
    say(wrapped(2, recordOf(0xB0C2, 1)));
    say(wrapped(1, recordOf(0xB0C2, 2)));
    EXPECT_EQ(taken, std::vector<Bytes>{packetOf(0xB0C2, 2)});
}

TEST_F(SessionTest, ShowsRecordsThatNameNoSim) {
    runWith();
    say(wrapped(0, recordOf(0xB0C2, 1)));
    say(wrapped(0xFFFFFFFF, recordOf(0xB0C2, 2)));
    say(recordOf(0xB0C2, 3));
    EXPECT_FALSE(session->subscription());
    say(wrapped(1, recordOf(0xB0C2, 4)));
    EXPECT_EQ(taken.size(), 4U);
    EXPECT_EQ(session->subscription(), 1);
}

TEST_F(SessionTest, SaysOnceWhenLossBeginsAndOnceWhenItHasEnded) {
    runWith();
    sayRaw({0x01, 0x02, 0x03, 0x04, 0x7E});
    EXPECT_EQ(lines(), std::vector<std::string>{"port: loses records: 1 bad checksum"});
    EXPECT_TRUE(session->isLosing());
    pass(4s);
    sayRaw({0x01, 0x02, 0x03, 0x04, 0x7E, 0x01, 0x7D, 0x00, 0x7E});
    Bytes lying = recordOf(0xB0C2);
    lying[2] = 15;
    say(lying);
    say({0x79, 0x00, 0x00, 0x04, 0x00});
    pass(4999ms);
    EXPECT_EQ(log.lines().size(), 1U);
    EXPECT_EQ(session->deadline(), now + 1ms);
    pass(1ms);
    EXPECT_EQ(lines().back(),
              "port: no longer loses records; it was 2 bad checksums, 1 bad escape, 1 lying length, "
              "4 texts dropped by the modem");
    EXPECT_FALSE(session->isLosing());
    pass(100s);
    EXPECT_EQ(log.lines().size(), 2U);
    sayRaw({0x01, 0x7E});
    EXPECT_EQ(lines().back(), "port: loses records: 1 frame too short");
}

TEST_F(SessionTest, CallsTextsThatTheModemDroppedTexts) {
    runWith();
    say({0x79, 0x00, 0x00, 0x02, 0x00});
    EXPECT_EQ(lines(), std::vector<std::string>{"port: loses texts: 2 texts dropped by the modem"});
    pass(5s);
    EXPECT_EQ(lines().back(), "port: no longer loses texts; it was 2 texts dropped by the modem");
    say({0x79, 0x00, 0x00, 0x01, 0x00});
    sayRaw({0x01, 0x7E});
    pass(5s);
    EXPECT_EQ(lines().back(), "port: no longer loses records; it was 1 frame too short, 1 text dropped by the modem");
}

TEST_F(SessionTest, CountsTheFrameInWhoseMiddleTheModemHangsUp) {
    runWith();
    const Bytes frame = plainFrame(recordOf(0xB0C2));
    sayRaw(Bytes(frame.begin(), frame.begin() + 10));
    session->lose();
    EXPECT_EQ(session->counts().frames.unfinished, 1U);
    EXPECT_EQ(lines(), (std::vector<std::string>{"port: loses records: 1 unfinished frame",
                                                 "port: no longer loses records; it was 1 unfinished frame"}));
    runWith();
    say(recordOf(0xB0C2));
    EXPECT_EQ(taken.size(), 1U);
}

TEST_F(SessionTest, SilencesTheModemInTheEndAndLosesNothingThatStillComes) {
    runWith();
    session->end();
    EXPECT_EQ(sent, (std::vector<Bytes>{{0x60, 0x00, 0x12, 0x6A, 0x7E},
                                        {0x73, 0, 0, 0, 0, 0, 0, 0, 0xDA, 0x81, 0x7E},
                                        {0x7D, 0x5D, 0x05, 0, 0, 0, 0, 0, 0, 0x74, 0x41, 0x7E}}));
    pass(100ms);
    say(recordOf(0xB0C2, 5));
    EXPECT_EQ(taken, std::vector<Bytes>{packetOf(0xB0C2, 5)});
    pass(199ms);
    EXPECT_EQ(session->state(), State::Ending);
    pass(1ms);
    EXPECT_EQ(session->state(), State::Closed);
    EXPECT_EQ(session->failure(), "");
}

TEST_F(SessionTest, EndsWithinTwoSecondsThoughTheModemGoesOn) {
    runWith();
    session->end();
    for (int i = 0; i < 19; ++i) {
        pass(100ms);
        say(recordOf(0xB0C2));
        EXPECT_EQ(session->state(), State::Ending);
    }
    pass(100ms);
    EXPECT_EQ(session->state(), State::Closed);
}

TEST_F(SessionTest, KeepsItsHeadUnderGarbage) {
    runWith();
    std::uint32_t state = 3;
    for (int i = 0; i < 2000; ++i) {
        Bytes noise(1 + state % 97);
        for (std::uint8_t& byte : noise) {
            state = state * 1'664'525 + 1'013'904'223;
            byte = static_cast<std::uint8_t>(state >> 24);
        }
        session->receive(noise);
    }
    sayRaw({0x7E});
    say(recordOf(0xB0C2, 1));
    EXPECT_EQ(taken, std::vector<Bytes>{packetOf(0xB0C2, 1)});
}

TEST_F(SessionTest, ShowsAModemsNameWithoutWhatATerminalObeys) {
    open();
    beQuiet();
    Bytes answer = kVersionAnswer;
    std::ranges::copy(bytesOf("A\x1b[2J\x9b~ "), answer.begin() + 39);
    say(answer);
    EXPECT_EQ(session->target(), "A?[2J?~");
}
