#include "LogGenerator/UTRAN/RRC_State.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

Lines decoded(const std::string& mode, const std::string& name) {
    return {{4, "RRC Info"}, {4, "Display Dict = {State = " + name + "}, rrc mode = " + mode + " " + name}};
}

TEST(RRC_State, NamesEveryMode) {
    const char* names[] = {"Disconnected", "Connecting",   "Cell Fach",       "Cell DCH",
                           "Cell PCH",     "Cell URA PCH", "Unknown RRC Mode"};
    for (std::uint32_t mode = 0; mode < 7; ++mode) {
        Fed<RRC_State> section(Record(0xD0E0, 15).u8(13, 1).u8(14, mode));
        EXPECT_EQ(section["State"], names[mode]);
        EXPECT_EQ(section.log(), decoded(std::to_string(mode), names[mode]));
    }
}

TEST(RRC_State, KnowsNoModeUnlessTheRecordSaysSo) {
    for (std::uint32_t version : {0u, 2u, 255u}) {
        Fed<RRC_State> section(Record(0xD0E0, 15).u8(13, version).u8(14, 3));
        EXPECT_EQ(section["State"], "Unknown RRC Mode");
        EXPECT_EQ(section.log(), decoded("255", "Unknown RRC Mode"));
    }
}

TEST(RRC_State, SaysThatARecordIsShortAndDecodesItAllTheSame) {
    Fed<RRC_State> section(Record(0xD0E0, 15).u8(13, 1).u8(14, 3));
    section.clearLog();
    section.feed(Record(0xD0E0, 14));
    EXPECT_EQ(section["State"], "Unknown RRC Mode");
    EXPECT_EQ(section.log(),
              (Lines{{4, "RRC Info"},
                     {4, "LogCode_0xD0E0 is length is 14 expected size 15"},
                     {4, "Display Dict = {State = Unknown RRC Mode}, rrc mode = 255 Unknown RRC Mode"}}));
    section.feed(Bytes(), 0xD0E0);
    EXPECT_EQ(section["State"], "Unknown RRC Mode");
}

TEST(RRC_State, MakesNoModeOfAMissingByte) {
    Fed<RRC_State> section(Record(0xD0E0, 15).u8(13, 1).u8(14, 3));
    section.clearLog();
    section.feed(Record(0xD0E0, 14).u8(13, 1));
    EXPECT_EQ(section["State"], "Unknown RRC Mode");
    EXPECT_EQ(section.log().back().second,
              "Display Dict = {State = Unknown RRC Mode}, rrc mode = 255 Unknown RRC Mode");
}

TEST(RRC_State, DescribesEverythingInItsPartOfTheDisplay) {
    Fed<RRC_State> section(Value(Dictionary::make({{"Note", "here"}, {"Rows", Array::make()}})));
    section.feed(Record(0xD0E0, 15).u8(13, 1).u8(14, 3));
    EXPECT_EQ(section.log().back().second,
              "Display Dict = {Note = here; Rows = array; State = Cell DCH}, rrc mode = 3 Cell DCH");
}

TEST(RRC_State, DecodesIntoNothingWithoutAPartOfTheDisplay) {
    Fed<RRC_State> section{Value()};
    section.feed(Record(0xD0E0, 15).u8(13, 1).u8(14, 3));
    EXPECT_EQ(section.log().back().second, "Display Dict = (none), rrc mode = 3 Cell DCH");
}

TEST(RRC_State, IgnoresACodeOfOthers) {
    Fed<RRC_State> section(Record(0xD0E2, 15).u8(13, 1).u8(14, 3));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, "RRC Info"}}));
}

}  // namespace
}  // namespace kelvo
