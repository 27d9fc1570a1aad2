#include <map>

#include "tests/telephony/wire/modem/PlayedModemFixture.h"

namespace kelvo::test {
namespace {

using modem::Fault;
using namespace std::chrono_literals;

const Bytes kVersion{0x00};
const Bytes kRanges{0x73, 0, 0, 0, 1, 0, 0, 0};

// What a stream holds, told apart with none of the code that is tested.
struct Taken {
    Bodies good;
    int badChecksums = 0;
    int badEscapes = 0;
    int tooShort = 0;
    int oversized = 0;
};

Taken take(const Bytes& stream) {
    Taken taken;
    Bytes frame;
    for (const std::uint8_t byte : stream) {
        if (byte != 0x7E) {
            frame.push_back(byte);
            continue;
        }
        Bytes body;
        bool escapes = true;
        for (std::size_t i = 0; i < frame.size(); ++i) {
            if (frame[i] != 0x7D) {
                body.push_back(frame[i]);
            } else if (i + 1 < frame.size() && (frame[i + 1] == 0x5D || frame[i + 1] == 0x5E)) {
                body.push_back(frame[++i] ^ 0x20);
            } else {
                escapes = false;
            }
        }
        const bool empty = frame.empty();
        const bool isLong = frame.size() + 1 > 2 * 65'551 + 3;
        frame.clear();
        if (empty) continue;
        if (isLong) {
            ++taken.oversized;
        } else if (!escapes) {
            ++taken.badEscapes;
        } else if (body.size() < 3) {
            ++taken.tooShort;
        } else {
            const int crc = body[body.size() - 2] | body.back() << 8;
            body.resize(body.size() - 2);
            if (plainChecksum(body) == crc) {
                taken.good.push_back(body);
            } else {
                ++taken.badChecksums;
            }
        }
    }
    EXPECT_TRUE(frame.empty());
    return taken;
}

std::vector<Bytes> records(int count) {
    std::vector<Bytes> made;
    for (int i = 0; i < count; ++i) {
        made.push_back(modemRecord(0xB0C2, 0x7E, static_cast<std::size_t>(8 + i % 50)));
        made.back()[12] = static_cast<std::uint8_t>(i);
        made.back()[13] = static_cast<std::uint8_t>(i >> 8);
        made.back()[14] = 0x7D;
    }
    return made;
}

// The number of a record of those, as it came.
int numberOf(const Bytes& body) { return body[16] | body[17] << 8; }

class PlayedModemFaultsTest : public PlayedModemTest {
protected:
    // All records of a modem of these faults, after the answer to their mask.
    Taken playAll(modem::Faults faults, int count, std::uint64_t seed = 1) {
        play(records(count), faults, seed);
        write(plainFrame(maskRequest(0xB, 0x200, 0xFF)));
        Taken taken = take(readFor(std::chrono::milliseconds(300 + 100 * count)));
        EXPECT_FALSE(taken.good.empty());
        EXPECT_EQ(taken.good.front()[0], 0x73);
        taken.good.erase(taken.good.begin());
        return taken;
    }
    static void expectInOrder(const Bodies& bodies) {
        int last = -1;
        for (const Bytes& body : bodies) {
            ASSERT_EQ(body[0], 0x10);
            ASSERT_GT(numberOf(body), last);
            last = numberOf(body);
        }
    }
    const modem::Tally& tally() const { return _modem->tally(); }
};

TEST_F(PlayedModemFaultsTest, OfNoneAreNoRecordsLost) {
    const Taken taken = playAll({}, 400);
    EXPECT_EQ(taken.good.size(), 400U);
    expectInOrder(taken.good);
}

TEST_F(PlayedModemFaultsTest, NoiseStandsBetweenFramesAndCostsNone) {
    const Taken taken = playAll({Fault::Noise}, 400);
    EXPECT_EQ(taken.good.size(), 400U);
    EXPECT_GT(tally().noise, 50U);
    EXPECT_EQ(taken.badChecksums + taken.tooShort, static_cast<int>(tally().noise));
    EXPECT_EQ(taken.badEscapes, 0);
}

TEST_F(PlayedModemFaultsTest, EachDamagedRecordIsLostAloneAndCountedOnce) {
    struct Case {
        Fault fault;
        std::uint64_t modem::Tally::*tallied;
        int Taken::*seen;
    };
    for (const Case& of : {Case{Fault::FlippedBits, &modem::Tally::flippedBits, &Taken::badChecksums},
                           Case{Fault::CutFrames, &modem::Tally::cutFrames, &Taken::badChecksums},
                           Case{Fault::BadEscapes, &modem::Tally::badEscapes, &Taken::badEscapes}}) {
        const Taken taken = playAll({of.fault}, 1000);
        expectInOrder(taken.good);
        const auto damaged = tally().*of.tallied;
        EXPECT_GT(damaged, 30U);
        EXPECT_EQ(taken.*of.seen, static_cast<int>(damaged));
        EXPECT_EQ(taken.badChecksums + taken.badEscapes + taken.tooShort + taken.oversized, taken.*of.seen);
        EXPECT_EQ(taken.good.size(), 1000U - damaged);
        EXPECT_EQ(tally().whole[0], 1000U - damaged);
        EXPECT_EQ(tally().damaged(), damaged);
    }
}

TEST_F(PlayedModemFaultsTest, LengthsThatLieAreInFramesThatAreGood) {
    const Taken taken = playAll({Fault::LyingLengths}, 1000);
    std::uint64_t lies = 0;
    for (const Bytes& body : taken.good) {
        const std::size_t outer = body[2] | body[3] << 8;
        const std::size_t inner = body[4] | body[5] << 8;
        lies += outer != body.size() - 4 || inner != outer ? 1 : 0;
    }
    EXPECT_EQ(taken.good.size(), 1000U);
    EXPECT_GT(lies, 30U);
    EXPECT_EQ(tally().lyingLengths, lies);
    EXPECT_EQ(tally().whole[0], 1000U - lies);
}

TEST_F(PlayedModemFaultsTest, OversizedFramesCostNoRecord) {
    const Taken taken = playAll({Fault::OversizedFrames}, 1000);
    EXPECT_EQ(taken.good.size(), 1000U);
    EXPECT_GT(taken.oversized, 0);
    EXPECT_EQ(taken.oversized, static_cast<int>(tally().oversized));
    EXPECT_EQ(taken.badChecksums + taken.badEscapes + taken.tooShort, 0);
}

TEST_F(PlayedModemFaultsTest, OneSeedMakesTheSameBytes) {
    const modem::Faults faults{Fault::Noise,           Fault::FlippedBits,  Fault::CutFrames, Fault::BadEscapes,
                               Fault::OversizedFrames, Fault::LyingLengths, Fault::HangUp};
    const auto bytes = [&](std::uint64_t seed) {
        now = 0ns;
        play(records(300), faults, seed);
        setMask();
        return readFor(31s);
    };
    const Bytes once = bytes(5);
    EXPECT_EQ(once, bytes(5));
    EXPECT_NE(once, bytes(6));
}

TEST_F(PlayedModemFaultsTest, AsynchronousFramesComeBeforeEveryAnswer) {
    play({}, {Fault::Asynchronous});
    for (const Bytes& request : {kVersion, kRanges}) {
        const Taken taken = take(ask(request));
        ASSERT_EQ(taken.good.size(), 8U);
        EXPECT_EQ(taken.good.back()[0], request[0]);
        std::map<int, int> kinds;
        for (const Bytes& body : taken.good) ++kinds[body[0] == 0x98 ? body[8] : body[0]];
        for (const int kind : {0x60, 0x79, 0x92, 0x99, 0x9D}) EXPECT_EQ(kinds[kind], 1);
        EXPECT_EQ(kinds[request == kVersion ? 0x7C : 0x00], 1);  // late, and to another request
    }
}

TEST_F(PlayedModemFaultsTest, SlowAnswersComeAllTheSame) {
    play({}, {Fault::SlowAnswers});
    EXPECT_EQ(ask(kVersion), Bytes());
    EXPECT_EQ(take(readFor(1500ms)).good.size(), 1U);
    EXPECT_EQ(ask(kRanges), Bytes());
    EXPECT_EQ(readFor(5100ms), Bytes());
    EXPECT_EQ(ask(kRanges), Bytes());  // again, and so there are two
    EXPECT_EQ(take(readFor(5200ms)).good.size(), 2U);
}

TEST_F(PlayedModemFaultsTest, TheFirstAnswerToEveryRequestIsMissing) {
    play({modemRecord(0xB0C2, 1)}, {Fault::MissingAnswers});
    for (const Bytes& request : {kVersion, kRanges, maskRequest(0xB, 0x200, 0xFF), maskRequest(4, 0x200, 0xFF)}) {
        EXPECT_EQ(ask(request), Bytes());
        EXPECT_EQ(take(ask(request)).good.size(), 1U);
    }
}

TEST_F(PlayedModemFaultsTest, ErrorsEchoTheRequestBehindTheirByte) {
    const Bytes mask = maskRequest(0xB, 8, 0xFF);
    for (const auto& [fault, error, rangesToo] :
         {std::tuple(Fault::BadCommand, 0x13, true), std::tuple(Fault::BadParameter, 0x14, false),
          std::tuple(Fault::BadLength, 0x15, false), std::tuple(Fault::BadMode, 0x18, true),
          std::tuple(Fault::Locked, 0x42, true), std::tuple(Fault::Security, 0x47, true),
          std::tuple(Fault::Transaction, 0x94, true)}) {
        play({}, {fault});
        const Bytes byte{static_cast<std::uint8_t>(error)};
        EXPECT_EQ(ask(mask), plainFrame(joined({byte, mask})));
        if (rangesToo) {
            EXPECT_EQ(ask(kRanges), plainFrame(joined({byte, kRanges})));
        } else {
            EXPECT_EQ(take(ask(kRanges)).good.front().size(), 76U);
        }
        EXPECT_EQ(take(ask(kVersion)).good.front().size(), 55U);
    }
}

TEST_F(PlayedModemFaultsTest, SmallerRangesEndBeforeTheLastRecordsOfKelvo) {
    play({}, {Fault::SmallerRanges});
    const Bytes answer = take(ask(kRanges)).good.front();
    const auto items = [&](int id) { return answer[12 + 4 * id] | answer[13 + 4 * id] << 8; };
    EXPECT_LE(items(1), 0x34F);
    EXPECT_LE(items(4), 0x221);
    EXPECT_LE(items(5), 0x1FF);
    EXPECT_LE(items(7), 0x150);
    EXPECT_LE(items(0xB), 0x186);
    EXPECT_LE(items(0xD), 0x0E2);
}

TEST_F(PlayedModemFaultsTest, SmallerMasksEndBeforeTheLastRecordThatIsAskedFor) {
    play({modemRecord(0xB005, 1), modemRecord(0xB003, 2)}, {Fault::SmallerMasks});
    // Items 3 and 5 of 8: item 5 is left out.
    EXPECT_EQ(ask({0x73, 0, 0, 0, 3, 0, 0, 0, 0xB, 0, 0, 0, 8, 0, 0, 0, 0x28}),
              plainFrame({0x73, 0, 0, 0, 3, 0, 0, 0, 0, 0, 0, 0, 0xB, 0, 0, 0, 5, 0, 0, 0, 0x08}));
    EXPECT_EQ(readFor(500ms), recordFrame(modemRecord(0xB003, 2)));
}

TEST_F(PlayedModemFaultsTest, AnEarlierSessionStreamsUntilItIsSilenced) {
    play(records(100), {Fault::EarlierSession});
    std::map<int, int> kinds;
    for (const Bytes& body : take(readFor(500ms)).good) ++kinds[body[0]];
    EXPECT_EQ(kinds, (std::map<int, int>{{0x10, 6}, {0x60, 11}, {0x79, 11}}));
    ask({0x60, 0});
    ask({0x73, 0, 0, 0, 0, 0, 0, 0});
    ask({0x7D, 5, 0, 0, 0, 0, 0, 0});
    EXPECT_EQ(readFor(1000ms), Bytes());
}

TEST_F(PlayedModemFaultsTest, EncryptedRecordsAreOnesThatNobodyCanRead) {
    const Taken taken = playAll({Fault::Encrypted}, 20);
    EXPECT_EQ(taken.good.size(), 20U);
    for (const Bytes& body : taken.good) EXPECT_EQ(body[0], 0x9E);
    EXPECT_EQ(tally().encrypted, 20U);
    EXPECT_EQ(tally().whole[0], 0U);
}

TEST_F(PlayedModemFaultsTest, TwoSimsWrapEverything) {
    const Bytes mine = modemRecord(0xB0C2, 1);
    const Bytes other = modemRecord(0xB0C2, 2);
    play({mine}, {Fault::TwoSims}, 1, {other});
    const Taken answers = take(joined({ask(kVersion), setMask()}));
    ASSERT_EQ(answers.good.size(), 2U);
    for (const Bytes& body : answers.good) EXPECT_EQ(Bytes(body.begin(), body.begin() + 4), (Bytes{0x98, 1, 0, 0}));
    EXPECT_EQ(answers.good[0].size(), 8U + 55);
    EXPECT_EQ(answers.good[1][8], 0x73);
    const Bodies sent = take(readFor(300ms)).good;
    EXPECT_EQ(sent, (Bodies{joined({{0x98, 1, 0, 0, 1, 0, 0, 0, 0x10, 1, 16, 0}, mine}),
                            joined({{0x98, 1, 0, 0, 2, 0, 0, 0, 0x10, 0, 16, 0}, other})}));
    EXPECT_EQ(tally().whole, (std::array<std::uint64_t, 2>{1, 1}));
}

TEST_F(PlayedModemFaultsTest, AClockThatHasNotBeenSetCountsFrom1980) {
    const Taken taken = playAll({Fault::Clock1980}, 9);
    ASSERT_EQ(taken.good.size(), 9U);
    // After 800 ms: 640 times 1.25 ms, in the upper 48 bits.
    const Bytes& last = taken.good.back();
    EXPECT_EQ(Bytes(last.begin() + 8, last.begin() + 16), (Bytes{0, 0, 0x80, 0x02, 0, 0, 0, 0}));
    EXPECT_EQ(numberOf(last), 8);
}

TEST_F(PlayedModemFaultsTest, HangsUpWithinAFrameAndComesBackForgetful) {
    play(records(1000), {Fault::HangUp});
    setMask();
    Bytes all;
    while (_modem->isPluggedIn(now)) {
        const Bytes more = readFor(10ms);
        all.insert(all.end(), more.begin(), more.end());
        ASSERT_LT(now, 100s);
    }
    EXPECT_NE(all.back(), 0x7E);
    EXPECT_EQ(tally().cutOff, 1U);
    EXPECT_GE(tally().whole[0], 49U);
    EXPECT_LT(tally().whole[0], 200U);
    const auto returns = _modem->nextDue();
    ASSERT_TRUE(returns);
    EXPECT_GE(*returns - now, 200ms);
    EXPECT_LE(*returns - now, 1500ms);
    now = *returns;
    EXPECT_TRUE(_modem->isPluggedIn(now));
    EXPECT_EQ(readFor(1000ms), Bytes());
    setMask();
    EXPECT_FALSE(take(readFor(300ms)).good.empty());
}

TEST_F(PlayedModemFaultsTest, AnAtPortSendsBackWhatItGets) {
    play(records(3), {Fault::AtPort});
    write({0x00, 0x78, 0xF0, 0x7E});
    EXPECT_EQ(read(), (Bytes{0x00, 0x78, 0xF0, 0x7E, '\r', '\n', 'E', 'R', 'R', 'O', 'R', '\r', '\n'}));
}

TEST_F(PlayedModemFaultsTest, ASilentPortAnswersNothing) {
    play(records(3), {Fault::Silent});
    EXPECT_EQ(ask(kVersion), Bytes());
    setMask();
    EXPECT_EQ(readFor(1000ms), Bytes());
}

TEST_F(PlayedModemFaultsTest, AFloodComesAsFastAsItIsRead) {
    play(records(5000), {Fault::Flood});
    setMask();
    EXPECT_EQ(read(), Bytes());
    now += 250ms;
    const Taken taken = take(read());
    EXPECT_EQ(taken.good.size(), 5000U);
    expectInOrder(taken.good);
    EXPECT_EQ(taken.good.front()[1], 255);
    EXPECT_EQ(tally().notSent, 0U);
}

}  // namespace
}  // namespace kelvo::test
