#include "LogGenerator/GSMUMTS/UMTSSet.h"

#include "LogGenerator/GSMUMTS/NeighborRankingRecord.h"
#include "LogGenerator/PhoneServices/CellInfo.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
constexpr CellField kNeighbor[] = {  // RSCP in dBm, unlike the ranking; 32767 is no value
    { kPLCellMonitorUARFCN, "UARFCN",          "UMTSSet: Failed to retrieve UARFCN\n"                                              },
    { kPLCellMonitorSCN,    "Scrambling Code", "UMTSSet: Failed to retrieve Scrambling Code\n"                                     },
    { kPLCellMonitorRSCP,   "RSCP",            "UMTSSet: Failed to retrieve RSCP\n",            whole(1, 0, dBm).unless(32767, "") },
    { kPLCellMonitorECN0,   "Energy Per Chip", "UMTSSet: Failed to retrieve Energy Per Chip\n", whole(1, 0, dB).unless(32767, "")  },
};
// clang-format on

}  // namespace

void UMTSSet::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "UMTSSet");
    switch (logCode) {
        case code::kNeighborRanking: showRanking(data); break;
        case code::kCellArray: showNeighbors(list(), data, kPLCellMonitorRadioAccessTechnologyUMTS, kNeighbor); break;
        default: reportUnknown(logCode);
    }
}

void UMTSSet::showRanking(ByteView data) {
    using Layout = NeighborRankingRecord;
    if (data.size() < Layout::kMinimum) return;
    showRows(list(), data, Layout::umtsCells(RecordView(data)), Layout::kUMTSCell.fields);
}

}  // namespace kelvo
