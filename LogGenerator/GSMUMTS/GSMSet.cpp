#include "LogGenerator/GSMUMTS/GSMSet.h"

#include "LogGenerator/GSMUMTS/NeighborRankingRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

void GSMSet::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "GSMSet");
    using Layout = NeighborRankingRecord;
    if (logCode != code::kNeighborRanking) return reportUnknown(logCode);
    if (data.size() < Layout::kMinimum) return;
    showRows(list(), data, Layout::gsmCells(RecordView(data)), Layout::kGSMCell.fields);
}

}  // namespace kelvo
