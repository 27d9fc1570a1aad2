#include "telephony/ChannelCommand.h"

#include <gtest/gtest.h>

using kelvo::bytesOf;
using kelvo::ChannelCommand;

namespace {

kelvo::Result<ChannelCommand> parse(const std::string& entries) {
    return ChannelCommand::parse(bytesOf("<plist version=\"1.0\"><dict>" + entries + "</dict></plist>"));
}

std::string reasonOf(const std::string& entries) {
    const auto command = parse(entries);
    return command ? "accepted" : command.error().reason;
}

}  // namespace

TEST(ChannelCommand, AsksForTheTechnology) {
    const auto command = parse("<key>GetTechnology</key><string>GetTechnology</string>");
    ASSERT_TRUE(command);
    EXPECT_TRUE(command->getTechnology);
    EXPECT_FALSE(command->startStreaming);
    EXPECT_FALSE(command->ordinaryCodes);
}

TEST(ChannelCommand, StartsAStreamOfCodes) {
    const auto command = parse(
        "<key>SetState</key><string>Streaming</string>"
        "<key>SetOskraLogCodes</key><array><integer>4234</integer><integer>65535</integer></array>"
        "<key>SetPlExtraCodes</key><array/>");
    ASSERT_TRUE(command);
    EXPECT_TRUE(command->startStreaming);
    ASSERT_TRUE(command->ordinaryCodes);
    EXPECT_EQ(command->ordinaryCodes->count(), 2U);
    EXPECT_TRUE(command->ordinaryCodes->test(0x108A));
    EXPECT_TRUE(command->ordinaryCodes->test(0xFFFF));
    ASSERT_TRUE(command->extendedCodes);
    EXPECT_TRUE(command->extendedCodes->none());
}

TEST(ChannelCommand, IgnoresUnknownKeysBesideKnownOnes) {
    const auto command = parse("<key>Foo</key><true/><key>SetState</key><string>Streaming</string>");
    ASSERT_TRUE(command);
    EXPECT_TRUE(command->startStreaming);
    EXPECT_EQ(command->unknownKeys, 1U);
}

TEST(ChannelCommand, RefusesWhatItDoesNotUnderstand) {
    EXPECT_EQ(reasonOf(""), "it asks for nothing known");
    EXPECT_EQ(reasonOf("<key>Foo</key><true/>"), "it asks for nothing known");
    EXPECT_EQ(reasonOf("<key>SetState</key><string>Sleeping</string>"), "SetState is not \"Streaming\"");
    EXPECT_EQ(reasonOf("<key>SetState</key><integer>1</integer>"), "SetState is not \"Streaming\"");
    EXPECT_EQ(reasonOf("<key>SetOskraLogCodes</key><string>1</string>"), "SetOskraLogCodes is no array");
    EXPECT_EQ(reasonOf("<key>SetPlExtraCodes</key><dict/>"), "SetPlExtraCodes is no array");
    for (const char* bad : {"<integer>-1</integer>", "<integer>65536</integer>", "<string>7</string>", "<true/>",
                            "<real>1.5</real>", "<integer>99999999999</integer>"})
        EXPECT_EQ(reasonOf(std::string("<key>SetOskraLogCodes</key><array>") + bad + "</array>"),
                  "SetOskraLogCodes holds something that is no code");
}

TEST(ChannelCommand, RefusesWhatIsNoDictionary) {
    EXPECT_EQ(ChannelCommand::parse(bytesOf("<plist version=\"1.0\"><array/></plist>")).error().reason,
              "it is no dictionary");
    EXPECT_FALSE(ChannelCommand::parse({}));
    EXPECT_FALSE(ChannelCommand::parse(bytesOf("bplist00garbage")));
}
