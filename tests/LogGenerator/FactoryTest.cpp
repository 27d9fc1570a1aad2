#include "LogGenerator/Factory.h"

#include <gtest/gtest.h>

#include "LogGenerator/CDMA/C2KLogGenerator.h"
#include "LogGenerator/GSMUMTS/OSK_GSMLogGenerator.h"
#include "LogGenerator/IFX/GSMLogGenerator.h"
#include "LogGenerator/LTE/LTELogGenerator.h"
#include "LogGenerator/UTRAN/UTRANLogGenerator.h"

namespace kelvo {
namespace {

template <class Generator>
bool makes(std::string_view technology) {
    const auto generator = generatorFromTechnology(technology);
    return dynamic_cast<Generator*>(generator.get()) != nullptr;
}

TEST(Factory, MakesTheGeneratorOfATechnology) {
    EXPECT_TRUE(makes<GSMLogGenerator>("kPLLogChannelTechnology_IFX"));
    EXPECT_TRUE(makes<OSK_GSMLogGenerator>("kPLLogChannelTechnology_Oskra_GSM"));
    EXPECT_TRUE(makes<C2KLogGenerator>("kPLLogChannelTechnology_Oskra_CDMA"));
    EXPECT_TRUE(makes<LTELogGenerator>("kPLLogChannelTechnology_Oskra_LTE"));
    EXPECT_TRUE(makes<UTRANLogGenerator>("kPLLogChannelTechnology_Oskra_UTRAN2"));
}

TEST(Factory, MakesNoneForAnythingElse) {
    for (const char* technology : {"", "LTE", "kPLLogChannelTechnology_Oskra_LTE ", "kPLLogChannelTechnology_ifx"}) {
        EXPECT_EQ(generatorFromTechnology(technology), nullptr) << technology;
    }
}

}  // namespace
}  // namespace kelvo
