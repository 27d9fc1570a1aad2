#pragma once

#include "LogGenerator/ClassIndex.h"
#include "LogGenerator/LTE/ConnectedModeMeasurementMisc.h"
#include "LogGenerator/LTE/DetectedCells.h"
#include "LogGenerator/LTE/LTEServingCellInfo.h"
#include "LogGenerator/LTE/MeasuredNeighborCells.h"
#include "LogGenerator/LTE/NeighborCellsList.h"
#include "LogGenerator/LTE/NeighborMeasurementMisc.h"
#include "LogGenerator/LTE/ReselectionCandidatesList.h"
#include "LogGenerator/LTE/ReselectionCandidatesMisc.h"
#include "LogGenerator/LTE/ServingCellMeasurement.h"
#include "LogGenerator/PhoneServices/PDPContextList.h"
#include "LogGenerator/PhoneServices/SimInfo.h"
#include "platform/system/Environment.h"

namespace kelvo {

/// The LTE sections. Those that share a log code see a record in the order of the members.
class LTEClassIndex final : public ClassIndex {
public:
    ~LTEClassIndex() override { printLine("Deallocing LTEClassIndex"); }

private:
    LTEServingCellInfo objLTEServingCellInfo{classDict, codeDictionary};
    ConnectedModeMeasurementMisc objConnectedModeMeasurementMisc{classDict, codeDictionary};
    MeasuredNeighborCells objMeasuredNeighborCells{classDict, codeDictionary};
    DetectedCells objDetectedCells{classDict, codeDictionary};
    ServingCellMeasurement objServingCellMeasurement{classDict, codeDictionary};
    NeighborMeasurementMisc objNeighborMeasurementMisc{classDict, codeDictionary};
    NeighborCellsList objNeighborCellsList{classDict, codeDictionary};
    ReselectionCandidatesMisc objReselectionCandidatesMisc{classDict, codeDictionary};
    ReselectionCandidatesList objReselectionCandidatesList{classDict, codeDictionary};
    SimInfo objSimInfo{classDict, codeDictionary};
    PDPContextList objPDPContextList{classDict, codeDictionary};
};

}  // namespace kelvo
