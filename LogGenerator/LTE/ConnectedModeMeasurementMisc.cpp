#include "LogGenerator/LTE/ConnectedModeMeasurementMisc.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kMeasurement = record(29, {
    { 17, u16, "E-ARFCN",                  decimal                             },
    { 19, u16, "Serving Physical Cell ID", decimal                             },
    { 21, u16, "Subframe Number",          decimal                             },
    { 23, u16, "Serving Filtered RSRP",    linear(0.25,  -140.0, "%4.2f", dBm) },
    { 25, u16, "Serving Filtered RSRQ",    linear(0.125,  -20.0, "%4.2f", dB)  },
});
// clang-format on

}  // namespace

void ConnectedModeMeasurementMisc::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Connected mode LTE Intra-frequency Measurement");
    if (logCode != 0xB179) return reportUnknown(logCode);
    show(data, kMeasurement);
}

}  // namespace kelvo
