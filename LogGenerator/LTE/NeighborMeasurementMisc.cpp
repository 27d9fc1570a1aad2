#include "LogGenerator/LTE/NeighborMeasurementMisc.h"

#include "LogGenerator/LTE/IdleNeighborsRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

void NeighborMeasurementMisc::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Neighbor Measurements");
    showOneOf(data, logCode, IdleNeighborsRecord::kFrequency);
}

}  // namespace kelvo
