#include "LogGenerator/GSMUMTS/UMTSRRInfo.h"

#include <cmath>

#include "LogGenerator/PhoneServices/CellInfo.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
constexpr ValueTable kRRCStates({
    { 0, "Disconnected" },
    { 1, "Connecting"   },
    { 2, "CELL_FACH"    },
    { 3, "CELL_DCH"     },
    { 4, "CELL_PCH"     },
    { 5, "URA_PCH"      },
}, "Unknown");

constexpr auto kState = record(code::kUMTSRRCState, 14, {
    { 13, u8,  "RRC State",          label(kRRCStates)           },
});

constexpr auto kCell = record(code::kUMTSServingCell, 29, {
    { 21, u32, "Cell ID",            asSigned                    },
    { 17, u32, "Downlink Frequency", asSigned                    },
    { 13, u32, "Uplink Frequency",   asSigned                    },
    { 25, u16, "URA ID",             decimal                     },
});

constexpr auto kCiphering = record(code::kUMTSCiphering, 19, {
    { 13, u8,  "Ciphering",          flag("Enabled", "Disabled") },
});

constexpr CellField kServingCell[] = {
    { kPLCellMonitorCellId, "Cell ID",         "UMTSRRInfo: Failed to retrieve Cell ID\n"         },
    { kPLCellMonitorUARFCN, "UARFCN",          "UMTSRRInfo: Failed to retrieve UARFCN\n"          },
    { kPLCellMonitorSCN,    "Scrambling Code", "UMTSRRInfo: Failed to retrieve Scrambling Code\n" },
};
// clang-format on

constexpr ShownReal kTransmitPower("%4.2f", dBm);

}  // namespace

void UMTSRRInfo::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "UMTSRRInfo");
    switch (logCode) {
        case code::kUMTSRRCState: show(data, kState); break;
        case code::kUMTSTransmitPower: showTransmitPower(data); break;
        case code::kUMTSServingCell:
            if (show(data, kCell)) hide("UARFCN");  // the cell array's key: these frequencies replace it
            break;
        case code::kUMTSCiphering: show(data, kCiphering); break;
        case code::kCellArray:
            showServingCell(values(), data, kPLCellMonitorRadioAccessTechnologyUMTS, kServingCell);
            break;
        default: reportUnknown(logCode);
    }
}

void UMTSRRInfo::showTransmitPower(ByteView data) {
    if (data.size() < 16 || !values()) return;
    const RecordView record(data);
    const RecordEntries entries(16, 14, record.count(14, u8));
    double sum = 0.0;
    int count = 0;
    for (std::size_t i = 0; i < entries.count(); ++i) {
        const std::int64_t raw = record.read(entries.offsetOf(i) + 4, i16);
        if (raw == 0) continue;
        sum += static_cast<double>((raw + 512) / 10 - 70);
        ++count;
    }
    // Intended: without an entry that counts, 0/0 is shown. Its sign is the processor's; every one shows x86's.
    const double power = sum / count;
    showReal(values()->slot("Transmit Power"), std::isnan(power) ? std::copysign(power, -1.0) : power, kTransmitPower);
}

}  // namespace kelvo
