#include "LogGenerator/PhoneServices/SimInfo.h"

#include <gtest/gtest.h>

#include <array>
#include <exception>
#include <type_traits>

#include "LogGenerator/UnknownDataException.h"
#include "tests/support/CellArray.h"
#include "tests/support/Fed.h"
#include "tests/support/Shows.h"

namespace kelvo {
namespace {

using test::Fed;
using test::Record;
using Lines = std::vector<test::RecordingLog::Line>;

using test::payload;

static_assert(std::is_empty_v<LogCode_0xFF0000::UnknownDataException>);
static_assert(!std::is_base_of_v<std::exception, LogCode_0xFF0000::UnknownDataException>);

struct File {
    const char* name;
    const char* label;
};

constexpr std::array<File, 14> kFiles = {{
    {"kSimFile_ICCID", "EF-ICCID"},
    {"kSimFile_MSISDN", "EF-MSISDN"},
    {"kSimFile_MBDN", "EF-3GPP MAIL BOX DIALING NUMBER"},
    {"kSimFile_HPPLMN", "EF-HPPLMN SEARCH PERIOD"},
    {"kSimFile_LOCI", "EF-LOCI"},
    {"kSimFile_PSLOCI", "EF-GPRS/PS-LOCI"},
    {"kSimFile_ACC", "EF-ACCESS CONTROL CLASS"},
    {"kSimFile_AD", "EF-ADMINISTRATIVE DATA"},
    {"kSimFile_FPLMN", "EF-FPLMN"},
    {"kSimFile_AHPLMN", "EF-ACTING HPLMN"},
    {"kSimFile_RATMODE", "EF-RAT MODE"},
    {"kSimFile_PNN", "EF-PLMN NETWORK NAME"},
    {"kSimFile_OPL", "EF-OPERATOR PLMN LIST"},
    {"kSimFile_OPLMNAcT", "EF-OPLMNAcT"},
}};

TEST(SimInfo, ShowsEveryFileAsItIs) {
    const Value pnn = Array::make({Dictionary::make({{"Name", "Net"}})});
    Fed<SimInfo> section(payload(0xff0000, Dictionary::make({{"kSimFile_OPLMNAcT", "14"},
                                                             {"kSimFile_ICCID", "1"},
                                                             {"kSimFile_MSISDN", "2"},
                                                             {"kSimFile_MBDN", "3"},
                                                             {"kSimFile_HPPLMN", 4},
                                                             {"kSimFile_LOCI", Bytes{5}},
                                                             {"kSimFile_PSLOCI", "6"},
                                                             {"kSimFile_ACC", "7"},
                                                             {"kSimFile_AD", true},
                                                             {"kSimFile_FPLMN", "9"},
                                                             {"kSimFile_AHPLMN", "10"},
                                                             {"kSimFile_RATMODE", "11"},
                                                             {"kSimFile_PNN", pnn},
                                                             {"kSimFile_OPL", "13"},
                                                             {"kSimFile_SPN", "not shown"}})));
    EXPECT_EQ(section.part(), Value(Dictionary::make({{"EF-ICCID", "1"},
                                                      {"EF-MSISDN", "2"},
                                                      {"EF-3GPP MAIL BOX DIALING NUMBER", "3"},
                                                      {"EF-HPPLMN SEARCH PERIOD", 4},
                                                      {"EF-LOCI", Bytes{5}},
                                                      {"EF-GPRS/PS-LOCI", "6"},
                                                      {"EF-ACCESS CONTROL CLASS", "7"},
                                                      {"EF-ADMINISTRATIVE DATA", true},
                                                      {"EF-FPLMN", "9"},
                                                      {"EF-ACTING HPLMN", "10"},
                                                      {"EF-RAT MODE", "11"},
                                                      {"EF-PLMN NETWORK NAME", pnn},
                                                      {"EF-OPERATOR PLMN LIST", "13"},
                                                      {"EF-OPLMNAcT", "14"}})));
    EXPECT_EQ(section.log(), (Lines{{4, "SimInfo"}}));
}

TEST(SimInfo, KeepsTheFilesThatARecordLacks) {
    Fed<SimInfo> section(payload(0xff0000, Dictionary::make({{"kSimFile_ICCID", "1"}, {"kSimFile_ACC", "7"}})));
    section.feed(payload(0xff0000, Dictionary::make({{"kSimFile_ICCID", "2"}})));
    EXPECT_EQ(section.part(), Value(Dictionary::make({{"EF-ICCID", "2"}, {"EF-ACCESS CONTROL CLASS", "7"}})));
}

TEST(SimInfo, UpdatesOneFileAndLeavesThirteenInTheirPlaces) {
    const DictionaryRef files = Dictionary::make();
    for (std::size_t i = kFiles.size(); i > 0; --i) files->set(kFiles[i - 1].name, std::to_string(i));  // backwards
    Fed<SimInfo> section(payload(0xff0000, files));
    section.feed(payload(0xff0000, Dictionary::make({{"kSimFile_ICCID", "x"}})));

    std::vector<std::string> labels;
    for (const File& file : kFiles) labels.emplace_back(file.label);
    EXPECT_EQ(test::keysOf(section.part()), labels);
    EXPECT_EQ(section["EF-ICCID"], "x");
    for (std::size_t i = 1; i < kFiles.size(); ++i) EXPECT_EQ(section[kFiles[i].label], std::to_string(i + 1));
}

TEST(SimInfo, ThrowsForADamagedRecordAfterItsErrorLine) {
    for (const Record& record : {Record(0xff0000, 13), Record(0xff0000, 13).text(13, "<plist><dict>"),
                                 Record(0xff0000, 13).text(13, "bplist00")}) {
        Fed<SimInfo> section;
        EXPECT_THROW(section.feed(record), LogCode_0xFF0000::UnknownDataException);
        EXPECT_TRUE(section.part().dictionary()->empty());
        EXPECT_EQ(section.log(), (Lines{{4, "SimInfo"}, {3, "SIM File dictionary data could not be constructed"}}));
    }
}

TEST(SimInfo, TakesAnythingButADictionaryForOneWithoutFiles) {
    Fed<SimInfo> section;
    section.feed(payload(0xff0000, Array::make({"kSimFile_ICCID"})));
    section.feed(payload(0xff0000, "kSimFile_ICCID"));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines(2, {4, "SimInfo"})));
}

TEST(SimInfo, IgnoresACodeOfOthersWithoutAWord) {
    Fed<SimInfo> section(payload(0xff0002, Dictionary::make({{"kSimFile_ICCID", "1"}})));
    section.feed(Record(0xff0001, 13));
    EXPECT_TRUE(section.part().dictionary()->empty());
    EXPECT_EQ(section.log(), (Lines(2, {4, "SimInfo"})));
}

}  // namespace
}  // namespace kelvo
