#pragma once

#include "LogGenerator/ClassIndex.h"
#include "LogGenerator/GSMUMTS/PDPContextList.h"
#include "LogGenerator/GSMUMTS/SimInfo.h"
#include "LogGenerator/LTE/ConnectedModeMeasurementMisc.h"
#include "LogGenerator/LTE/LTEServingCellInfo.h"
#include "LogGenerator/LTE/ServingCellMeasurement.h"

namespace kelvo {

/// The LTE sections. Those that share a log code see a record in the order of the members.
class LTEClassIndex final : public ClassIndex {
public:
    ~LTEClassIndex() override;

private:
    LTEServingCellInfo objLTEServingCellInfo{classDict, codeDictionary};
    ConnectedModeMeasurementMisc objConnectedModeMeasurementMisc{classDict, codeDictionary};
    ServingCellMeasurement objServingCellMeasurement{classDict, codeDictionary};
    SimInfo objSimInfo{classDict, codeDictionary};
    PDPContextList objPDPContextList{classDict, codeDictionary};
};

}  // namespace kelvo
