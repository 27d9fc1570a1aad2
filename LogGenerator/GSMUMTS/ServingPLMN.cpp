#include "LogGenerator/GSMUMTS/ServingPLMN.h"

#include <algorithm>
#include <array>

#include "LogGenerator/GSMUMTS/RegistrationRecord.h"
#include "LogGenerator/GSMUMTS/ServingPLMNRecord.h"
#include "LogGenerator/PhoneServices/CellInfo.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
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
        case code::kServingPLMN: showServing(data); break;
        case code::kRegistration: show(data, RegistrationRecord::kSelection); break;
        case code::kCellArray: showCellArray(data); break;
        default: reportUnknown(logCode);
    }
}

void ServingPLMN::showServing(ByteView data) {
    if (data.size() < ServingPLMNRecord::kMinimum || !values()) return;
    const RecordView record(data);
    // Packed BCD, 3GPP TS 24.008: fillers, such as the third digit of a two-digit network code, show as blanks.
    const auto digit = [&](std::size_t at, int lowBit) {
        const auto value = record.read(at, u8.bits(lowBit, lowBit + 3));
        return value < 10 ? static_cast<char>('0' + value) : ' ';
    };
    const auto showDigits = [&](Key key, std::array<char, 3> digits) {
        showText(values()->slot(key), {digits.data(), digits.size()});
    };
    showDigits("Mobile Country Code", {digit(15, 0), digit(15, 4), digit(16, 0)});
    showDigits("Mobile Network Code", {digit(17, 0), digit(17, 4), digit(16, 4)});
    showFields(*values(), record, 0, ServingPLMNRecord::kAreas.fields);
}

void ServingPLMN::showCellArray(ByteView data) {
    const ArrayRef cells = cellInfoArray(data);
    if (!cells) return;
    const auto serving = std::find_if(cells->begin(), cells->end(), isServing);
    if (serving != cells->end()) showCell(values(), *serving->dictionary(), kCell);
}

}  // namespace kelvo
