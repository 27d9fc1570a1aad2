#include "LogGenerator/GSMUMTS/GSMServingCell.h"

#include "LogGenerator/GSMUMTS/GSMReselectionRecord.h"
#include "LogGenerator/PhoneServices/CellInfo.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kIdentity = record(code::kGSMServingCell, 26, {
    { 17, u16,             "Cell ID",            decimal },
    { 13, u16,             "ARFCN",              decimal },
    { 15, u16,             "BSIC",               decimal },
});

constexpr auto kDedicated = record(code::kGSMDedicatedChannel, 17, {
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
    if (logCode == code::kCellArray) {
        return showServingCell(values(), data, kPLCellMonitorRadioAccessTechnologyGSM, kCell);
    }
    showOneOf(data, logCode, kIdentity, GSMReselectionRecord::kServingCell, kDedicated);
}

}  // namespace kelvo
