#include "LogGenerator/LTE/MeasuredNeighborCells.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kCell = entry(6, {
    { 0, u16, "Physical Cell ID", decimal                             },
    { 2, u16, "Filtered RSRP",    linear(0.25,  -140.0, "%4.2f", dBm) },
    { 4, u16, "Filtered RSRQ",    linear(0.125,  -20.0, "%4.2f", dB)  },
});
// clang-format on

}  // namespace

void MeasuredNeighborCells::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Measured Neighbor Cells");
    if (logCode != 0xB179) return reportUnknown(logCode);
    if (data.size() < 29) return;
    const auto measured = static_cast<std::size_t>(RecordView(data).read(27, u8));
    showRows(list(), data, 29, measured, kCell);
}

}  // namespace kelvo
