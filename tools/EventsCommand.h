#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// "events": what happened in captures, worked out from their values.
void addEventsCommand(CLI::App& app);

}  // namespace kelvo
