#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"

#include "LogGenerator/RowWriter.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kChannel = entry(8, {
    { 0, u8, "CCTRCH ID", decimal },
    { 1, u8, "TSNUM",     decimal },
});
// clang-format on

}  // namespace

void CCTRCHSIRMeasurement::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "CCTRCH SIR Measurement");
    if (logCode != 0xD00C || data.size() < 17) return;
    const RecordView record(data);
    const auto transportChannels = static_cast<std::size_t>(record.read(14, u16.bits(6, 11)));
    const auto count = static_cast<std::size_t>(record.read(14, u16.bits(12, 15)));
    const RecordEntries channels =
        RecordEntries(289 + 34 * transportChannels, kChannel.size, count).within(data.size());
    RowWriter rows(list());
    for (std::size_t i = 0; i < channels.count(); ++i) {
        const std::size_t at = channels.offsetOf(i);
        Dictionary::Rewrite row = rows.next();
        showFields(row, record, at, kChannel.fields);
        const RecordEntries timeslots(at + 2, 1, 6);
        showValues(ownArray(row.next("SIR")), record, timeslots, u8, decimal);
    }
}

}  // namespace kelvo
