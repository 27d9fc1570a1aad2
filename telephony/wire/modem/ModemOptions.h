#pragma once

#include <cstdint>
#include <filesystem>
#include <functional>
#include <optional>
#include <string>

#include "platform/telephony/Technology.h"
#include "telephony/simulation/Generation.h"
#include "telephony/wire/modem/Faults.h"

namespace CLI {
class App;
}

namespace kelvo::modem {

/// What the command line of kelvo-modem asks for.
struct ModemOptions {
    std::filesystem::path replay;  ///< a capture or a file of frames; empty: a simulation
    Technology simulate = Technology::LTE;
    simulation::Generation generation = simulation::Generation::Of2010;
    std::string on;  ///< "tcp:PORT", "unix:PATH", or a link to the pseudo-terminal; empty: no link
    Faults faults;
    std::uint64_t seed = 1;
};

/// Options to work with, or the status to exit with at once.
struct ParsedModemOptions {
    std::optional<ModemOptions> options;
    int exitStatus = 0;
};

/// Reads the command line. Prints help to standard output and errors, in one line, to standard error.
ParsedModemOptions parseModemOptions(int argc, const char* const* argv);

/// Shows the command line's description to `reader`, for the manual.
void describeModemOptions(const std::function<void(const CLI::App&)>& reader);

}  // namespace kelvo::modem
