#include "LogGenerator/UTRAN/UTRANServingCellInfo.h"

#include <gtest/gtest.h>

#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

constexpr const char* kTitle = "Serving Cell Info";

Record cellArray(const std::string& cells) {
    return Record(0xFF0001, 13).text(13, "<plist version=\"1.0\"><array>" + cells + "</array></plist>");
}

std::string number(const std::string& key, int value) {
    return "<key>kPLCellMonitor" + key + "</key><integer>" + std::to_string(value) + "</integer>";
}

std::string cell(const std::string& technology, const std::string& type, const std::string& more) {
    return "<dict><key>kPLCellMonitorCellRadioAccessTechnology</key><string>kPLCellMonitorRadioAccessTechnology" +
           technology + "</string><key>kPLCellMonitorCellType</key><string>kPLCellMonitorCellType" + type +
           "</string>" + more + "</dict>";
}

/// Reports one serving cell whose LAC is the XML element `lac`.
Record cellWithLac(const std::string& lac) {
    return cellArray(cell("UTRAN2", "Serving",
                          "<key>kPLCellMonitorLAC</key>" + lac + number("CellId", 1) + number("BandInfo", 1) +
                              number("SCN", 1) + number("UARFCN", 1)));
}

Record servingCell() {
    return Record(0xD0E2, 26).u8(14, 200).u8(15, 201).u16(17, 9400).u16(19, 10054).u32(21, 12345678).u8(25, 1);
}

TEST(UTRANServingCellInfo, ShowsEveryField) {
    Fed<UTRANServingCellInfo> section(servingCell());
    EXPECT_EQ(section["Cell Access Restrictions"], "200");
    EXPECT_EQ(section["URA ID"], "201");
    EXPECT_EQ(section["Uplink UARFCN"], "9400");
    EXPECT_EQ(section["Downlink UARFCN"], "10054");
    EXPECT_EQ(section["Cell ID"], "12345678");
    EXPECT_EQ(section["Allowed Access"], "Emergency Calls Only");
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
}

TEST(UTRANServingCellInfo, ShowsTheFieldsInTheirOrder) {
    const Fed<UTRANServingCellInfo> section(servingCell());
    EXPECT_EQ(test::keysOf(section.part()),
              (std::vector<std::string>{"Cell Access Restrictions", "Cell ID", "Downlink UARFCN", "Uplink UARFCN",
                                        "URA ID", "Allowed Access"}));
}

TEST(UTRANServingCellInfo, ReadsTheLowestBitAloneForTheAllowedAccess) {
    Fed<UTRANServingCellInfo> section(servingCell().u8(25, 0xFE));
    EXPECT_EQ(section["Allowed Access"], "All Calls");
}

TEST(UTRANServingCellInfo, PrintsTheCellIdAsSigned) {
    Fed<UTRANServingCellInfo> section(servingCell().u32(21, 0xFFFFFFFE));
    EXPECT_EQ(section["Cell ID"], "-2");
}

TEST(UTRANServingCellInfo, IgnoresAShortRecordAndACodeOfOthers) {
    Fed<UTRANServingCellInfo> section;
    section.feed(servingCell().cut(25), 0xD0E2);
    section.feed(Record(0xD0E0, 40));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {4, kTitle}}));
}

TEST(UTRANServingCellInfo, TakesTheUtranCellOfACellArray) {
    Fed<UTRANServingCellInfo> section(servingCell());
    section.clearLog();
    section.feed(cellArray(cell("GSM", "Serving", number("LAC", 1) + number("CellId", 1)) +
                           cell("UTRAN2", "Neighbor", number("LAC", 2)) + "<string>no cell</string><dict/>" +
                           cell("UTRAN2", "Serving",
                                number("LAC", 4566) + number("CellId", -5) + number("BandInfo", 34) +
                                    number("SCN", 126) + number("UARFCN", 10088))));
    EXPECT_EQ(section["Local Area Code"], "4566");
    EXPECT_EQ(section["Cell ID"], "-5");
    EXPECT_EQ(section["Freq Band Indicator"], "34");
    EXPECT_EQ(section["Cell Scrambling Code"], "126");
    EXPECT_EQ(section["Uplink UARFCN"], "10088");
    EXPECT_EQ(section["Downlink UARFCN"], "10088");
    EXPECT_EQ(section["URA ID"], "201");
    EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
    section.feed(servingCell());
    EXPECT_EQ(section["Cell ID"], "12345678");  // whichever record came last
}

