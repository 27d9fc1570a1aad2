#include "LogGenerator/LTE/DetectedCells.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kCell = entry(2, {
    { 0, u16, "Physical Cell ID", decimal },
});
// clang-format on

}  // namespace

void DetectedCells::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Detected Cells");
    if (logCode != 0xB179) return reportUnknown(logCode);
    if (data.size() < 29) return;
    const RecordView record(data);
    const auto measured = static_cast<std::size_t>(record.read(27, u8));
    const auto detected = static_cast<std::size_t>(record.read(28, u8));
    showRows(list(), data, 29 + 6 * measured, detected, kCell);  // they follow the measured cells
}

}  // namespace kelvo
