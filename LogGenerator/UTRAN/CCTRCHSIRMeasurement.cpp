#include "LogGenerator/UTRAN/CCTRCHSIRMeasurement.h"

#include "LogGenerator/RowWriter.h"
#include "LogGenerator/UTRAN/TransportChannelsRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

void CCTRCHSIRMeasurement::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "CCTRCH SIR Measurement");
    using Layout = TransportChannelsRecord;
    if (logCode != code::kUTRANTransportChannels || data.size() < Layout::kMinimum) return;
    const RecordView record(data);
    const RecordEntries channels = Layout::codedChannels(record).within(data.size());
    RowWriter rows(list());
    for (std::size_t i = 0; i < channels.count(); ++i) {
        const std::size_t at = channels.offsetOf(i);
        Dictionary::Rewrite row = rows.next();
        showFields(row, record, at, Layout::kCodedChannel.fields);
        showValues(ownArray(row.next("SIR")), record, Layout::timeslots(at), u8, decimal);
    }
}

}  // namespace kelvo
