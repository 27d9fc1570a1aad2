#include "LogGenerator/LTE/DetectedCells.h"

#include "LogGenerator/LTE/IntraFrequencyRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

void DetectedCells::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Detected Cells");
    using Layout = IntraFrequencyRecord;
    if (logCode != code::kLTEIntraFrequency) return reportUnknown(logCode);
    if (data.size() < Layout::kServingCell.size) return;
    showRows(list(), data, Layout::detectedCells(RecordView(data)), Layout::kDetectedCell.fields);
}

}  // namespace kelvo
