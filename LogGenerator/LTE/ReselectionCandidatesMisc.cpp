#include "LogGenerator/LTE/ReselectionCandidatesMisc.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kServingCell = record(21, {
    { 13, u8,  "Version",         decimal },
    { 15, u16, "Serving EARFCN",  decimal },
    { 17, u16, "Serving Cell ID", decimal },
});
// clang-format on

}  // namespace

void ReselectionCandidatesMisc::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Reselection Candidates");
    if (logCode != 0xB186) return reportUnknown(logCode);
    show(data, kServingCell);
}

}  // namespace kelvo
