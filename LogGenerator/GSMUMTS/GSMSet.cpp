#include "LogGenerator/GSMUMTS/GSMSet.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kCell = entry(7, {
    { 0, u16, "ARFCN",         decimal          },
    { 2, u16, "BSIC",          decimal          },
    { 4, i8,  "RSSI",          whole(1, 0, dBm) },
    { 5, i16, "Ranking Value", decimal          },
});
// clang-format on

}  // namespace

void GSMSet::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "GSMSet");
    if (logCode != 0x4005) return reportUnknown(logCode);
    if (data.size() < 15) return;
    const auto count = static_cast<std::size_t>(RecordView(data).read(14, u8));
    showRows(list(), data, 15, count, kCell);  // intended: at 15 as the UMTS entries are
}

}  // namespace kelvo
