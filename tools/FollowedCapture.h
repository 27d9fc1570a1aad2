#pragma once

#include <cstddef>
#include <optional>
#include <string>

#include "overview/Tracker.h"
#include "platform/host/Capture.h"
#include "platform/values/Result.h"

namespace kelvo {

/// A capture, followed record by record from its beginning to its end.
struct FollowedCapture {
    overview::Tracker tracker;
    overview::Time end{};  ///< of the last record
    std::size_t messages = 0;
    std::optional<Failure> breakOff;  ///< where the capture can be read no further, and why
};

/// Follows what is left of `reader`'s capture, `path`. Throws CommandFailure for a record that ends the program
/// elsewhere.
FollowedCapture followCapture(const std::string& path, CaptureReader& reader, Technology technology);

}  // namespace kelvo
