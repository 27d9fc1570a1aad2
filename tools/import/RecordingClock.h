#pragma once

#include <optional>

#include "platform/host/Capture.h"
#include "telephony/recordings/RecordingReader.h"

namespace kelvo {

/// Gives every record of a recording a time. A clock that was not set counts from 1980 on: then a record's time is that
/// of the record before it, and where there is none the first that any record tells.
class RecordingClock {
public:
    /// `first`: the earliest time that a record tells; none when none does.
    explicit RecordingClock(std::optional<CaptureTime> first) : _last(first) {}

    CaptureTime timeOf(const RecordedMessage& message) {
        if (message.time) _last = message.time;
        return _last.value_or(CaptureTime(std::chrono::sys_days(std::chrono::year(1980) / 1 / 6)));
    }

private:
    std::optional<CaptureTime> _last;
};

}  // namespace kelvo
