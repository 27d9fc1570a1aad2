#include "LogGenerator/LTE/MeasuredNeighborCells.h"

#include "LogGenerator/LTE/IntraFrequencyRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

void MeasuredNeighborCells::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Measured Neighbor Cells");
    using Layout = IntraFrequencyRecord;
    if (logCode != code::kLTEIntraFrequency) return reportUnknown(logCode);
    if (data.size() < Layout::kServingCell.size) return;
    showRows(list(), data, Layout::measuredCells(RecordView(data)), Layout::kMeasuredCell.fields);
}

}  // namespace kelvo
