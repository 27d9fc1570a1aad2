#include "LogGenerator/LTE/LTELogGenerator.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <set>

#include "LogGenerator/Factory.h"
#include "LogGenerator/LTE/LTEClassIndex.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tests/support/CapturedOutput.h"
#include "tests/support/Record.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/TemplateScreens.h"

namespace kelvo {
namespace {

using test::Record;
using test::RecordingLog;

std::set<std::int64_t> numbers(const Value& array) {
    std::set<std::int64_t> numbers;
    for (const Value& element : *array.array()) numbers.insert(element.number()->integer());
    EXPECT_EQ(numbers.size(), array.array()->size());  // no code twice
    return numbers;
}

class LTE : public testing::Test {
protected:
    const DirectoryResources resources{KELVO_RESOURCE_DIR};
    RecordingLog log;
    Environment::Scope environment{{.log = &log, .resources = &resources}};
};

TEST_F(LTE, IsTheGeneratorOfTheLteTechnology) {
    const auto generator = generatorFromTechnology("kPLLogChannelTechnology_Oskra_LTE");
    EXPECT_NE(dynamic_cast<LTELogGenerator*>(generator.get()), nullptr);
    EXPECT_EQ(generatorFromTechnology("kPLLogChannelTechnology_Oskra_LTE2"), nullptr);
    EXPECT_EQ(generatorFromTechnology(""), nullptr);
}

TEST_F(LTE, ShowsARecordOnItsScreen) {
    Dictionary state;
    LTELogGenerator generator;
    generator.updateState(state, Record(0xB0C2, 38).u16(16, 5780).bytes());
    const Value display = generator.generateLogUsingState(state);
    EXPECT_EQ((*(*display.dictionary())["Serving Cell Info"].dictionary())["Download Frequency"], Value("5780"));
}

TEST_F(LTE, SaysThatItIsCreatedAndDestructed) {
    { const LTELogGenerator generator; }
    EXPECT_EQ(log.lines().front(), RecordingLog::Line(3, "Creating LTELogGenerator object"));
    const auto& lines = log.lines();
    EXPECT_EQ(lines[lines.size() - 2].second.find("LTELogGenerator is destructed 0x"), 0U);
    EXPECT_EQ(lines[lines.size() - 2].first, 4);
    EXPECT_EQ(lines.back().second.find("OSK_GSMLogGenerator is destructed 0x"), 0U);
}

TEST_F(LTE, SaysOnStandardOutputThatItsSectionsGo) {
    const test::CapturedOutput output;
    {
        const Environment::Scope printing({.standardOutput = output.file()});
        const LTELogGenerator generator;
    }
    EXPECT_EQ(output.text(), "Deallocing LTEClassIndex\nDeallocing ClassIndex\n");
}

using LTEScreens = test::TemplateScreens<LTELogGenerator>;

constexpr const char* kValueScreens[] = {
    "Serving Cell Info",     "Serving Cell Measurements", "Connected mode LTE Intra-frequency Measurement",
    "Neighbor Measurements", "Reselection Candidates",    "SIM Info"};
constexpr const char* kListScreens[] = {"Measured Neighbor Cells", "Detected Cells", "Neighbor Cells List",
                                        "Reselection Candidates List", "PDP Context Info"};

TEST_F(LTEScreens, HaveAPlaceForEverySection) {
    for (const char* name : kValueScreens) EXPECT_TRUE(screen(name)) << name;
    for (const char* name : kListScreens) EXPECT_TRUE(rows(name)) << name;
}

TEST_F(LTEScreens, HaveOnePlaceForEverySectionOfTheClassIndex) {
    const LTEClassIndex index;
    for (std::string_view name : index.getAllNames()) {
        const RecordingLog::Line bound(4, name);  // written when a section is bound
        EXPECT_EQ(std::count(log.lines().begin(), log.lines().end(), bound), 1) << name;
        EXPECT_TRUE((*state["Display"].dictionary())[name]) << name;
    }
}

TEST_F(LTEScreens, HaveAPlaceForEveryValueOfTheOrdinaryRecords) {
    std::size_t before = 0;
    for (const char* name : kValueScreens) before += screen(name)->size();
    for (const LogCode code : {0xB0C2, 0xB0C1, 0xB179, 0xB17F, 0xB180, 0xB186}) feed(Record(code, 60));
    std::size_t after = 0;
    for (const char* name : kValueScreens) {
        after += screen(name)->size();
        if (std::string_view(name) == "SIM Info") continue;
        for (const auto& [key, value] : *screen(name)) EXPECT_NE(value, Value("–")) << name << ": " << key;
    }
    EXPECT_EQ(after, before);
}

TEST_F(LTEScreens, OfferARecordToItsSectionsInOrder) {
    log.clear();
    feed(Record(0xB179, 47).u8(27, 2).u8(28, 3).u16(29, 301).u16(41, 11));
    EXPECT_EQ(log.lines(), (std::vector<RecordingLog::Line>{{4, "Connected mode LTE Intra-frequency Measurement"},
                                                            {4, "Measured Neighbor Cells"},
                                                            {4, "Detected Cells"}}));
    EXPECT_EQ((*(*rows("Measured Neighbor Cells"))[0].dictionary())["Physical Cell ID"], Value("301"));
    EXPECT_EQ((*(*rows("Detected Cells"))[0].dictionary())["Physical Cell ID"], Value("11"));

    log.clear();
    feed(Record(0xB180, 20));
    feed(Record(0xB186, 20));
    EXPECT_EQ(log.lines(), (std::vector<RecordingLog::Line>{{4, "Neighbor Measurements"},
                                                            {4, "Neighbor Cells List"},
                                                            {4, "Reselection Candidates"},
                                                            {4, "Reselection Candidates List"}}));
}

TEST_F(LTEScreens, ChangeNothingForAConnectedModeRecordThatIsOneByteShort) {
    const Value before = state["Display"].copy();
    feed(Record(0xB179, 28).u8(17, 9).u8(27, 2));
    EXPECT_EQ(state["Display"], before);
}

TEST_F(LTEScreens, AskForTheRecordsTheyShow) {
    const DictionaryRef command = generator.getStartCommand();
    EXPECT_EQ((*command)["SetState"], Value("Streaming"));
    EXPECT_EQ(numbers((*command)["SetOskraLogCodes"]),
              (std::set<std::int64_t>{0xB0C2, 0xB0C1, 0xB179, 0xB17F, 0xB180, 0xB186}));
    EXPECT_EQ(numbers((*command)["SetPlExtraCodes"]), (std::set<std::int64_t>{0, 1, 2}));
}

}  // namespace
}  // namespace kelvo
