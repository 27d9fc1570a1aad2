#include <gtest/gtest.h>

#include <algorithm>

#include "LogGenerator/LTE/LTELogGenerator.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "tests/support/CellArray.h"

namespace kelvo {
namespace {

using test::payload;

class LTESharedSections : public testing::Test {
protected:
    const Value& section(const char* name) { return (*state["Display"].dictionary())[name]; }

    const DirectoryResources resources{KELVO_RESOURCE_DIR};
    Environment::Scope environment{{.resources = &resources}};
    Dictionary state;
    LTELogGenerator generator;
};

TEST_F(LTESharedSections, ShowSimFilesOnTheLteScreens) {
    generator.getDisplayFromState(state);
    EXPECT_EQ(section("SIM Info").dictionary()->size(), 14U);
    const DictionaryRef files = Dictionary::make();
    for (const char* file : {"ICCID", "MSISDN", "MBDN", "HPPLMN", "LOCI", "PSLOCI", "ACC", "AD", "FPLMN", "AHPLMN",
                             "RATMODE", "PNN", "OPL", "OPLMNAcT"}) {
        files->set("kSimFile_" + std::string(file), "content");
    }
    generator.updateState(state, payload(0xff0000, files).bytes());
    EXPECT_EQ(section("SIM Info").dictionary()->size(), 14U);  // every label has its place in the template
    for (const auto& [label, value] : *section("SIM Info").dictionary()) EXPECT_EQ(value, Value("content")) << label;
}

TEST_F(LTESharedSections, ShowDataContextsOnTheLteScreens) {
    generator.getDisplayFromState(state);
    EXPECT_EQ(section("PDP Context Info"), Value(Array::make()));
    generator.updateState(state, payload(0xff0002, Array::make({"context"})).bytes());
    EXPECT_EQ(section("PDP Context Info"), Value(Array::make({"context"})));
}

TEST_F(LTESharedSections, AskForTheirRecords) {
    const Value extra = (*generator.getStartCommand())["SetPlExtraCodes"];
    for (int code : {0, 2}) {
        EXPECT_EQ(std::count(extra.array()->begin(), extra.array()->end(), Value(code)), 1) << code;
    }
}

}  // namespace
}  // namespace kelvo
