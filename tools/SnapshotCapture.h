#pragma once

#include <cstddef>
#include <string>
#include <vector>

#include "platform/system/OutputFile.h"
#include "platform/telephony/Technology.h"
#include "tools/SnapshotFile.h"

namespace kelvo {

/// Writes the raw records of a snapshot's history, oldest first, as a capture that plays them again, and says how many
/// messages it holds. The snapshot keeps no times of its messages: those of one entry are spread evenly over the two
/// seconds, one refresh, before the entry's date. Records that cannot be told apart are told in `odd`.
/// Throws CommandFailure when there is no message at all or the file cannot be written.
std::size_t writeSnapshotCapture(const SnapshotFile& snapshot, Technology technology, OutputFile file,
                                 std::vector<std::string>& odd);

}  // namespace kelvo
