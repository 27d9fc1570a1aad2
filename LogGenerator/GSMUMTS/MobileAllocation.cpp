#include "LogGenerator/GSMUMTS/MobileAllocation.h"

#include "LogGenerator/RowWriter.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kSequence = record(code::kMobileAllocation, 15, {
    { 13, u8, "HSN", decimal },
});
// clang-format on

}  // namespace

void MobileAllocation::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "MobileAllocation");
    if (logCode != code::kMobileAllocation) return reportUnknown(logCode);
    if (!show(data, kSequence) || !values()) return;
    const RecordView record(data);
    const RecordEntries entries(15, 2, record.count(14, u8));
    showValues(ownArray(values()->slot("ARFCNs")), record, entries.within(data.size()), u16, decimal);
}

}  // namespace kelvo
