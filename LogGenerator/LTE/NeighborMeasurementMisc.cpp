#include "LogGenerator/LTE/NeighborMeasurementMisc.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kMeasurement = record(21, {
    { 13, u8,            "Version",   decimal             },
    { 17, u16,           "E-ARFCN",   decimal             },
    { 19, u8.bits(0, 5), "Qrxlevmin", whole(2, -140, dBm) },
});
// clang-format on

}  // namespace

void NeighborMeasurementMisc::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Neighbor Measurements");
    if (logCode != 0xB180) return reportUnknown(logCode);
    show(data, kMeasurement);
}

}  // namespace kelvo
