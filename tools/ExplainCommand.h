#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// `kelvoctl explain KEY`: what a value on the screens means, and the standard it comes from.
void addExplainCommand(CLI::App& app);

}  // namespace kelvo
