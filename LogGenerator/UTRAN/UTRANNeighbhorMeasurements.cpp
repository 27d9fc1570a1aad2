#include "LogGenerator/UTRAN/UTRANNeighbhorMeasurements.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr ValueTable kStatus({
    { 0, "ASET" },
    { 1, "MSET" },
    { 2, "DSET" },
}, "");

constexpr auto kNeighbor = entry(16, {
    { 0, u32.bits( 0, 13), "UARFCN",      decimal                        },
    { 0, u32.bits(14, 20), "Cell ID",     decimal                        },
    { 0, u32.bits(21, 28), "Filter RSCP", linear(1.0 / 256, 0.0, "%f")   },  // intended: 0.000000 to 0.996094
    { 0, u32.bits(29, 30), "Status",      label(kStatus).absentAt(3)     },
    { 0, u32.bit(31),      "inJDCS",      flag("TRUE", "FALSE")          },
});
// clang-format on

}  // namespace

void UTRANNeighbhorMeasurements::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "NeighbhorMeasurements List");
    if (logCode != code::kUTRANNeighborCells || data.size() < 21) return;
    const auto count = RecordView(data).count(16, u8.bits(1, 7));
    showRows(list(), data, 168, count, kNeighbor);
}

}  // namespace kelvo