TEST(UTRANServingCellInfo, ShowsTheLastOfSeveralServingCells) {
    Fed<UTRANServingCellInfo> section(cellArray(cell("UTRAN2", "Serving", number("LAC", 1) + number("SCN", 9)) +
                                                cell("UTRAN2", "Serving", number("LAC", 2))));
    EXPECT_EQ(section["Local Area Code"], "2");
    EXPECT_EQ(section["Cell Scrambling Code"], "9");
}

TEST(UTRANServingCellInfo, SaysOnceWhichValueACellLacks) {
    Fed<UTRANServingCellInfo> section(servingCell());
    section.clearLog();
    section.feed(cellArray(cell("UTRAN2", "Serving", "<key>kPLCellMonitorSCN</key><string>126</string>")));
    EXPECT_EQ(section["Cell ID"], "12345678");
    EXPECT_EQ(section["Uplink UARFCN"], "9400");
    EXPECT_EQ(section["Cell Scrambling Code"], "(absent)");
    EXPECT_EQ(section.log(), (Lines{{4, kTitle},
                                    {3, "Serving Cell Info: Failed to retrieve LAC\n"},
                                    {3, "Serving Cell Info: Failed to retrieve Cell ID\n"},
                                    {3, "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
                                    {3, "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n"},
                                    {3, "Serving Cell Info: Failed to retrieve UARFCN\n"}}));
}

TEST(UTRANServingCellInfo, TakesWholeNumbersOfThirtyTwoSignedBitsAlone) {
    Fed<UTRANServingCellInfo> section(cellWithLac("<integer>4566</integer>"));
    for (const char* lac : {"<integer>2147483648</integer>", "<real>1.5</real>", "<true/>"}) {
        section.clearLog();
        section.feed(cellWithLac(lac));
        EXPECT_EQ(section["Local Area Code"], "4566") << lac;
        EXPECT_EQ(section.log(), (Lines{{4, kTitle}, {3, "Serving Cell Info: Failed to retrieve LAC\n"}})) << lac;
    }
    section.feed(cellWithLac("<integer>-2147483648</integer>"));
    EXPECT_EQ(section["Local Area Code"], "-2147483648");
}

TEST(UTRANServingCellInfo, SaysWhichValueACellLacksWithoutAPartOfTheDisplay) {
    Fed<UTRANServingCellInfo> section{Value()};
    section.feed(cellArray(cell("UTRAN2", "Serving", number("LAC", 1) + number("SCN", 1))));
    EXPECT_EQ(section.log(), (Lines{{4, kTitle},
                                    {3, "Serving Cell Info: Failed to retrieve Cell ID\n"},
                                    {3, "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"},
                                    {3, "Serving Cell Info: Failed to retrieve UARFCN\n"}}));
}

TEST(UTRANServingCellInfo, DropsAPayloadThatIsNoArray) {
    for (const Record& record :
         {Record(0xFF0001, 13), Record(0xFF0001, 20), Record(0xFF0001, 5),
          Record(0xFF0001, 13).text(13, "<plist><array>"), Record(0xFF0001, 13).text(13, "<plist><dict/></plist>")}) {
        Fed<UTRANServingCellInfo> section(record);
        EXPECT_TRUE(section.part().dictionary()->empty());
        EXPECT_EQ(section.log(), (Lines{{4, kTitle}}));
    }
}

}  // namespace
}  // namespace kelvo
