#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "model/SnapshotFile.h"
#include "platform/host/Capture.h"
#include "platform/system/OutputFile.h"
#include "platform/telephony/Technology.h"

namespace kelvo {

/// One message of a snapshot's history.
struct SnapshotMessage {
    CaptureTime time;
    Bytes bytes;
};

/// The messages that led to a snapshot's history, oldest first: raw records, or, `asTrees`, a cell monitor's trees. The
/// snapshot keeps no times of its messages: those of one entry are spread evenly over the two seconds, one refresh,
/// before the entry's date. What cannot be told apart is told in `odd`.
std::vector<SnapshotMessage> messagesOf(const SnapshotFile& snapshot, bool asTrees, std::vector<std::string>& odd);

/// Writes them as a capture that plays them again, and says how many it holds.
/// Throws CommandFailure when there is no message at all or the file cannot be written.
std::size_t writeSnapshotCapture(const SnapshotFile& snapshot, Technology technology, OutputFile file,
                                 std::vector<std::string>& odd);

}  // namespace kelvo
