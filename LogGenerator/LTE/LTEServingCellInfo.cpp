#include "LogGenerator/LTE/LTEServingCellInfo.h"

#include "LogGenerator/PhoneServices/CellInfo.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
constexpr ValueTable kBandwidth({  // resource blocks, 3GPP TS 36.101 table 5.6-1
    {   6, "1.4 MHz" },
    {  15, "3 MHz"   },
    {  25, "5 MHz"   },
    {  50, "10 MHz"  },
    {  75, "15 MHz"  },
    { 100, "20 MHz"  },
}, "Unknown");

constexpr auto kServingCell = record(code::kLTEServingCell, 38, {
    // at  raw  key                    shown as
    {  14, u16, "Physical Cell ID",    decimal           },
    {  16, u16, "Download Frequency",  decimal           },
    {  18, u16, "Upload Frequency",    decimal           },
    {  20, u8,  "Download Bandwidth",  label(kBandwidth) },
    {  21, u8,  "Upload Bandwidth",    label(kBandwidth) },
    {  22, u32, "Cell Identity",       asSigned          },
    {  26, u16, "Tracking Area Code",  decimal           },
    {  28, u32, "Freq Band Indicator", asSigned          },
});

constexpr auto kAntennas = record(code::kLTEMasterInformationBlock, 22, {
    {  20, u8,  "Num Tx Antennas",     decimal           },
});

constexpr CellField kCell[] = {
    { kPLCellMonitorTAC,      "Tracking Area Code",  "Serving Cell Info: Failed to retrieve TAC\n"                 },
    { kPLCellMonitorCellId,   "Cell Identity",       "Serving Cell Info: Failed to retrieve Cell ID\n"             },
    { kPLCellMonitorPID,      "Physical Cell ID",    "Serving Cell Info: Failed to retrieve Physical Cell ID\n"    },
    { kPLCellMonitorBandInfo, "Freq Band Indicator", "Serving Cell Info: Failed to retrieve Freq Band Indicator\n" },
    { kPLCellMonitorUARFCN,   "UARFCN",              "Serving Cell Info: Failed to retrieve UARFCN\n"              },
};
// clang-format on

}  // namespace

void LTEServingCellInfo::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "LTE Serving Cell Info");
    switch (logCode) {
        case code::kLTEServingCell:
            if (show(data, kServingCell)) hide("UARFCN");  // the cell array's key: these frequencies replace it
            break;
        case code::kLTEMasterInformationBlock:
            if (show(data, kAntennas)) reportUnknown(logCode);  // intended: shown and still reported
            break;
        case code::kCellArray: showServingCell(values(), data, kPLCellMonitorRadioAccessTechnologyLTE, kCell); break;
        default: reportUnknown(logCode);
    }
}

}  // namespace kelvo
