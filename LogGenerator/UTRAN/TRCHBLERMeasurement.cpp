#include "LogGenerator/UTRAN/TRCHBLERMeasurement.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kChannel = entry(2, {
    { 0, u8, "TRCH ID",               decimal },
    { 1, u8, "TRCH BLER Measurement", decimal },
});
// clang-format on

}  // namespace

void TRCHBLERMeasurement::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Notice, "TRCH BLER Measurement");
    if (logCode != 0xD00C || data.size() < 17) return;
    const auto transportChannels = static_cast<std::size_t>(RecordView(data).read(14, u16.bits(6, 11)));
    showRows(list(), data, 17, transportChannels, kChannel);
}

}  // namespace kelvo
