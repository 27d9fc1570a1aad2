#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// "kelvoctl watch": the live screens in the terminal.
void addWatchCommand(CLI::App& app);

}  // namespace kelvo
