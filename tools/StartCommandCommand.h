#pragma once

#include <CLI/App.hpp>

namespace kelvo {

/// "kelvoctl start-command": what makes the service stream a technology's records.
void addStartCommandCommand(CLI::App& app);

}  // namespace kelvo
