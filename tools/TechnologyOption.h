#pragma once

#include <CLI/App.hpp>
#include <optional>
#include <string>

#include "platform/telephony/Technology.h"

namespace kelvo {

/// Gives `command` the option "--technology ifx|gsm|cdma|lte|utran"; any other word ends the command. `technology`
/// outlives the parsing.
CLI::Option* addTechnologyOption(CLI::App& command, std::optional<Technology>& technology, const std::string& help);

}  // namespace kelvo
