#include "LogGenerator/GSMUMTS/BLER.h"

#include "LogGenerator/RowWriter.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kWindow = record(code::kUMTSTransportErrors, 16, {
    { 14, u16, "Window Size",           decimal  },
});

constexpr auto kChannel = entry(9, {
    { 0,  u8,  "Transport Channel ID",  decimal  },
    { 1,  u32, "CRC Received",          asSigned },
    { 5,  u32, "CRC Received in Error", asSigned },
});
// clang-format on

}  // namespace

void BLER::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "BLER");
    if (logCode != code::kUMTSTransportErrors) return reportUnknown(logCode);
    if (!show(data, kWindow) || !values()) return;
    const auto count = RecordView(data).count(13, u8);
    showRows(ownArray(values()->slot("Transport Channels")), data, 16, count, kChannel);
}

}  // namespace kelvo
