#pragma once

#include <CLI/CLI.hpp>

namespace kelvo {

/// "kelvoctl decode": a capture as the display its messages give.
void addDecodeCommand(CLI::App& app);

}  // namespace kelvo
