#include "LogGenerator/UTRAN/TRCHBLERMeasurement.h"

#include "LogGenerator/UTRAN/TransportChannelsRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

void TRCHBLERMeasurement::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Notice, "TRCH BLER Measurement");
    using Layout = TransportChannelsRecord;
    if (logCode != code::kUTRANTransportChannels || data.size() < Layout::kMinimum) return;
    showRows(list(), data, Layout::channels(RecordView(data)), Layout::kChannel.fields);
}

}  // namespace kelvo
