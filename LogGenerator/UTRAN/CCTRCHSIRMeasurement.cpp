#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"

#include "platform/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kChannel = entry(8, {
    { 0, u8, "CCTRCH ID", decimal },
    { 1, u8, "TSNUM",     decimal },
});
// clang-format on

/// The values of the six timeslots behind a channel's two bytes.
ArrayRef timeslots(RecordView record, std::size_t channel) {
    const ArrayRef values = Array::make();
    for (std::size_t i = 0; i < 6; ++i) {
        std::string text;
        print(text, record.read(channel + 2 + i, u8), decimal);
        values->append(std::move(text));
    }
    return values;
}

}  // namespace

void CCTRCHSIRMeasurement::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "CCTRCH SIR Measurement");
    if (logCode != 0xD00C || data.size() < 17) return;
    clearElementsInArray(list());
    const RecordView record(data);
    const auto transportChannels = static_cast<std::size_t>(record.read(14, u16.bits(6, 11)));
    const auto count = static_cast<std::size_t>(record.read(14, u16.bits(12, 15)));
    const RecordEntries channels(289 + 34 * transportChannels, kChannel.size, count);
    std::vector<Value> shown = rowsOf(data, channels, kChannel.fields);
    for (std::size_t i = 0; i < shown.size(); ++i) {
        shown[i].dictionary()->set("SIR", timeslots(record, channels.offsetOf(i)));
    }
    replaceArray(list(), std::move(shown));
}

}  // namespace kelvo
