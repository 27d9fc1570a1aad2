#include "LogGenerator/GSMUMTS/UMTSSet.h"

#include "LogGenerator/PhoneServices/CellInfo.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kCell = entry(10, {  // 0x4005
    { 2, u16, "Scrambling Code",    decimal                    },
    { 4, i8,  "RSCP",               whole(1, -21, dB)          },
    { 7, i8,  "Energy Per Chip",    linear(0.5, 0.0, "%f", dB) },
    { 0, i16, "Downlink Frequency", decimal                    },
    { 8, i16, "Ranking Value",      decimal                    },
    { 5, i16, "Rank Cell RSCP",     whole(1, 0, dB)            },
});

constexpr CellField kNeighbor[] = {  // RSCP in dBm, unlike 0x4005; 32767 is no value
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
        case 0x4005: showRanking(data); break;
        case 0xff0001: showCellArray(data); break;
        default: reportUnknown(logCode);
    }
}

void UMTSSet::showRanking(ByteView data) {
    if (data.size() < 15) return;
    const auto count = static_cast<std::size_t>(RecordView(data).read(13, u8));
    showRows(list(), data, 15, count, kCell);
}

void UMTSSet::showCellArray(ByteView data) {
    showNeighbors(list(), data, kPLCellMonitorRadioAccessTechnologyUMTS, kNeighbor);
}

}  // namespace kelvo
