#pragma once

#include <CLI/CLI.hpp>

namespace kelvo {

/// "kelvoctl start-command": what makes the service stream a technology's records.
void addStartCommandCommand(CLI::App& app);

}  // namespace kelvo
