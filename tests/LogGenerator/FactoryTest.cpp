#include <gtest/gtest.h>

#include "LogGenerator/LTE/LTELogGenerator.h"
#include "LogGenerator/UTRAN/UTRANLogGenerator.h"

namespace kelvo {
namespace {

template <class Generator>
bool makes(std::string_view technology) {
    const auto generator = LogGenerator::generatorFromTechnology(technology);
    return dynamic_cast<Generator*>(generator.get()) != nullptr;
}

TEST(Factory, MakesTheGeneratorOfATechnology) {
    EXPECT_TRUE(makes<LTELogGenerator>("kPLLogChannelTechnology_Oskra_LTE"));
    EXPECT_TRUE(makes<UTRANLogGenerator>("kPLLogChannelTechnology_Oskra_UTRAN2"));
}

TEST(Factory, MakesNoneForAnythingElse) {
    for (const char* technology : {"", "LTE", "kPLLogChannelTechnology_Oskra_LTE ", "kPLLogChannelTechnology_ifx"}) {
        EXPECT_EQ(LogGenerator::generatorFromTechnology(technology), nullptr) << technology;
    }
}

}  // namespace
}  // namespace kelvo
