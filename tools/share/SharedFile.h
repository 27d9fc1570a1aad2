#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "platform/host/Capture.h"
#include "platform/system/OutputFile.h"
#include "platform/telephony/Technology.h"
#include "telephony/recordings/RecordingKind.h"
#include "tools/share/RecordSharer.h"

namespace kelvo {

/// What became of a file.
struct SharedFile {
    RecordingKind kind{};
    std::uint64_t records = 0;          ///< that were written
    std::uint64_t read = 0;             ///< that there were
    std::optional<std::string> ends{};  ///< where and why it can be read no further
};

/// Copies the file `in`, or the capture on standard input when it is "-", to `out` as what it is: a capture, a
/// snapshot, a stream of frames or a DLF file, unpacked. A capture that does not tell its technology is taken for
/// `technology`. What can be read is copied, even when the file breaks off.
/// Throws CommandFailure when nothing can be read or written.
SharedFile shareFile(const std::string& in, const std::string& out, const OutputTerms& terms,
                     std::optional<Technology> technology, RecordSharer& sharer);

}  // namespace kelvo
