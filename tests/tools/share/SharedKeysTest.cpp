#include "tools/share/SharedKeys.h"

#include <gtest/gtest.h>

#include "LogGenerator/Factory.h"
#include "glossary/Glossary.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"
#include "platform/values/Value.h"
#include "tools/share/SharedRecords.h"

namespace kelvo {
namespace {

TEST(SharedKeys, ClassEveryKeyOfEveryScreen) {
    std::size_t keys = 0;
    for (const TechnologyNames& names : kTechnologies) {
        for (const Meaning& meaning : meaningsOf(names.technology)) {
            EXPECT_TRUE(identityOf(meaning.section, meaning.key))
                << names.name << ": \"" << meaning.section << "\" / \"" << meaning.key << "\"";
            ++keys;
        }
    }
    EXPECT_GT(keys, 200U);
}

/// The names of everything in a template that is no value.
void expectScreens(const Value& part, const std::string& name, std::size_t& screens) {
    if (part.array()) {
        EXPECT_TRUE(isScreen(name)) << name;
        ++screens;
    }
    if (!part.dictionary()) return;
    EXPECT_TRUE(name.empty() || isScreen(name)) << name;
    ++screens;
    for (const auto& [key, value] : *part.dictionary()) {
        EXPECT_TRUE(value.string() == nullptr || key == "_sorted" || identityOf(name, key)) << name << "/" << key;
        expectScreens(value, key, screens);
    }
}

TEST(SharedKeys, KnowEveryScreenAndKeyOfTheTemplates) {
    const DirectoryResources resources(KELVO_RESOURCE_DIR);
    std::size_t screens = 0;
    for (const char* name : {"LTE", "OSK_GSM", "UTRAN", "C2KTemplate"}) {
        const auto read = resources.dictionary(name);
        ASSERT_TRUE(read) << name;
        expectScreens(*read, {}, screens);
    }
    EXPECT_GT(screens, 50U);
}

TEST(SharedKeys, TellWhoseNumberACellIdIsByItsScreen) {
    EXPECT_EQ(identityOf("GSM Serving Cell", "Cell ID"), Identity::Cell);
    EXPECT_EQ(identityOf("UMTS RR Info", "Cell ID"), Identity::UtranCell);
    EXPECT_EQ(identityOf("Serving Cell Info", "Cell ID"), Identity::UtranCell);
    EXPECT_EQ(identityOf("Serving Cell Info", "Cell Identity"), Identity::EutranCell);
    EXPECT_EQ(identityOf("Reselection Candidates List", "Cell ID"), Identity::PhysicalCell);
    EXPECT_EQ(identityOf("Neighbor Cell List", "Cell ID"), Identity::CellParameter);
    EXPECT_EQ(identityOf("", "Cell ID"), std::nullopt);
}

TEST(SharedKeys, PassBySortingNumbers) {
    EXPECT_EQ(identityOf("4;System", "2;System ID"), Identity::System);
    EXPECT_TRUE(isScreen("06;SIM and Data Contexts"));
    EXPECT_FALSE(isScreen("310410123456789"));
    EXPECT_EQ(withoutOrder("310;System"), "310;System");
}

TEST(SharedKeys, KnowNoOthers) {
    EXPECT_EQ(identityOf("", "Subscriber"), std::nullopt);
    EXPECT_FALSE(isScreen(""));
}

TEST(SharedRecords, HaveATableForEveryCodeThatIsDecoded) {
    const DirectoryResources resources(KELVO_RESOURCE_DIR);
    const Environment::Scope environment({.resources = &resources});
    std::size_t codes = 0;
    for (const TechnologyNames& names : kTechnologies) {
        const DictionaryRef command = generatorFromTechnology(names.identifier)->getStartCommand();
        const ArrayRef list = (*command)["SetOskraLogCodes"].array();
        if (!list) continue;
        for (const Value& code : *list) {
            EXPECT_NE(sharedRecord(static_cast<LogCode>(code.number()->integer())), nullptr)
                << std::hex << code.number()->integer();
            ++codes;
        }
    }
    EXPECT_EQ(codes, 44U);  // 8 of CDMA, 25 of GSM and UMTS, 6 of LTE, 5 of UTRAN
}

TEST(Identity, HiddenIsWhatTheUserWantsAndWhatAlwaysIs) {
    const ShareChoices cellsKept{.hideCells = false, .hideApns = true};
    EXPECT_TRUE(isHidden(Identity::SimNumber, cellsKept));
    EXPECT_TRUE(isHidden(Identity::Temporary, cellsKept));
    EXPECT_TRUE(isHidden(Identity::Location, cellsKept));
    EXPECT_TRUE(isHidden(Identity::Apn, cellsKept));
    EXPECT_FALSE(isHidden(Identity::Cell, cellsKept));
    EXPECT_FALSE(isHidden(Identity::Plmn, cellsKept));
    EXPECT_FALSE(isHidden(Identity::None, {}));
    EXPECT_FALSE(isHidden(Identity::Apn, {}));
    EXPECT_TRUE(isHidden(Identity::Country, {}));
}

}  // namespace
}  // namespace kelvo
