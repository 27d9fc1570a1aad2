#include "LogGenerator/GSMUMTS/ServingPLMN.h"

#include <gtest/gtest.h>

#include "tests/support/CellArray.h"
#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

using test::cell;
using test::cellArray;

TEST(ServingPLMN, ShowsTheServingNetworkWithABlankForTheFiller) {
    Fed<ServingPLMN> section(
        Record(0x7135, 32).u8(14, 3).u8(15, 0x13).u8(16, 0xF0).u8(17, 0x10).u8(18, 0x11).u8(19, 0xD6).u8(20, 7));
    EXPECT_EQ(section["Mobile Country Code"], "310");
    EXPECT_EQ(section["Mobile Network Code"], "01 ");
    EXPECT_EQ(section["Location Area Code"], "4566");  // 0x11D6: the high byte comes first
    EXPECT_EQ(section["Routing Area Code"], "7");
    EXPECT_EQ(section["Service Type"], "CS_PS_SERVICE");
    EXPECT_EQ(test::keysOf(section.part()),
              (std::vector<std::string>{"Mobile Country Code", "Mobile Network Code", "Location Area Code",
                                        "Routing Area Code", "Service Type"}));
    EXPECT_EQ(section.log(), (Lines{{4, "Serving PLMN"}}));
}

TEST(ServingPLMN, TakesEveryDigitFromItsNibble) {
    Fed<ServingPLMN> section(Record(0x7135, 32).u8(15, 0x21).u8(16, 0x63).u8(17, 0x54));
    EXPECT_EQ(section["Mobile Country Code"], "123");
    EXPECT_EQ(section["Mobile Network Code"], "456");
    section.feed(Record(0x7135, 32).u8(15, 0x9A).u8(16, 0xA9).u8(17, 0xFB));
    EXPECT_EQ(section["Mobile Country Code"], " 99");
    EXPECT_EQ(section["Mobile Network Code"], "   ");
}

TEST(ServingPLMN, NamesServiceTypesAndSelectionModes) {
    test::expectNames<ServingPLMN>(0x7135, 32, 14, "Service Type",
                                   {{0, "NO_SERVICE"},
                                    {1, "CS_ONLY"},
                                    {2, "PS_ONLY"},
                                    {3, "CS_PS_SERVICE"},
                                    {4, "LIMITED_SERVICE"},
                                    {5, "Unknown"},
                                    {255, "Unknown"}});
    test::expectNames<ServingPLMN>(0x7132, 16, 14, "PLMN Sel Mod",
                                   {{0, "Automatic"},
                                    {1, "Manual"},
                                    {2, "Limited"},
                                    {3, "LIMITED_ROUTINE_ACQ"},
                                    {4, "LIMITED_MANUAL_ACQ"},
                                    {5, "Unknown"},
                                    {255, "Unknown"}});
}

TEST(ServingPLMN, ShowsNothingButTheSelectionModeOfARegistrationRecord) {
    Fed<ServingPLMN> section(Record(0x7132, 16).u8(13, 3).u8(14, 1));
    EXPECT_EQ(test::keysOf(section.part()), std::vector<std::string>{"PLMN Sel Mod"});
}

TEST(ServingPLMN, TakesTheFirstServingGsmOrUmtsCellOfTheCellArray) {
    Fed<ServingPLMN> section(cellArray({
        cell("LTE", "Serving", {{"kPLCellMonitorMCC", 1}, {"kPLCellMonitorMNC", 1}, {"kPLCellMonitorLAC", 1}}),
        cell("GSM", "Neighbor", {{"kPLCellMonitorMCC", 2}}),
        Dictionary::make({{"kPLCellMonitorCellType", "kPLCellMonitorCellTypeServing"}, {"kPLCellMonitorMCC", 3}}),
        cell("UMTS", "Serving", {{"kPLCellMonitorMCC", 262}}),
        cell("GSM", "Serving", {{"kPLCellMonitorMCC", 4}, {"kPLCellMonitorMNC", 4}, {"kPLCellMonitorLAC", 4}}),
    }));
    EXPECT_EQ(section["Mobile Country Code"], "262");
    EXPECT_EQ(test::keysOf(section.part()), std::vector<std::string>{"Mobile Country Code"});
    EXPECT_EQ(section.log(), (Lines{{4, "Serving PLMN"},
                                    {3, "ServingPLMN: Failed to retrieve MNC\n"},
                                    {3, "ServingPLMN: Failed to retrieve LAC\n"}}));
}

