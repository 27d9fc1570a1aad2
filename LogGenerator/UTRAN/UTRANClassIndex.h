#pragma once

#include "LogGenerator/ClassIndex.h"
#include "LogGenerator/PhoneServices/PDPContextList.h"
#include "LogGenerator/PhoneServices/SimInfo.h"
#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"
#include "LogGenerator/UTRAN/GSMNeighbhorMeasurements.h"
#include "LogGenerator/UTRAN/RRC_State.h"
#include "LogGenerator/UTRAN/TRCHBLERMeasurement.h"
#include "LogGenerator/UTRAN/UTRANNeighbhorMeasurements.h"
#include "LogGenerator/UTRAN/UTRANServingCellInfo.h"
#include "platform/system/Environment.h"

namespace kelvo {

/// The UTRAN sections. Those that share a log code see a record in the order of the members.
class UTRANClassIndex final : public ClassIndex {
public:
    ~UTRANClassIndex() override { printLine("Deallocing UTRANClassIndex"); }

private:
    RRC_State rrc_state{classDict, codeDictionary};
    UTRANServingCellInfo servingCellInfo{classDict, codeDictionary};
    UTRANNeighbhorMeasurements tdMeasurements{classDict, codeDictionary};
    GSMNeighbhorMeasurements gsmMeasurements{classDict, codeDictionary};
    TRCHBLERMeasurement trchMeasurements{classDict, codeDictionary};
    CCTRCHSIRMeasurement cctrchMeasurements{classDict, codeDictionary};
    PDPContextList pdpList{classDict, codeDictionary};
    SimInfo simInfo{classDict, codeDictionary};
};

}  // namespace kelvo
