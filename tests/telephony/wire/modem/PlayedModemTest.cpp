#include "telephony/wire/modem/PlayedModem.h"

#include <cstring>

#include "tests/telephony/wire/modem/PlayedModemFixture.h"

namespace kelvo::test {
namespace {

using namespace std::chrono_literals;

TEST_F(PlayedModemTest, TellsItsVersionInTextsOfTheirWidths) {
    play({});
    write({0x00, 0x78, 0xF0, 0x7E});
    Bytes expected{0x00};
    for (const char* text : {"Jan 05 2012", "12:00:00", "Jan 06 2012", "12:00:00", "PLAYED  "})
        expected.insert(expected.end(), text, text + std::strlen(text));
    ASSERT_EQ(expected.size(), 47U);
    expected.resize(55);
    EXPECT_EQ(read(), plainFrame(expected));
}

TEST_F(PlayedModemTest, TellsItsBuildIdFromTheTwelfthByteOn) {
    play({});
    write({0x7C, 0x93, 0x49, 0x7E});
    EXPECT_EQ(read(), plainFrame({0x7C, 0,   0,   0,   0,   0,   0,   0,   0,   0,   0,   0,  //
                                  'K',  'E', 'L', 'V', 'O', '-', 'M', 'O', 'D', 'E', 'M', '-', '1', 0}));
}

TEST_F(PlayedModemTest, TellsHowManyItemsItHasOfEachEquipment) {
    play({});
    write({0x73, 0x00, 0x00, 0x00, 0x01, 0x00, 0x00, 0x00, 0x61, 0x9D, 0x7E});
    EXPECT_EQ(read(),
              plainFrame({0x73, 0, 0, 0, 1, 0,   0,    0, 0,    0, 0, 0,  // good
                          0,    0, 0, 0, 2, 0xA, 0,    0, 0,    0, 0, 0, 0, 0, 0, 0, 0x10, 9, 0,    0, 0x20, 0x0E,
                          0,    0, 0, 0, 0, 0,   0xFF, 4, 0,    0, 0, 0, 0, 0, 0, 0, 0,    0, 0x8A, 3, 0,    0,
                          1,    2, 0, 0, 0, 0,   0,    0, 0xFF, 1, 0, 0, 0, 0, 0, 0, 0,    0, 0,    0}));
}

TEST_F(PlayedModemTest, AnswersWhoeverSilencesIt) {
    play({});
    write({0x60, 0x00, 0x12, 0x6A, 0x7E});
    EXPECT_EQ(read(), plainFrame({0x60, 0, 0}));
    write({0x73, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0xDA, 0x81, 0x7E});
    EXPECT_EQ(read(), plainFrame({0x73, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0}));
    write({0x7D, 0x5D, 0x05, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x74, 0x41, 0x7E});
    EXPECT_EQ(read(), plainFrame({0x7D, 5, 0, 0, 0, 0, 0, 0}));
}

TEST_F(PlayedModemTest, PutsAMaskInForceAndTellsIt) {
    play({});
    const Bytes mask{0xB, 0, 0, 0, 12, 0, 0, 0, 0x81, 0x05};
    EXPECT_EQ(ask(joined({{0x73, 0, 0, 0, 3, 0, 0, 0}, mask})),
              plainFrame(joined({{0x73, 0, 0, 0, 3, 0, 0, 0, 0, 0, 0, 0}, mask})));
    EXPECT_EQ(ask({0x73, 0, 0, 0, 4, 0, 0, 0, 0xB, 0, 0, 0}),
              plainFrame(joined({{0x73, 0, 0, 0, 4, 0, 0, 0, 0, 0, 0, 0}, mask})));
}

TEST_F(PlayedModemTest, PutsNoMoreInForceThanItHas) {
    play({});
    // 0x1FF items of TD-SCDMA, of which the last is bit 6 of byte 63.
    Bytes expected{0x73, 0, 0, 0, 3, 0, 0, 0, 0, 0, 0, 0, 0xD, 0, 0, 0, 0xFF, 1, 0, 0};
    expected.insert(expected.end(), 63, 0xFF);
    expected.push_back(0x7F);
    EXPECT_EQ(ask(maskRequest(0xD, 0x300, 0xFF)), plainFrame(expected));
    // Of equipment 2 there is nothing: a status that is not good.
    EXPECT_EQ(ask(maskRequest(2, 8, 0xFF)),
              plainFrame({0x73, 0, 0, 0, 3, 0, 0, 0, 1, 0, 0, 0, 2, 0, 0, 0, 0, 0, 0, 0}));
}

TEST_F(PlayedModemTest, RefusesWhatItDoesNotUnderstandAndRepeatsIt) {
    play({});
    EXPECT_EQ(ask({0x4B, 1, 2}), plainFrame({0x13, 0x4B, 1, 2}));  // no such command
    EXPECT_EQ(ask({0x00, 0x00}), plainFrame({0x15, 0x00, 0x00}));  // too long
    EXPECT_EQ(ask({0x60}), plainFrame({0x15, 0x60}));              // too short
    EXPECT_EQ(ask({0x73, 0, 0}), plainFrame({0x15, 0x73, 0, 0}));
    EXPECT_EQ(ask({0x73, 0, 0, 0, 9, 0, 0, 0}), plainFrame({0x14, 0x73, 0, 0, 0, 9, 0, 0, 0}));
    EXPECT_EQ(ask({0x73, 0, 0, 0, 4, 0, 0, 0, 16, 0, 0, 0}),
              plainFrame({0x14, 0x73, 0, 0, 0, 4, 0, 0, 0, 16, 0, 0, 0}));
    // A mask that lacks a byte of its nine items.
    const Bytes shortMask{0x73, 0, 0, 0, 3, 0, 0, 0, 0xB, 0, 0, 0, 9, 0, 0, 0, 0xFF};
    EXPECT_EQ(ask(shortMask), plainFrame(joined({{0x15}, shortMask})));
}

TEST_F(PlayedModemTest, IgnoresWhatIsNoFrame) {
    play({});
    write({0x7E, 0x7E, 0x00, 0x78, 0xF1, 0x7E, 0x01, 0x7E});
    EXPECT_EQ(read(), Bytes());
    write({0x00});
    write({0x78});
    EXPECT_EQ(read(), Bytes());
    write({0xF0, 0x7E});
    EXPECT_EQ(read().size(), 58U);
}

TEST_F(PlayedModemTest, SendsTheRecordsThatItIsAskedForInTheirTime) {
    const Bytes first = modemRecord(0xB0C2, 1);
    const Bytes other = modemRecord(0xB0C3, 2);
    const Bytes third = modemRecord(0xB179, 0x7E);
    play({first, other, third});
    Bytes mask(0x30);  // up to item 0x17F
    mask[0xC2 / 8] = 1 << 0xC2 % 8;
    mask[0x179 / 8] = 1 << 0x179 % 8;
    ask(joined({{0x73, 0, 0, 0, 3, 0, 0, 0, 0xB, 0, 0, 0, 0x80, 1, 0, 0}, mask}));
    now += 249ms;
    EXPECT_EQ(read(), Bytes());
    now += 1ms;
    EXPECT_EQ(read(), recordFrame(first));
    EXPECT_EQ(_modem->nextDue(), now + 100ms);
    now += 199ms;
    EXPECT_EQ(read(), Bytes());
    now += 1ms;
    EXPECT_EQ(read(), recordFrame(third));
    EXPECT_EQ(_modem->nextDue(), std::nullopt);
    EXPECT_EQ(_modem->tally().whole[0], 2U);
}

TEST_F(PlayedModemTest, BeginsWhenTheLastOfTheFirstMasksHasBeenSet) {
    const Bytes umts = modemRecord(0x4005, 1);
    play({umts});
    setMask(7);
    now += 200ms;
    setMask(4);
    now += 249ms;
    EXPECT_EQ(read(), Bytes());
    now += 1ms;
    EXPECT_EQ(read(), recordFrame(umts));
}

TEST_F(PlayedModemTest, PlaysOnWhileNobodyAsks) {
    const Bytes last = modemRecord(0xB0C2, 3);
    play({modemRecord(0xB0C2, 1), modemRecord(0xB0C2, 2), last});
    setMask();
    ask({0x73, 0, 0, 0, 0, 0, 0, 0});
    now += 360ms;
    EXPECT_EQ(read(), Bytes());
    setMask();
    now += 100ms;
    EXPECT_EQ(read(), recordFrame(last));
}

TEST_F(PlayedModemTest, TellsHowManyRecordsWait) {
    std::vector<Bytes> records;
    for (int i = 0; i < 300; ++i) records.push_back(modemRecord(0xB0C2, 1));
    play(records);
    setMask();
    now += 250ms + 299 * 100ms;
    const Bytes all = read();
    EXPECT_EQ(Bytes(all.begin(), all.begin() + 23), recordFrame(records[0], 255));
    EXPECT_EQ(Bytes(all.end() - 23, all.end()), recordFrame(records[0], 0));
    EXPECT_EQ(Bytes(all.end() - 69, all.end() - 46), recordFrame(records[0], 2));
}

TEST_F(PlayedModemTest, KeepsABoundedNumberOfRecordsForAReaderThatDoesNotRead) {
    std::vector<Bytes> records(5000, modemRecord(0xB0C2, 1));
    play(records);
    setMask();
    for (; now < 502s; now += 1s) _modem->output(now);  // and nothing is taken
    read();
    EXPECT_EQ(_modem->tally().whole[0] + _modem->tally().notSent, 5000U);
    EXPECT_GE(_modem->tally().whole[0], 4096U);
    EXPECT_LE(_modem->tally().whole[0], 4096U + 4096 / 23 + 1);  // as many again as are on their way
}

TEST_F(PlayedModemTest, ForgetsItsReaderWhenThePlugIsPulled) {
    play({modemRecord(0xB0C2, 1), modemRecord(0xB0C2, 2), modemRecord(0xB0C2, 3)});
    setMask();
    now += 250ms;
    _modem->unplug();
    EXPECT_FALSE(_modem->isPluggedIn(now));
    EXPECT_EQ(ask({0x00}), Bytes());
    _modem->plugIn(now);
    EXPECT_TRUE(_modem->isPluggedIn(now));
    EXPECT_EQ(readFor(1000ms), Bytes());
}

}  // namespace
}  // namespace kelvo::test
