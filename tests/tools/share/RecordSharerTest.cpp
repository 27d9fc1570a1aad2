#include "tools/share/RecordSharer.h"

#include <gtest/gtest.h>

#include "LogGenerator/RecordView.h"
#include "platform/encodings/PropertyList.h"
#include "tests/support/CellArray.h"
#include "tests/support/Record.h"
#include "tests/support/Subpackets.h"

namespace kelvo {
namespace {

using test::Record;

/// 262-01 in area 4566, cell 26385441 with code 301.
Record servingCell() {
    return Record(0xB0C2, 38)
        .u8(13, 2)
        .u16(14, 301)
        .u16(16, 1300)
        .u16(18, 19'300)
        .u8(20, 50)
        .u8(21, 25)
        .u32(22, 26'385'441)
        .u16(26, 4566)
        .u32(28, 3)
        .u16(32, 262)
        .u8(34, 2)
        .u16(35, 1)
        .u8(37, 1);
}

struct RecordSharerTest : testing::Test {
    /// The shared record; empty when it is left out.
    Bytes share(ByteView message, Technology technology = Technology::LTE) {
        const auto shared = sharer.share(message, technology);
        return shared ? Bytes(shared->begin(), shared->end()) : Bytes();
    }
    Bytes share(const Record& record) { return share(record.bytes()); }
    std::uint64_t removed(const std::string& what) const {
        const auto found = sharer.tally().removed().find(what);
        return found != sharer.tally().removed().end() ? found->second : 0;
    }
    static std::int64_t read(const Bytes& record, std::size_t at, Raw raw) { return RecordView(record).read(at, raw); }

    RecordSharer sharer{{}, Pseudonyms::secretOf("a test")};
};

TEST_F(RecordSharerTest, ReplacesIdentitiesAndKeepsTheRest) {
    const Bytes before = servingCell().bytes();
    const Bytes after = share(before);
    ASSERT_EQ(after.size(), before.size());
    for (const std::size_t at : {14, 26, 32}) EXPECT_NE(read(after, at, u16), read(before, at, u16)) << at;
    EXPECT_NE(read(after, 22, u32), read(before, 22, u32));
    EXPECT_NE(read(after, 35, u16), read(before, 35, u16));
    for (const std::size_t at : {0, 1, 2, 3, 4, 13, 16, 17, 18, 19, 20, 21, 28, 29, 30, 31, 34, 37}) {
        EXPECT_EQ(after[at], before[at]) << at;
    }
}

TEST_F(RecordSharerTest, GivesTheSamePseudonymAgain) {
    const Bytes once = share(servingCell());
    EXPECT_EQ(share(servingCell()), once);
    const Bytes measured = share(Record(0xB179, 29).u8(13, 2).u16(19, 301));
    EXPECT_EQ(read(measured, 19, u16), read(once, 14, u16));
    RecordSharer stranger({}, Pseudonyms::secretOf("another"));
    const Bytes before = servingCell().bytes();
    const auto other = stranger.share(before, Technology::LTE);
    EXPECT_NE(Bytes(other->begin(), other->end()), once);
}

TEST_F(RecordSharerTest, KeepsCellsOnRequestAndNothingThatNoFieldHolds) {
    RecordSharer keeping({.hideCells = false}, Pseudonyms::secretOf("a test"));
    const Bytes before = servingCell().bytes();
    const auto after = keeping.share(before, Technology::LTE);
    EXPECT_EQ(Bytes(after->begin(), after->end()), before);
    EXPECT_TRUE(keeping.tally().replaced().empty());
}

TEST_F(RecordSharerTest, LeavesNothingBetweenTheFields) {
    Record noise(0x1183, 50);
    for (std::size_t at = 13; at < 50; ++at) noise.u8(at, 0xA5);
    const Bytes after = share(noise);
    ASSERT_EQ(after.size(), 50U);
    for (std::size_t at = 20; at < 36; ++at) EXPECT_EQ(after[at], 0) << at;
    for (std::size_t at = 42; at < 50; ++at) EXPECT_EQ(after[at], 0) << at;
    EXPECT_EQ(read(after, 13, u16), 0xA5A5);
    EXPECT_NE(read(after, 38, u32.bits(0, 23)), 0xA5A5A5);
}

TEST_F(RecordSharerTest, LeavesNothingInSubpacketsThatNobodyReads) {
    test::Subpackets packet(0x119C);
    packet.add(1, 8).u8(4, 8).u16(6, 0x4142).add(2, 14).add(3, 12).add(4, 8).u16(4, 0x4142).u16(6, 0x4344);
    const Bytes after = share(packet.bytes());
    ASSERT_EQ(after.size(), packet.bytes().size());
    EXPECT_EQ(read(after, 17 + 4, u8), 8);
    EXPECT_EQ(read(after, 17 + 6, u16), 0);
    EXPECT_EQ(read(after, 17 + 8 + 14 + 12, u8), 4);
    EXPECT_EQ(read(after, 17 + 8 + 14 + 12 + 2, u16), 8);
    EXPECT_EQ(read(after, 17 + 8 + 14 + 12 + 4, u32), 0);
}

TEST_F(RecordSharerTest, ReplacesANetworkInPackedDigitsAndItsAreas) {
    // 262-01; area 0x11D6 with the high byte first, routing area 17.
    const Bytes before = Record(0x7135, 32)
                             .u8(14, 3)
                             .u8(15, 0x62)
                             .u8(16, 0xF2)
                             .u8(17, 0x10)
                             .u8(18, 0x11)
                             .u8(19, 0xD6)
                             .u8(20, 17)
                             .bytes();
    const Bytes after = share(before);
    EXPECT_NE(Bytes(after.begin() + 15, after.begin() + 18), Bytes({0x62, 0xF2, 0x10}));
    EXPECT_EQ(after[16] >> 4, 15);
    const std::int64_t area = read(after, 18, u16.bigEndian());
    EXPECT_NE(area, 4566);
    EXPECT_GE(area, 1000);
    EXPECT_LT(area, 10'000);
    EXPECT_NE(after[20], 17);
    EXPECT_EQ(area, read(share(servingCell()), 26, u16));  // the same area as LTE's, as the number is
}

TEST_F(RecordSharerTest, ReplacesEveryDigitOfEquivalentNetworks) {
    // 262 and 001, a digit of each in turn; then three more bytes of the next one.
    Record record(0x7150, 26);
    const std::uint8_t digits[] = {2, 0, 6, 0, 2, 1, 7, 3, 9};
    record.u8(16, 2);
    for (std::size_t i = 0; i < 9; ++i) record.u8(17 + i, digits[i]);
    const Bytes after = share(record);
    ASSERT_EQ(after.size(), 26U);
    EXPECT_EQ(after[16], 2);
    const std::int64_t country = after[17] * 100 + after[19] * 10 + after[21];
    EXPECT_EQ(country, read(share(servingCell()), 32, u16));
    for (std::size_t at = 23; at < 26; ++at) {
        EXPECT_NE(after[at], digits[at - 17]);
        EXPECT_LT(after[at], 10);
    }
    EXPECT_EQ(share(record), after);
}

// Candidates are 4 bytes apart: what is the first one's cell is the second one's technology.
TEST_F(RecordSharerTest, MakesNoCellATechnologyWhereCandidatesLieOverEachOther) {
    const Bytes before = Record(0xB186, 33).u8(19, 2).u16(23, 1).u16(25, 10'562).u16(27, 300).bytes();
    const Bytes after = share(before);
    EXPECT_EQ(read(after, 23, u16), 1);
    EXPECT_EQ(read(after, 25, u16), 10'562);
    EXPECT_NE(read(after, 27, u16), 300);
    EXPECT_GT(read(after, 27, u16), 4);
    const Bytes technology = share(Record(0xB186, 33).u8(19, 2).u16(23, 1).u16(27, 3));
    EXPECT_EQ(read(technology, 27, u16), 3);
}

TEST_F(RecordSharerTest, TurnsRecordsOfNewerModemsFirst) {
    // A serving cell of version 3: code at 14, channels of 32 bits at 16 and 20.
    const Bytes after =
        share(Record(0xB0C2, 42).u8(13, 3).u16(14, 301).u32(16, 1300).u32(26, 26'385'441).u16(30, 4566));
    ASSERT_EQ(after.size(), 38U);
    EXPECT_EQ(read(after, 1, u16), 37);
    EXPECT_EQ(read(after, 16, u16), 1300);
    EXPECT_EQ(read(after, 14, u16), read(share(servingCell()), 14, u16));
    EXPECT_EQ(read(after, 22, u32), read(share(servingCell()), 22, u32));
}

TEST_F(RecordSharerTest, LeavesOutWhatItCannotRead) {
    EXPECT_EQ(share(Record(0xB195, 60)), Bytes());
    EXPECT_EQ(share(Record(0xB0C2, 39).u8(13, 3)), Bytes());
    EXPECT_EQ(share(Bytes(12, 1)), Bytes());
    EXPECT_EQ(share(Record(0xFF0000, 13).text(13, "no list")), Bytes());
    EXPECT_EQ(share(Record(0xFF0009, 20)), Bytes());
    EXPECT_EQ(share(bytesOf("no list"), Technology::IFX), Bytes());
    EXPECT_EQ(removed("record of a code that Kelvo does not know"), 1U);
    EXPECT_EQ(removed("record in a layout that Kelvo cannot read"), 1U);
    EXPECT_EQ(removed("message that is no record"), 1U);
    EXPECT_EQ(removed("record of the phone that Kelvo cannot read"), 2U);
    EXPECT_EQ(removed("message that is no cell monitor's tree"), 1U);
}

TEST_F(RecordSharerTest, KeepsAPrefixButNotWhatIsInIt) {
    Bytes message = {0x81, 0x77};
    const Bytes packet = servingCell().bytes();
    message.insert(message.end(), packet.begin(), packet.end());
    const Bytes after = share(message);
    ASSERT_EQ(after.size(), message.size());
    EXPECT_EQ(after[0], 0x81);
    EXPECT_EQ(after[1], 0);
    EXPECT_EQ(Bytes(after.begin() + 2, after.end()), share(packet));
}

TEST_F(RecordSharerTest, SaysTheLengthThatTheRecordHas) {
    const Bytes after = share(servingCell().u16(1, 0x4142));
    EXPECT_EQ(read(after, 1, u16), 37);
}

TEST_F(RecordSharerTest, ShiftsTheTimeOnRequest) {
    RecordSharer shifting({.shiftTimes = true}, Pseudonyms::secretOf("a test"));
    const std::uint64_t ticks = 72659535985485082;
    Bytes before = servingCell().bytes();
    for (std::size_t i = 0; i < 8; ++i) before[5 + i] = static_cast<std::uint8_t>(ticks >> 8 * i);
    const auto after = shifting.share(before, Technology::LTE);
    EXPECT_NE(Bytes(after->begin() + 5, after->begin() + 13), Bytes(before.begin() + 5, before.begin() + 13));
    const Bytes unshifted = share(before);
    EXPECT_EQ(Bytes(unshifted.begin() + 5, unshifted.begin() + 13), Bytes(before.begin() + 5, before.begin() + 13));
}

TEST_F(RecordSharerTest, TellsWhatItReplacedFieldByField) {
    share(servingCell());
    share(servingCell());
    const auto& replaced = sharer.tally().replaced();
    EXPECT_EQ(replaced.at("Cell Identity").values, 2U);
    EXPECT_EQ(replaced.at("Tracking Area Code").values, 2U);
    EXPECT_EQ(replaced.at("Physical Cell ID").identity, Identity::PhysicalCell);
    EXPECT_EQ(replaced.at("Mobile Network Code").values, 2U);
    EXPECT_EQ(replaced.size(), 5U);
}

TEST_F(RecordSharerTest, ReadsNothingBehindARecordsEnd) {
    for (const LogCode code : {0xB179, 0x417A, 0x4221, 0x5137, 0xD00A, 0xD00C, 0xD00E, 0x51FF, 0x51F8, 0x4116}) {
        Record record(code, 40);
        for (std::size_t at = 13; at < 40; ++at) record.u8(at, 0xFF);
        record.u8(13, 2);
        const Bytes exact = record.bytes();
        const auto shared = sharer.share(exact, Technology::GSM);
        EXPECT_TRUE(!shared || shared->size() == exact.size()) << std::hex << code;
    }
}

}  // namespace
}  // namespace kelvo
