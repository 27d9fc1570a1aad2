#pragma once

#include <CLI/App.hpp>
#include <optional>
#include <string>

#include "platform/host/Capture.h"

namespace kelvo {

/// Gives `command` the option "NAME T", a time in ISO 8601, UTC: "2014-08-29T20:51:07Z", "2014-08-29T20:51:07.250Z" or
/// a date alone. Anything else ends the command. `time` outlives the parsing.
CLI::Option* addTimeOption(CLI::App& command, const std::string& name, std::optional<CaptureTime>& time,
                           const std::string& help);

}  // namespace kelvo
