#pragma once

#include <optional>
#include <utility>

#include "platform/host/Capture.h"

namespace kelvo {

/// Writes records to a capture, which appears with the first of them. A failure (a full disk, a name that was taken
/// meanwhile) is told in one line on the log, ends the recording and leaves the streaming alone.
class Recording {
public:
    explicit Recording(OutputFile file) : _file(std::move(file)) {}

    /// `technology` names the capture's; it stays the same from the first record on.
    void append(Technology technology, const CapturePacket& packet);

private:
    Result<void> write(Technology technology, const CapturePacket& packet);

    std::optional<OutputFile> _file;        // until the first record
    std::optional<CaptureWriter> _capture;  // from then on; none once the recording has ended
};

}  // namespace kelvo
