#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "LogGenerator/LogCode.h"
#include "platform/host/Capture.h"
#include "platform/telephony/Technology.h"

namespace kelvo {

/// The record behind readings.
struct Moment {
    CaptureTime time{};
    Technology technology{};
    std::optional<LogCode> code{};  ///< none for a cell monitor's tree
    std::uint64_t record = 0;       ///< its number in its input, from 1
    std::size_t input = 0;          ///< which of the inputs, from 0
};

/// "2014-08-29T20:51:07.123456Z": UTC, to the microsecond, in 27 letters for the years 0 to 9999.
class MomentText {
public:
    /// Holds until the next call.
    std::string_view of(CaptureTime time);

private:
    std::chrono::sys_seconds _second = std::chrono::sys_seconds::min();
    std::string _text;
};

}  // namespace kelvo
