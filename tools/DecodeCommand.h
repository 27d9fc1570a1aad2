#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// "kelvoctl decode": a capture as the display its messages give.
void addDecodeCommand(CLI::App& app);

}  // namespace kelvo
