#include "LogGenerator/GSMUMTS/HSDPAInformation.h"

#include <gtest/gtest.h>

#include <memory>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kPrimary = "Primary HARQ Process";
constexpr const char* kSecondary = "Secondary HARQ Process";

Value process(const char* id, const char* bits, const char* transmissions, const char* errors) {
    return Dictionary::make(
        {{"Process ID", id}, {"No Rx Bits", bits}, {"New Tx", transmissions}, {"Block Errors", errors}});
}

const Value& list(const Fed<HSDPAInformation>& section, const char* key) { return (*section.part().dictionary())[key]; }

TEST(HSDPAInformation, ShowsVersionSubFramesAndCarriers) {
    Fed<HSDPAInformation> section(Record(0x4221, 18).u8(13, 255).u16(14, 0xF000 | 2 << 10 | 1023));
    EXPECT_EQ(section["Version"], "255");
    EXPECT_EQ(section["Sub Frames"], "1023");
    EXPECT_EQ(section["Carrier Info"], "Dual Carrier");
    EXPECT_EQ(test::keysOf(section.part()), (std::vector<std::string>{"Version", "Sub Frames", "Carrier Info"}));
    EXPECT_EQ(section.log(), (Lines{{4, "HSDPA Info"}}));
}

TEST(HSDPAInformation, NamesEveryCarrierConfiguration) {
    const char* names[] = {"Single Carrier", "MIMO", "Dual Carrier", "Reserved"};
    for (std::uint32_t value = 0; value < 4; ++value) {
        Fed<HSDPAInformation> section(Record(0x4221, 18).u16(14, value << 10));
        EXPECT_EQ(section["Carrier Info"], names[value]);
        EXPECT_EQ(section["Sub Frames"], "0");
    }
}

TEST(HSDPAInformation, ShowsTheProcessesOfThePrimaryCarrier) {
    Fed<HSDPAInformation> section(Record(0x4221, 36)
                                      .u8(16, 2)
                                      .u8(18, 5)
                                      .u32(19, 4294967295)
                                      .u16(23, 65535)
                                      .u16(25, 12)
                                      .u8(27, 6)
                                      .u32(28, 1000)
                                      .u16(32, 20)
                                      .u16(34, 3));
    EXPECT_EQ(list(section, kPrimary),
              Value(Array::make({process("5", "4294967295", "65535", "12"), process("6", "1000", "20", "3")})));
    EXPECT_EQ(section[kSecondary], "(absent)");
}

TEST(HSDPAInformation, ReadsTheSecondaryCarrierBehindAGap) {
    Fed<HSDPAInformation> section(Record(0x4221, 189).u8(16, 1).u8(17, 1).u8(18, 1).u8(27, 2).u8(180, 3).u32(181, 7));
    EXPECT_EQ(list(section, kPrimary), Value(Array::make({process("1", "0", "0", "0")})));
    EXPECT_EQ(list(section, kSecondary), Value(Array::make({process("3", "7", "0", "0")})));
}

TEST(HSDPAInformation, WidensTheGapWithEveryPrimaryProcess) {
    Fed<HSDPAInformation> section(Record(0x4221, 360).u8(16, 2).u8(17, 2).u8(342, 7).u8(351, 8).u8(180, 99));
    EXPECT_EQ(list(section, kSecondary),
              Value(Array::make({process("7", "0", "0", "0"), process("8", "0", "0", "0")})));
}

TEST(HSDPAInformation, ReadsTheSecondaryCarrierAtTheStartWithoutAPrimaryOne) {
    Fed<HSDPAInformation> section(Record(0x4221, 27).u8(17, 1).u8(18, 9));
    EXPECT_EQ(list(section, kSecondary), Value(Array::make({process("9", "0", "0", "0")})));
    EXPECT_EQ(section[kPrimary], "(absent)");
}

TEST(HSDPAInformation, KeepsTheListsThatARecordDoesNotCarry) {
    Fed<HSDPAInformation> section(Record(0x4221, 18 + 2 * 162 + 9).u8(13, 1).u8(16, 2).u8(17, 1));
    const Value before = list(section, kPrimary);
    section.feed(Record(0x4221, 18).u8(13, 2));
    EXPECT_EQ(section["Version"], "2");
    EXPECT_EQ(list(section, kPrimary).array()->size(), 2U);
    EXPECT_EQ(list(section, kSecondary).array()->size(), 1U);
    EXPECT_EQ(list(section, kPrimary).array(), before.array());
}

/// One process on each carrier.
Record bothCarriers(std::uint32_t primaryId, std::uint32_t secondaryId) {
    return Record(0x4221, 189).u8(16, 1).u8(17, 1).u8(18, primaryId).u8(180, secondaryId);
}

TEST(HSDPAInformation, LeavesTheListsOfAnEarlierRecordToTheirHolders) {
    Fed<HSDPAInformation> section(bothCarriers(1, 2));
    const ArrayRef primary = list(section, kPrimary).array();
    const ArrayRef secondary = list(section, kSecondary).array();
    section.feed(bothCarriers(3, 4));
    EXPECT_EQ(Value(primary), Value(Array::make({process("1", "0", "0", "0")})));
    EXPECT_EQ(Value(secondary), Value(Array::make({process("2", "0", "0", "0")})));
    EXPECT_NE(list(section, kPrimary).array(), primary);
    EXPECT_NE(list(section, kSecondary).array(), secondary);
    EXPECT_EQ(list(section, kPrimary), Value(Array::make({process("3", "0", "0", "0")})));
    EXPECT_EQ(list(section, kSecondary), Value(Array::make({process("4", "0", "0", "0")})));
}

TEST(HSDPAInformation, StoresNewListsEvenWhereNobodyHoldsTheOldOnes) {
    Fed<HSDPAInformation> section(bothCarriers(1, 2));
    const std::weak_ptr<Array> primary = list(section, kPrimary).array();
    const std::weak_ptr<Array> secondary = list(section, kSecondary).array();
    section.feed(bothCarriers(1, 2));
    EXPECT_TRUE(primary.expired());
    EXPECT_TRUE(secondary.expired());
}

TEST(HSDPAInformation, MakesUpNoProcessesBeyondTheEnd) {
    Fed<HSDPAInformation> section(Record(0x4221, 28).u8(16, 255).u8(17, 255));
    EXPECT_EQ(list(section, kPrimary).array()->size(), 2U);
    EXPECT_EQ(list(section, kSecondary), Value(Array::make()));
}

TEST(HSDPAInformation, IgnoresAShortRecordAndACodeOfOthersWithoutAWord) {
    Fed<HSDPAInformation> section(Record(0x4221, 17));
    section.feed(Record(0x4222, 40));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines(2, {4, "HSDPA Info"})));
}

}  // namespace
}  // namespace kelvo
