#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// "kelvoctl share": a copy of a file in which identities are replaced.
void addShareCommand(CLI::App& app);

}  // namespace kelvo
