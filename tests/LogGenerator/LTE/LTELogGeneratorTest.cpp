#include "LogGenerator/LTE/LTELogGenerator.h"

#include <gtest/gtest.h>

#include <set>

#include "platform/DirectoryResources.h"
#include "platform/Environment.h"
#include "platform/TelephonyConstants.h"
#include "tests/support/Record.h"
#include "tests/support/RecordingLog.h"

namespace kelvo {
namespace {

using test::Record;

std::set<std::int64_t> numbers(const Value& array) {
    std::set<std::int64_t> numbers;
    for (const Value& element : *array.array()) numbers.insert(element.number()->integer());
    EXPECT_EQ(numbers.size(), array.array()->size());  // no code twice
    return numbers;
}

class LTE : public testing::Test {
protected:
    const DirectoryResources resources{KELVO_RESOURCE_DIR};
    test::RecordingLog log;
    Environment::Scope environment{{.log = &log, .resources = &resources}};
};

TEST_F(LTE, IsTheGeneratorOfTheLteTechnology) {
    const auto generator = LogGenerator::generatorFromTechnology("kPLLogChannelTechnology_Oskra_LTE");
    EXPECT_NE(dynamic_cast<LTELogGenerator*>(generator.get()), nullptr);
    EXPECT_EQ(LogGenerator::generatorFromTechnology("kPLLogChannelTechnology_Oskra_LTE2"), nullptr);
    EXPECT_EQ(LogGenerator::generatorFromTechnology(""), nullptr);
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
    EXPECT_EQ(log.lines().front(), test::RecordingLog::Line(3, "Creating LTELogGenerator object"));
    const auto& lines = log.lines();
    EXPECT_EQ(lines[lines.size() - 2].second.find("LTELogGenerator is destructed 0x"), 0U);
    EXPECT_EQ(lines[lines.size() - 2].first, 4);
    EXPECT_EQ(lines.back().second.find("OSK_GSMLogGenerator is destructed 0x"), 0U);
}

TEST_F(LTE, SaysOnStandardOutputThatItsSectionsGo) {
    char* text = nullptr;
    std::size_t size = 0;
    std::FILE* output = open_memstream(&text, &size);
    {
        const Environment::Scope printing({.standardOutput = output});
        const LTELogGenerator generator;
    }
    std::fclose(output);
    EXPECT_STREQ(text, "Deallocing LTEClassIndex\nDeallocing ClassIndex\n");
    std::free(text);
}

TEST_F(LTE, AsksForTheCodesOfItsSections) {
    LTELogGenerator generator;
    const DictionaryRef command = generator.getStartCommand();
    EXPECT_EQ((*command)["SetState"], Value("Streaming"));
    for (std::int64_t code : {0xB0C2, 0xB0C1, 0xB179, 0xB17F}) {
        EXPECT_TRUE(numbers((*command)["SetOskraLogCodes"]).contains(code)) << code;
    }
    EXPECT_TRUE(numbers((*command)["SetPlExtraCodes"]).contains(1));
}

}  // namespace
}  // namespace kelvo
