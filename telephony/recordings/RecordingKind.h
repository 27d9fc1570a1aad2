#pragma once

#include <string>
#include <string_view>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"

namespace kelvo {

/// What a file is, told by its content.
enum class RecordingKind {
    Capture,   ///< a classic pcap file
    Snapshot,  ///< a property list
    Frames,    ///< a stream of diagnostic frames
    Dlf,       ///< records back to back
    Unknown,
};

/// "a stream of diagnostic frames".
std::string_view nameOf(RecordingKind kind);

/// By the beginning of a file, unpacked: up to a megabyte of it, in which a sound frame or record must stand.
RecordingKind recognizeRecording(ByteView beginning);

/// The same for a file; a file that cannot be read is a failure.
Result<RecordingKind> recognizeRecording(const std::string& path);

/// What to say of a file that was taken for a capture and is none: `reason`, or what it is instead and which command
/// makes a capture of it.
std::string whyNoCapture(const std::string& path, const std::string& reason);

}  // namespace kelvo
