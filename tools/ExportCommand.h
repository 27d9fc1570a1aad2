#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// "kelvoctl export": the readings of captures, snapshots and recordings, or of the running service, as tables.
void addExportCommand(CLI::App& app);

}  // namespace kelvo
