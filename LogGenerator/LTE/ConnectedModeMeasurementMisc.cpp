#include "LogGenerator/LTE/ConnectedModeMeasurementMisc.h"

#include "LogGenerator/LTE/IntraFrequencyRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

void ConnectedModeMeasurementMisc::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Connected mode LTE Intra-frequency Measurement");
    showOneOf(data, logCode, IntraFrequencyRecord::kServingCell);
}

}  // namespace kelvo
