#include "tools/Command.h"

#include <CLI/CLI.hpp>

namespace kelvo {

CLI::App& addCommand(CLI::App& app, const std::string& name, const std::string& description) {
    return *app.add_subcommand(name, description);
}

}  // namespace kelvo
