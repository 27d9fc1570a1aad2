#include "LogGenerator/Factory.h"

#include "LogGenerator/CDMA/C2KLogGenerator.h"
#include "LogGenerator/GSMUMTS/OSK_GSMLogGenerator.h"
#include "LogGenerator/IFX/GSMLogGenerator.h"
#include "LogGenerator/LTE/LTELogGenerator.h"
#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

std::unique_ptr<LogGenerator> generatorFromTechnology(std::string_view technology) {
    if (technology == kPLLogChannelTechnology_IFX) return GSMLogGenerator::generator();
    if (technology == kPLLogChannelTechnology_Oskra_GSM) return OSK_GSMLogGenerator::generator();
    if (technology == kPLLogChannelTechnology_Oskra_CDMA) return C2KLogGenerator::generator();
    if (technology == kPLLogChannelTechnology_Oskra_LTE) return LTELogGenerator::generator();
    if (technology == kPLLogChannelTechnology_Oskra_UTRAN2) return UTRANLogGenerator::generator();
    return nullptr;
}

}  // namespace kelvo
