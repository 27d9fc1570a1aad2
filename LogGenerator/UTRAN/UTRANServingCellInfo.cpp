#include "LogGenerator/UTRAN/UTRANServingCellInfo.h"

#include "LogGenerator/PhoneServices/CellInfo.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kServingCell = record(code::kUTRANServingCell, 26, {
    { 14, u8,        "Cell Access Restrictions", decimal                                    },
    { 21, u32,       "Cell ID",                  asSigned                                   },
    { 19, u16,       "Downlink UARFCN",          decimal                                    },
    { 17, u16,       "Uplink UARFCN",            decimal                                    },
    { 15, u8,        "URA ID",                   decimal                                    },
    { 25, u8.bit(0), "Allowed Access",           flag("Emergency Calls Only", "All Calls")  },
});

constexpr CellField kCell[] = {
    { kPLCellMonitorLAC,      "Local Area Code",      "Serving Cell Info: Failed to retrieve LAC\n"                  },
    { kPLCellMonitorCellId,   "Cell ID",              "Serving Cell Info: Failed to retrieve Cell ID\n"              },
    { kPLCellMonitorBandInfo, "Freq Band Indicator",  "Serving Cell Info: Failed to retrieve Freq Band Indicator\n"  },
    { kPLCellMonitorSCN,      "Cell Scrambling Code", "Serving Cell Info: Failed to retrieve Cell Scrambling Code\n" },
    { kPLCellMonitorUARFCN,   "Uplink UARFCN",        "Serving Cell Info: Failed to retrieve UARFCN\n"               },
    { kPLCellMonitorUARFCN,   "Downlink UARFCN",      nullptr                                                        },
};
// clang-format on

}  // namespace

void UTRANServingCellInfo::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Serving Cell Info");
    if (logCode == code::kUTRANServingCell) show(data, kServingCell);
    if (logCode == code::kCellArray) showCellArray(data);
}

void UTRANServingCellInfo::showCellArray(ByteView data) {
    const Value payload = cellInfo(data);
    if (!payload.array()) return;
    for (const Value& cell : *payload.array()) {  // every serving cell; the last one shows
        if (isCell(cell, kPLCellMonitorRadioAccessTechnologyUTRAN2, kPLCellMonitorCellTypeServing)) {
            showCell(values(), *cell.dictionary(), kCell);
        }
    }
}

}  // namespace kelvo
