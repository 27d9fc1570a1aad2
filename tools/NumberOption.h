#pragma once

#include <CLI/App.hpp>
#include <cstdint>
#include <optional>
#include <string>

namespace kelvo {

/// Gives `command` the option "NAME N", a whole number from `least`; anything else ends the command. `number` outlives
/// the parsing.
CLI::Option* addNumberOption(CLI::App& command, const std::string& name, std::optional<std::uint64_t>& number,
                             std::uint64_t least, const std::string& help);

}  // namespace kelvo
