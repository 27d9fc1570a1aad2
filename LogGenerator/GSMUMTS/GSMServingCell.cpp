#include "LogGenerator/GSMUMTS/GSMServingCell.h"

#include "LogGenerator/PhoneServices/CellInfo.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kIdentity = record(26, {  // 0x5134
    { 17, u16,             "Cell ID",            decimal },
    { 13, u16,             "ARFCN",              decimal },
    { 15, u16,             "BSIC",               decimal },
});

constexpr auto kMeasurement = record(29, {  // 0x5137; GSM RR Info shows the same bytes whole
    { 15, u8,              "RSSI",               whole(1, 0, dBm) },
    { 16, u32.bits(0, 15), "C1 Value",           decimal          },
    { 20, u32.bits(0, 15), "C2 Value",           decimal          },
});

constexpr auto kDedicated = record(17, {  // 0x5076
    { 13, u16.bits(0, 7),  "MA Dedicated ARFCN", decimal },  // the low byte alone, as intended
});

constexpr CellField kCell[] = {
    { kPLCellMonitorCellId, "Cell ID", "GSMServingCell: Failed to retrieve Cell ID\n" },
    { kPLCellMonitorARFCN,  "ARFCN",   "GSMServingCell: Failed to retrieve ARFCN\n"   },
};
// clang-format on

}  // namespace

void GSMServingCell::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "GSMServingCell");
    switch (logCode) {
        case 0x5134: show(data, kIdentity); break;
        case 0x5137: show(data, kMeasurement); break;
        case 0x5076: show(data, kDedicated); break;
        case 0xff0001: showServingCell(values(), data, kPLCellMonitorRadioAccessTechnologyGSM, kCell); break;
        default: reportUnknown(logCode);
    }
}

}  // namespace kelvo
