#pragma once

#include <CLI/App.hpp>
#include <string>

namespace kelvo {

/// Gives the program the command `name`. Whatever describes a command includes <CLI/App.hpp> alone: what makes and runs
/// the parser takes three times as long to compile, and is in this function and in main.
CLI::App& addCommand(CLI::App& app, const std::string& name, const std::string& description);

}  // namespace kelvo
