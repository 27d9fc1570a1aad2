#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// "kelvoctl import": makes a capture of what others have recorded, or lists what is in it.
void addImportCommand(CLI::App& app);

}  // namespace kelvo
