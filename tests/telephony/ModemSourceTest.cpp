#include "tests/support/TemporaryDirectory.h"
#include "tests/telephony/ModemSourceFixture.h"

namespace kelvo {

using namespace std::chrono_literals;
using test::joined;
using test::ModemSourceTest;
using test::plainBody;

TEST_F(ModemSourceTest, OpensThePortForTheFirstClientOnly) {
    queue.advance(100s);
    EXPECT_EQ(lines->tries, 0);
    EXPECT_EQ(source->description(), "the modem at line");
    stream({0x51F4});
    EXPECT_EQ(lines->tries, 1);
    EXPECT_TRUE(lines->line->opened);
    EXPECT_TRUE(lines->line->sent.empty());
    answer();
    stream({0x51F4, 0x51FF});
    EXPECT_EQ(lines->tries, 1);
    say(test::recordOf(0x51F4, 7));
    EXPECT_EQ(taken, std::vector<Bytes>{test::packetOf(0x51F4, 7)});
}

TEST_F(ModemSourceTest, LetsRecordsGatherAtThePortWhileNobodyWaitsForAnAnswer) {
    stream({0x51F4});
    lines->line->listener.lineOpened();
    EXPECT_FALSE(lines->line->gathers);
    queue.advance(200ms);
    EXPECT_FALSE(lines->line->gathers);
    answerRequests();
    EXPECT_TRUE(lines->line->gathers);
    stream({0x51F4, 0x51FF});  // a mask is asked for
    EXPECT_FALSE(lines->line->gathers);
    answerRequests();
    EXPECT_TRUE(lines->line->gathers);
    source->end([] {});
    EXPECT_FALSE(lines->line->gathers);
}

TEST_F(ModemSourceTest, ReleasesThePortSixSecondsAfterTheLastClientHasLeft) {
    stream({0x51F4});
    answer();
    leave();
    answerRequests();  // to the mask without any code
    queue.advance(5999ms);
    EXPECT_TRUE(lines->line->sent.empty());
    queue.advance(1ms);
    ASSERT_EQ(lines->line->sent.size(), 3U);
    EXPECT_EQ(lines->line->sent[1], (Bytes{0x73, 0, 0, 0, 0, 0, 0, 0, 0xDA, 0x81, 0x7E}));
    EXPECT_EQ(*lines->alive, 1);
    queue.advance(200ms);
    EXPECT_EQ(*lines->alive, 0);
    queue.advance(100s);
    EXPECT_EQ(lines->tries, 1);
    stream({0x51F4});
    EXPECT_EQ(lines->tries, 2);
}

TEST_F(ModemSourceTest, KeepsThePortForAClientThatComesBackInTime) {
    stream({0x51F4});
    answer();
    leave();
    answerRequests();
    queue.advance(5s);
    stream({0x51F4});
    answerRequests();
    queue.advance(100s);
    EXPECT_EQ(*lines->alive, 1);
    EXPECT_EQ(lines->tries, 1);
}

TEST_F(ModemSourceTest, TriesAgainAfterTenthOfASecondDoublingToOne) {
    lines->isThere = false;
    stream({0x51F4});
    EXPECT_EQ(lines->tries, 1);
    EXPECT_EQ(source->state(), "it cannot be opened: No such file or directory");
    for (const auto pause : {100ms, 200ms, 400ms, 800ms, 1000ms, 1000ms}) {
        const int before = lines->tries;
        queue.advance(pause - 1ms);
        EXPECT_EQ(lines->tries, before);
        queue.advance(1ms);
        EXPECT_EQ(lines->tries, before + 1);
    }
    EXPECT_EQ(texts(), std::vector<std::string>{
                           "the modem at line: it cannot be opened: No such file or directory; trying again"});
    leave();
    queue.advance(10s);
    const int before = lines->tries;
    queue.advance(100s);
    EXPECT_EQ(lines->tries, before);  // nobody is left who wants it
    EXPECT_EQ(source->state(), "");
}

TEST_F(ModemSourceTest, TriesAtOnceWhenThePortMayHaveCome) {
    lines->isThere = false;
    stream({0x51F4});
    queue.advance(5s);
    lines->isThere = true;
    ASSERT_TRUE(lines->watching);
    const auto changed = lines->watching;
    changed();
    ASSERT_NE(lines->line, nullptr);
    EXPECT_FALSE(lines->watching);
    const int tries = lines->tries;
    changed();
    queue.advance(5s);
    EXPECT_EQ(lines->tries, tries);
}

TEST_F(ModemSourceTest, GoesOnByItselfWhenAModemThatHasGoneIsBack) {
    stream({0x51F4});
    answer();
    lines->isThere = false;
    lines->line->listener.lineClosed("it hung up");
    queue.run();
    EXPECT_EQ(*lines->alive, 0);
    EXPECT_EQ(source->state(), "the modem has gone: it hung up");
    queue.advance(100ms);
    EXPECT_TRUE(lines->lastAgain);
    lines->isThere = true;
    queue.advance(1s);
    answer();
    EXPECT_EQ(source->state(), "");
    say(test::recordOf(0x51F4, 8));
    EXPECT_EQ(taken, std::vector<Bytes>{test::packetOf(0x51F4, 8)});
    EXPECT_EQ(texts().back(), "line: the modem is back");
}

TEST_F(ModemSourceTest, TellsAModemThatHasGoneOnceAndWhatIsNewAboutIt) {
    stream({0x51F4});
    answer();
    lines->line->listener.lineClosed("it hung up");
    queue.advance(100ms);
    lines->line->listener.lineClosed("nobody is there");
    queue.advance(200ms);
    EXPECT_EQ(source->state(), "the modem has gone: it hung up");
    EXPECT_EQ(texts(), std::vector<std::string>{"the modem at line: the modem has gone: it hung up; trying again"});
    lines->line->listener.lineClosed("Permission denied");
    EXPECT_EQ(source->state(), "it cannot be opened: Permission denied");
}

TEST_F(ModemSourceTest, LeaksNothingWhenItIsUnpluggedAHundredTimes) {
    stream({0x51F4});
    for (int i = 0; i < 100; ++i) {
        answer();
        say(test::recordOf(0x51F4, 1));
        lines->line->listener.lineClosed("it hung up");
        queue.advance(100ms);
        ASSERT_EQ(*lines->alive, 1);
    }
    EXPECT_EQ(taken.size(), 100U);
}

TEST_F(ModemSourceTest, SaysOnceThatAPortIsNoDiagnosticOneAndGoesOnTrying) {
    stream({0x51F4});
    for (int i = 0; i < 3; ++i) {
        lines->line->listener.lineOpened();
        queue.advance(3500ms);
    }
    EXPECT_EQ(source->state(), "not a diagnostic port, or in use");
    EXPECT_EQ(texts(), std::vector<std::string>{"the modem at line: not a diagnostic port, or in use; trying again"});
    EXPECT_GE(lines->tries, 3);
    EXPECT_FALSE(lines->lastAgain);
}

TEST_F(ModemSourceTest, SilencesTheModemWhenTheServiceEnds) {
    stream({0x51F4});
    answer();
    lines->line->sent.clear();
    bool done = false;
    source->end([&] { done = true; });
    EXPECT_EQ(lines->line->sent.size(), 3U);
    EXPECT_FALSE(done);
    queue.advance(199ms);
    EXPECT_FALSE(done);
    queue.advance(1ms);
    EXPECT_TRUE(done);
    queue.advance(100s);
    EXPECT_EQ(lines->tries, 1);
}

TEST_F(ModemSourceTest, EndsAtOnceWhenNoPortIsOpen) {
    bool done = false;
    source->end([&] { done = true; });
    EXPECT_TRUE(done);
}

TEST_F(ModemSourceTest, EndsWhenTheModemGoesWhileItIsSilenced) {
    stream({0x51F4});
    answer();
    bool done = false;
    source->end([&] { done = true; });
    lines->line->listener.lineClosed("it hung up");
    EXPECT_TRUE(done);
    EXPECT_TRUE(log.lines().empty());
}

TEST_F(ModemSourceTest, FindsTheTechnologyOutBeforeAnybodyStreams) {
    make({.technology = {}, .subscription = {}});
    EXPECT_FALSE(source->technology());
    source->findTechnology();
    answer();
    say(test::recordOf(0x5134));
    queue.advance(500ms);
    EXPECT_EQ(source->technology(), Technology::GSM);
    EXPECT_EQ((*source->portStatus())["CampedOn"], Value("GSM"));
    EXPECT_TRUE(taken.empty() || taken.size() == 1);
    queue.advance(10s);  // nobody came
    EXPECT_EQ(*lines->alive, 0);
    EXPECT_FALSE(source->technology());
}

TEST_F(ModemSourceTest, KeepsTheTechnologyWhileTheModemIsGone) {
    make({.technology = {}, .subscription = {}});
    stream({0x5134});
    answer();
    say(test::recordOf(0x5134));
    queue.advance(500ms);
    lines->line->listener.lineClosed("it hung up");
    EXPECT_EQ(source->technology(), Technology::GSM);
}

TEST_F(ModemSourceTest, RecordsRecordsWithTheModemsTimeOrElseTheMachines) {
    const test::TemporaryDirectory directory;
    const auto path = directory.path() / "recorded.pcap";
    auto file = OutputFile::create(path);
    ASSERT_TRUE(file);
    source->recordTo(Recording(std::move(file).value()));
    stream({0x51F4});
    answer();
    Bytes set = test::recordOf(0x51F4, 1);
    const std::uint64_t timestamp = 72659535985485082U;  // 2023-12-06 04:04:26.2273
    for (int i = 0; i < 8; ++i) set[8 + i] = static_cast<std::uint8_t>(timestamp >> 8 * i);
    say(set);
    Bytes unset = test::recordOf(0x51F4, 2);
    for (int i = 0; i < 8; ++i) unset[8 + i] = i == 0;
    say(unset);
    auto capture = CaptureReader::open(path);
    ASSERT_TRUE(capture);
    EXPECT_EQ(capture->technology(), Technology::LTE);
    const auto first = *capture->next();
    ASSERT_TRUE(first);
    EXPECT_EQ(std::chrono::floor<std::chrono::microseconds>(first->time).time_since_epoch(), 1'701'835'466'227'324us);
    EXPECT_EQ(Bytes(first->bytes.begin(), first->bytes.end()), taken[0]);
    const auto second = *capture->next();
    ASSERT_TRUE(second);
    EXPECT_EQ(second->time.time_since_epoch(), 1'700'000'000s);
    EXPECT_EQ(second->bytes[5], 1);  // the record's own timestamp stays
}

TEST_F(ModemSourceTest, RecordsFramesAsTheyCome) {
    const test::TemporaryDirectory directory;
    const auto path = directory.path() / "recorded.frames";
    auto file = OutputFile::create(path);
    ASSERT_TRUE(file);
    source->recordFramesTo(std::move(file).value());
    stream({0x51F4});
    lines->line->listener.lineOpened();
    Bytes noise{0x33, 0x7D, 0x5E, 0x7E};
    lines->line->listener.lineGave(noise);
    Bytes more{0x44};
    lines->line->listener.lineGave(more);
    std::ifstream stream(path, std::ios::binary);
    EXPECT_EQ(std::string(std::istreambuf_iterator<char>(stream), {}), "\x33\x7D\x5E\x7E\x44");
}

TEST_F(ModemSourceTest, TurnsNewerLayoutsBeforeAnybodyGetsThem) {
    stream({0xB0C1});
    answer();
    // The master information block of version 2: PCI 73, EARFCN 1825, frame 1020, two antennas, 50 resource blocks.
    const Bytes payload{2, 73, 0, 0x21, 0x07, 0, 0, 0xFC, 0x03, 2, 50};
    say(joined({{0x10, 0, 23, 0, 23, 0, 0xC1, 0xB0}, Bytes(8), payload}));
    const Bytes fixed{1, 73, 0, 0x21, 0x07, 0xFC, 0x03, 2, 50};
    EXPECT_EQ(taken, std::vector<Bytes>{joined({{1, 21, 0, 0xC1, 0xB0}, Bytes(8), fixed})});
    EXPECT_EQ((*source->portStatus())["Adapted"], Value(1));
}

// So that replaying shows what was shown, and a recording has nothing left to turn.
TEST_F(ModemSourceTest, RecordsWhatItHasTurned) {
    const test::TemporaryDirectory directory;
    const auto path = directory.path() / "recorded.pcap";
    auto file = OutputFile::create(path);
    ASSERT_TRUE(file);
    source->recordTo(Recording(std::move(file).value()));
    stream({0xB0C1});
    answer();
    const Bytes payload{2, 73, 0, 0x21, 0x07, 0, 0, 0xFC, 0x03, 2, 50};
    say(joined({{0x10, 0, 23, 0, 23, 0, 0xC1, 0xB0}, Bytes(8), payload}));
    auto capture = CaptureReader::open(path);
    ASSERT_TRUE(capture);
    const auto recorded = *capture->next();
    ASSERT_TRUE(recorded);
    const Bytes fixed{1, 73, 0, 0x21, 0x07, 0xFC, 0x03, 2, 50};
    EXPECT_EQ(Bytes(recorded->bytes.begin(), recorded->bytes.end()), joined({{1, 21, 0, 0xC1, 0xB0}, Bytes(8), fixed}));
    EXPECT_EQ(adaptation::RecordAdapter().adapt(recorded->bytes).outcome, adaptation::Adapted::Outcome::Passed);
}

TEST_F(ModemSourceTest, RefusesLayoutsThatItDoesNotKnowAndNamesThemOnce) {
    stream({0xB0C1});
    answer();
    say(test::recordOf(0xB0C1, 9));  // two bytes of version 9
    say(test::recordOf(0xB0C1, 9));
    EXPECT_TRUE(taken.empty());
    EXPECT_EQ(std::ranges::count(texts(), "the modem at line: 0xB0C1 version 9, 2 bytes: not known"), 1);
    EXPECT_EQ((*source->portStatus())["Refused"], Value(2));
    EXPECT_EQ((*source->portStatus())["Delivered"], Value(0));
}

TEST_F(ModemSourceTest, AsksForWhatNewerModemsSendInstead) {
    stream({0xB17F});
    lines->line->listener.lineOpened();
    queue.advance(200ms);
    Bytes mask;  // of equipment 0xB, with the codes
    for (int i = 0; i < 100 && !lines->line->sent.empty(); ++i) {
        const Bytes asked = plainBody(lines->line->sent.back());
        if (asked[0] == 0x73 && asked[4] == 3 && asked[8] == 0xB) mask.assign(asked.begin() + 16, asked.end());
        answerOne();
    }
    ASSERT_GT(mask.size(), 0x193U / 8);
    EXPECT_NE(mask[0x17F / 8] & 1 << (0x17F % 8), 0);
    EXPECT_NE(mask[0x193 / 8] & 1 << (0x193 % 8), 0);
}

TEST_F(ModemSourceTest, TellsItsPortsStatus) {
    stream({0x51F4});
    answer();
    say(test::recordOf(0x51F4, 1, 9));
    Bytes damaged{0x01, 0x02, 0x03, 0x04, 0x7E};
    lines->line->listener.lineGave(damaged);
    const DictionaryRef port = source->portStatus();
    EXPECT_EQ((*port)["Name"], Value("line"));
    EXPECT_EQ((*port)["State"], Value("running"));
    EXPECT_EQ((*port)["Target"], Value("TARGET9"));
    EXPECT_EQ((*port)["BuildId"], Value("B-7"));
    EXPECT_EQ((*port)["CampedOn"], Value());  // the command line said so: nobody listens
    EXPECT_EQ((*port)["Losing"], Value(true));
    EXPECT_EQ((*port)["Records"], Value(1));
    EXPECT_EQ((*port)["Delivered"], Value(1));
    EXPECT_EQ((*port)["BadChecksums"], Value(1));
    EXPECT_EQ((*port)["Waiting"], Value(9));
    EXPECT_EQ((*port)["Openings"], Value(1));
}

}  // namespace kelvo
