#pragma once

#include "LogGenerator/ClassIndex.h"
#include "LogGenerator/GSMUMTS/ActiveSet.h"
#include "LogGenerator/GSMUMTS/BLER.h"
#include "LogGenerator/GSMUMTS/CellChangeCounters.h"
#include "LogGenerator/GSMUMTS/CodingScheme.h"
#include "LogGenerator/GSMUMTS/DetectedSet.h"
#include "LogGenerator/GSMUMTS/EquivalentPLMNList.h"
#include "LogGenerator/GSMUMTS/GPRSInformation.h"
#include "LogGenerator/GSMUMTS/GSMRRInfo.h"
#include "LogGenerator/GSMUMTS/GSMServingCell.h"
#include "LogGenerator/GSMUMTS/GSMSet.h"
#include "LogGenerator/GSMUMTS/HSDPAInformation.h"
#include "LogGenerator/GSMUMTS/MobileAllocation.h"
#include "LogGenerator/GSMUMTS/MonitoredSet.h"
#include "LogGenerator/GSMUMTS/NeighboringCells.h"
#include "LogGenerator/GSMUMTS/NonRankedGSMSet.h"
#include "LogGenerator/GSMUMTS/NonRankedUMTSSet.h"
#include "LogGenerator/GSMUMTS/ProcessCO.h"
#include "LogGenerator/GSMUMTS/ProcessCS.h"
#include "LogGenerator/GSMUMTS/ProcessPS.h"
#include "LogGenerator/GSMUMTS/ServingPLMN.h"
#include "LogGenerator/GSMUMTS/UMTSRRInfo.h"
#include "LogGenerator/GSMUMTS/UMTSRRMeasurement.h"
#include "LogGenerator/GSMUMTS/UMTSSet.h"
#include "LogGenerator/GSMUMTS/VirtualActiveSet.h"
#include "LogGenerator/PhoneServices/PDPContextList.h"
#include "LogGenerator/PhoneServices/SimInfo.h"
#include "platform/system/Environment.h"

namespace kelvo {

/// The GSM/UMTS sections. Those that share a log code see a record in the order of the members.
class OSK_GSMClassIndex final : public ClassIndex {
public:
    ~OSK_GSMClassIndex() override { printLine("Deallocing OSK_GSMClassIndex"); }

private:
    ActiveSet objActiveSet{classDict, codeDictionary};
    CodingScheme objCodingScheme{classDict, codeDictionary};
    GPRSInformation objGPRSInformation{classDict, codeDictionary};
    GSMServingCell objGSMServingCell{classDict, codeDictionary};
    MobileAllocation objMobileAllocation{classDict, codeDictionary};
    NeighboringCells objNeighboringCells{classDict, codeDictionary};
    PDPContextList objPDPContextList{classDict, codeDictionary};
    ProcessPS objProcessPS{classDict, codeDictionary};
    UMTSRRMeasurement objUMTSRRMeasurement{classDict, codeDictionary};
    CellChangeCounters objCellChangeCounter{classDict, codeDictionary};
    DetectedSet objDetectedSet{classDict, codeDictionary};
    GSMSet objGSMSet{classDict, codeDictionary};
    NonRankedGSMSet objNonRankedGSMSet{classDict, codeDictionary};
    ProcessCO objProcessCO{classDict, codeDictionary};
    ServingPLMN objServingPLMN{classDict, codeDictionary};
    UMTSSet objUMTSSet{classDict, codeDictionary};
    EquivalentPLMNList objEquivalentPLMNList{classDict, codeDictionary};
    GSMRRInfo objGSMRRInfo{classDict, codeDictionary};
    MonitoredSet objMonitoredSet{classDict, codeDictionary};
    NonRankedUMTSSet objNonRankedUMTSSet{classDict, codeDictionary};
    ProcessCS objProcessCS{classDict, codeDictionary};
    UMTSRRInfo objUMTSRRInfo{classDict, codeDictionary};
    BLER objBLER{classDict, codeDictionary};
    VirtualActiveSet objVirtualActiveSet{classDict, codeDictionary};
    SimInfo objSimInfo{classDict, codeDictionary};
    HSDPAInformation objHSDPAInformation{classDict, codeDictionary};
};

}  // namespace kelvo
