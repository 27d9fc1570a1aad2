#include "LogGenerator/GSMUMTS/ServingPLMN.h"

#include <algorithm>

#include "LogGenerator/PhoneServices/CellInfo.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
constexpr ValueTable kSelectionModes({
    { 0, "Automatic"           },
    { 1, "Manual"              },
    { 2, "Limited"             },
    { 3, "LIMITED_ROUTINE_ACQ" },
    { 4, "LIMITED_MANUAL_ACQ"  },
}, "Unknown");

constexpr ValueTable kServiceTypes({
    { 0, "NO_SERVICE"      },
    { 1, "CS_ONLY"         },
    { 2, "PS_ONLY"         },
    { 3, "CS_PS_SERVICE"   },
    { 4, "LIMITED_SERVICE" },
}, "Unknown");

constexpr auto kSelection = record(16, {  // 0x7132
    { 14, u8,              "PLMN Sel Mod",       label(kSelectionModes) },
});

constexpr auto kServing = record(32, {  // 0x7135, behind the network's digits at 15 to 17
    { 18, u16.bigEndian(), "Location Area Code", decimal                },
    { 20, u8,              "Routing Area Code",  decimal                },
    { 14, u8,              "Service Type",       label(kServiceTypes)   },
});

constexpr CellField kCell[] = {
    { kPLCellMonitorMCC, "Mobile Country Code", "ServingPLMN: Failed to retrieve MCC\n" },
    { kPLCellMonitorMNC, "Mobile Network Code", "ServingPLMN: Failed to retrieve MNC\n" },
    { kPLCellMonitorLAC, "Location Area Code",  "ServingPLMN: Failed to retrieve LAC\n" },
};
// clang-format on

bool isServing(const Value& cell) {
    return isCell(cell, kPLCellMonitorRadioAccessTechnologyGSM, kPLCellMonitorCellTypeServing) ||
           isCell(cell, kPLCellMonitorRadioAccessTechnologyUMTS, kPLCellMonitorCellTypeServing);
}

}  // namespace

void ServingPLMN::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Serving PLMN");
    switch (logCode) {
        case 0x7135: showServing(data); break;
        case 0x7132: show(data, kSelection); break;
        case 0xff0001: showCellArray(data); break;
        default: reportUnknown(logCode);
    }
}

void ServingPLMN::showServing(ByteView data) {
    if (data.size() < kServing.size || !values()) return;
    const RecordView record(data);
    // Packed BCD, 3GPP TS 24.008: fillers, such as the third digit of a two-digit network code, show as blanks.
    const auto digit = [&](std::size_t at, int lowBit) {
        const auto value = record.read(at, u8.bits(lowBit, lowBit + 3));
        return value < 10 ? static_cast<char>('0' + value) : ' ';
    };
    values()->slot("Mobile Country Code").text() = {digit(15, 0), digit(15, 4), digit(16, 0)};
    values()->slot("Mobile Network Code").text() = {digit(17, 0), digit(17, 4), digit(16, 4)};
    showFields(*values(), record, 0, kServing.fields);
}

void ServingPLMN::showCellArray(ByteView data) {
    const ArrayRef cells = cellInfoArray(data);
    if (!cells) return;
    const auto serving = std::find_if(cells->begin(), cells->end(), isServing);
    if (serving != cells->end()) showCell(values(), *serving->dictionary(), kCell);
}

}  // namespace kelvo
