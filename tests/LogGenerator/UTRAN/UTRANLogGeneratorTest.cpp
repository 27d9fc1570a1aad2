#include "LogGenerator/UTRAN/UTRANLogGenerator.h"

#include <gtest/gtest.h>

#include <set>

#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tests/support/CapturedOutput.h"
#include "tests/support/CellArray.h"
#include "tests/support/Record.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemplateScreens.h"

namespace kelvo {
namespace {

using test::Record;
using test::RecordingLog;

/// Resources that exist by their paths alone; remembers which template was asked for.
class ListedResources final : public Resources {
public:
    explicit ListedResources(std::vector<std::string> paths) : _paths(std::move(paths)) {}

    Result<DictionaryRef> dictionary(std::string_view name) const override {
        asked = name;
        return Dictionary::make({{"RRC Info", Dictionary::make()}});
    }
    std::vector<std::string> pathsOfType(std::string_view type) const override {
        return type == "plist" ? _paths : std::vector<std::string>();
    }

    mutable std::string asked;

private:
    std::vector<std::string> _paths;
};

std::string templateAmong(std::vector<std::string> paths) {
    const ListedResources resources(std::move(paths));
    const Environment::Scope environment({.resources = &resources});
    Dictionary state;
    UTRANLogGenerator().getDisplayFromState(state);
    return resources.asked;
}

TEST(UTRANLogGenerator, TakesTheFirstTemplateThatMentionsUtranInAnyCase) {
    EXPECT_EQ(templateAmong({"/r/GSM.plist", "/r/utran_v2.plist", "/r/UTRAN.plist"}), "utran_v2");
    EXPECT_EQ(templateAmong({"/r/UTRAN.plist", "/r/utran_v2.plist"}), "UTRAN");
    EXPECT_EQ(templateAmong({"/r/UTRA.plist", "/r/my.Utran.plist"}), "my.Utran");
}

TEST(UTRANLogGenerator, LooksAtTheTemplatesNameAndNotAtItsDirectories) {
    EXPECT_EQ(templateAmong({"/opt/utran/GSM.plist", "/opt/utran/UTRAN.plist"}), "UTRAN");
    EXPECT_EQ(templateAmong({"/home/UTRAN tests/LTE.plist", "/home/UTRAN tests/my.utran.plist"}), "my.utran");
}

TEST(UTRANLogGenerator, SaysWhatItBuilds) {
    const ListedResources resources({"UTRAN.plist"});
    RecordingLog log;
    const Environment::Scope environment({.log = &log, .resources = &resources});
    const auto generator = UTRANLogGenerator::generator();
    std::vector<RecordingLog::Line> lines = log.lines();
    for (auto& [level, text] : lines) {
        if (const std::size_t address = text.find("0x"); address != std::string::npos) text.resize(address + 2);
    }
    EXPECT_EQ(lines, (std::vector<RecordingLog::Line>{{4, "Array Count: 1"},
                                                      {4, "Array Count: 2"},
                                                      {4, "Array Count: 1"},
                                                      {4, "Array Count: 1"},
                                                      {4, "Array Count: 1"},
                                                      {4, "Array Count: 1"},
                                                      {4, "Array Count: 1"},
                                                      {4, "Array Count: 1"},
                                                      {3, "Creating OSKLogGenerator2 object with 0x"},
                                                      {4, "Creating Log object: 0x"},
                                                      {3, "Class Index: 1"},
                                                      {3, "Created UTRANLogGenerator object"}}));
}

TEST(UTRANLogGenerator, SaysOnStandardOutputThatItsSectionsGo) {
    const ListedResources resources({"UTRAN.plist"});
    const test::CapturedOutput output;
    {
        const Environment::Scope environment({.resources = &resources, .standardOutput = output.file()});
        const UTRANLogGenerator generator;
    }
    EXPECT_EQ(output.text(), "Deallocing UTRANClassIndex\nDeallocing ClassIndex\n");
}

class HalfBuiltUTRANLogGenerator : public testing::TestWithParam<std::vector<std::string>> {
protected:
    ListedResources resources{GetParam()};
    RecordingLog log;
    Environment::Scope environment{{.log = &log, .resources = &resources}};
};

TEST_P(HalfBuiltUTRANLogGenerator, IsMadeWithoutAWordOnTheLog) {
    const UTRANLogGenerator generator;
    EXPECT_TRUE(log.lines().empty());
}

TEST_P(HalfBuiltUTRANLogGenerator, DecodesNothingAndHarmsNothing) {
    UTRANLogGenerator generator;
    Dictionary state;
    const Bytes record = Record(0xD0E0, 15).u8(13, 1).u8(14, 3).bytes();
    generator.updateState(state, record);
    EXPECT_EQ(log.lines(), (std::vector<RecordingLog::Line>{{3, "Cannot load template for display"}}));
    EXPECT_FALSE(generator.generateLogUsingState(state));
    EXPECT_EQ(resources.asked, "");
    EXPECT_FALSE(state["Display"]);
    EXPECT_EQ(Value(generator.getStartCommand()), Value(Dictionary::make({{"SetState", "Streaming"},
                                                                          {"SetOskraLogCodes", Array::make()},
                                                                          {"SetPlExtraCodes", Array::make()}})));
    EXPECT_EQ(generator.getSaveContentsFromState(state)->size(), 2U);  // the snapshot and the DLF
}

TEST_P(HalfBuiltUTRANLogGenerator, LeavesTheDisplayOfAnotherAsItIs) {
    UTRANLogGenerator generator;
    Dictionary state;
    const Value display = Dictionary::make({{"RRC Info", Dictionary::make({{"State", "Cell PCH"}})}});
    state.set("Template", display);
    state.set("Display", display.copy());
    generator.updateState(state, Record(0xD0E0, 15).u8(13, 1).u8(14, 3).bytes());
    EXPECT_EQ(generator.generateLogUsingState(state), display);
    EXPECT_EQ(generator.processTemplate(display), display);
    generator.updateWithData(Bytes(20, 9));
    EXPECT_EQ(state["Display"], display);
}

INSTANTIATE_TEST_SUITE_P(WithoutATemplate, HalfBuiltUTRANLogGenerator,
                         testing::Values(std::vector<std::string>(),
                                         std::vector<std::string>{"/utran/GSM.plist", "/utran/UTRA.plist"}));

using UTRANScreens = test::TemplateScreens<UTRANLogGenerator>;

TEST_F(UTRANScreens, HaveAPlaceForEverySection) {
    for (const char* name : {"RRC Info", "Serving Cell Info", "SIM Info"}) EXPECT_TRUE(screen(name)) << name;
    for (const char* name :
         {"Neighbor Cell List", "GSM Neighbor Cell List", "TRCH BLER", "CCTRCH SIR", "PDP Context Info"}) {
        EXPECT_TRUE(rows(name)) << name;
    }
}

TEST_F(UTRANScreens, HaveAPlaceForEveryValue) {
    const std::size_t before = screen("Serving Cell Info")->size();
    feed(Record(0xD0E0, 15));
    feed(Record(0xD0E2, 26));
    feed(test::cellArray({test::cell("UTRAN2", "Serving",
                                     {{"kPLCellMonitorLAC", 1},
                                      {"kPLCellMonitorCellId", 1},
                                      {"kPLCellMonitorBandInfo", 1},
                                      {"kPLCellMonitorSCN", 1},
                                      {"kPLCellMonitorUARFCN", 1}})}));
    EXPECT_EQ(screen("RRC Info")->size(), 1U);
    EXPECT_EQ(screen("Serving Cell Info")->size(), before);
    for (const char* name : {"RRC Info", "Serving Cell Info"}) {
        for (const auto& [key, value] : *screen(name)) EXPECT_NE(value, Value("–")) << name << ": " << key;
    }
}

TEST_F(UTRANScreens, HaveAPlaceForEverySimFile) {
    const std::size_t before = screen("SIM Info")->size();
    const DictionaryRef files = Dictionary::make();
    for (const char* file : {"ICCID", "MSISDN", "MBDN", "HPPLMN", "LOCI", "PSLOCI", "ACC", "AD", "FPLMN", "AHPLMN",
                             "RATMODE", "PNN", "OPL", "OPLMNAcT"}) {
        files->set("kSimFile_" + std::string(file), "content");
    }
    feed(test::payload(0xFF0000, files));
    EXPECT_EQ(screen("SIM Info")->size(), before);
    for (const auto& [label, value] : *screen("SIM Info")) EXPECT_EQ(value, Value("content")) << label;
}

TEST_F(UTRANScreens, ShowWhatRecordsBring) {
    feed(Record(0xD0E0, 15).u8(13, 1).u8(14, 3));
    feed(Record(0xD00A, 184).u8(16, 2).u32(168, 10088));
    EXPECT_EQ((*screen("RRC Info"))["State"], Value("Cell DCH"));
    ASSERT_EQ(rows("Neighbor Cell List")->size(), 1U);
    EXPECT_EQ((*(*rows("Neighbor Cell List"))[0].dictionary())["UARFCN"], Value("10088"));
}

TEST_F(UTRANScreens, ShowOneRecordInBothChannelLists) {
    log.clear();
    feed(Record(0xD00C, 331).u16(14, 1 << 6 | 1 << 12).u8(17, 4).u8(323, 3));
    EXPECT_EQ(log.lines(),
              (std::vector<RecordingLog::Line>{{5, "TRCH BLER Measurement"}, {4, "CCTRCH SIR Measurement"}}));
    EXPECT_EQ((*(*rows("TRCH BLER"))[0].dictionary())["TRCH ID"], Value("4"));
    EXPECT_EQ((*(*rows("CCTRCH SIR"))[0].dictionary())["CCTRCH ID"], Value("3"));
}

std::set<std::int64_t> numbers(const Value& list) {
    std::set<std::int64_t> numbers;
    for (const Value& code : *list.array()) numbers.insert(code.number()->integer());
    return numbers;
}

TEST_F(UTRANScreens, AskForTheRecordsTheyShow) {
    const DictionaryRef command = generator.getStartCommand();
    EXPECT_EQ((*command)["SetState"], Value("Streaming"));
    EXPECT_EQ(numbers((*command)["SetOskraLogCodes"]),
              (std::set<std::int64_t>{0xD0E0, 0xD0E2, 0xD00A, 0xD00E, 0xD00C}));
    EXPECT_EQ(numbers((*command)["SetPlExtraCodes"]), (std::set<std::int64_t>{0, 1, 2}));
}

}  // namespace
}  // namespace kelvo
