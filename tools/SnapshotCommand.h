#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// "kelvoctl snapshot": what a saved snapshot holds.
void addSnapshotCommand(CLI::App& app);

}  // namespace kelvo