TEST(ServingPLMN, ShowsTheCodesOfAServingGsmCellAsNumbers) {
    Fed<ServingPLMN> section(cellArray(
        {cell("GSM", "Serving", {{"kPLCellMonitorMCC", 262}, {"kPLCellMonitorMNC", 1}, {"kPLCellMonitorLAC", 4566}})}));
    EXPECT_EQ(section["Mobile Country Code"], "262");
    EXPECT_EQ(section["Mobile Network Code"], "1");
    EXPECT_EQ(section["Location Area Code"], "4566");
    EXPECT_EQ(section.log(), (Lines{{4, "Serving PLMN"}}));
}

TEST(ServingPLMN, SaysThatACellLacksItsCountryCode) {
    Fed<ServingPLMN> section(cellArray({cell("GSM", "Serving", {{"kPLCellMonitorMCC", "262"}})}));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, "Serving PLMN"},
                                    {3, "ServingPLMN: Failed to retrieve MCC\n"},
                                    {3, "ServingPLMN: Failed to retrieve MNC\n"},
                                    {3, "ServingPLMN: Failed to retrieve LAC\n"}}));
}

TEST(ServingPLMN, KeepsTheCodesThatALaterCellLacks) {
    Fed<ServingPLMN> section(cellArray(
        {cell("GSM", "Serving", {{"kPLCellMonitorMCC", 262}, {"kPLCellMonitorMNC", 1}, {"kPLCellMonitorLAC", 4566}})}));
    section.clearLog();
    section.feed(cellArray({cell("UMTS", "Serving", {{"kPLCellMonitorMNC", 2}})}));
    EXPECT_EQ(section["Mobile Country Code"], "262");
    EXPECT_EQ(section["Mobile Network Code"], "2");
    EXPECT_EQ(section["Location Area Code"], "4566");
    EXPECT_EQ(section.log(), (Lines{{4, "Serving PLMN"},
                                    {3, "ServingPLMN: Failed to retrieve MCC\n"},
                                    {3, "ServingPLMN: Failed to retrieve LAC\n"}}));
}

TEST(ServingPLMN, SaysWhatACellLacksEvenWithoutAPlaceOnTheScreen) {
    Fed<ServingPLMN> section{Value()};
    section.feed(cellArray({cell("GSM", "Serving")}));
    EXPECT_EQ(section.log(), (Lines{{4, "Serving PLMN"},
                                    {3, "ServingPLMN: Failed to retrieve MCC\n"},
                                    {3, "ServingPLMN: Failed to retrieve MNC\n"},
                                    {3, "ServingPLMN: Failed to retrieve LAC\n"}}));
}

TEST(ServingPLMN, IgnoresAnEmptyCellArrayAndReportsADamagedOne) {
    Fed<ServingPLMN> section(cellArray({}));
    EXPECT_EQ(section.log(), (Lines{{4, "Serving PLMN"}}));
    section.clearLog();
    section.feed(Record(0xff0001, 13).text(13, "<plist><array>"));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, "Serving PLMN"},
                                    {3, "Cell Info Array data could not be constructed"},
                                    {3, "Failed to get Cell Array\n"}}));
}

TEST(ServingPLMN, IgnoresAShortRecordAndReportsACodeOfOthers) {
    Fed<ServingPLMN> section(Record(0x7135, 31));
    section.feed(Record(0x7132, 15));
    section.feed(Record(0x7131, 40));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, "Serving PLMN"},
                                    {4, "Serving PLMN"},
                                    {4, "Serving PLMN"},
                                    {3, "Received an unknown log message: 28977"}}));
}

}  // namespace
}  // namespace kelvo
