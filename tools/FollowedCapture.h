#pragma once

#include <cstddef>
#include <optional>

#include "overview/Tracker.h"
#include "platform/values/Result.h"
#include "tools/inputs/Input.h"

namespace kelvo {

/// A capture, followed record by record from its beginning to its end.
struct FollowedCapture {
    overview::Tracker tracker;
    overview::Time end{};  ///< of the last record
    std::size_t messages = 0;
    std::optional<Failure> breakOff;  ///< where the capture can be read no further, and why
};

/// Follows what is left of `input`. Throws CommandFailure for a record that ends the program elsewhere, and for an
/// input that breaks off before its first record.
FollowedCapture followCapture(Input& input);

}  // namespace kelvo
