#pragma once

#include <cstdint>
#include <filesystem>
#include <functional>
#include <optional>
#include <string>

#include "telephony/PacedSource.h"
#include "telephony/ServiceConfig.h"
#include "telephony/line/PortAddress.h"
#include "telephony/line/SerialLine.h"
#include "telephony/simulation/Generation.h"
#include "telephony/wire/Session.h"

namespace kelvo {

/// What the command line of the service asks for.
struct ServiceOptions {
    bool status = false;           ///< ask the service that runs, instead of being one
    bool json = false;             ///< its status is for a program
    std::filesystem::path replay;  ///< a capture; empty: a simulation or a port
    bool loop = false;
    Technology simulate = Technology::LTE;
    std::uint64_t seed = 1;
    simulation::Generation generation = simulation::Generation::Of2010;
    PacedSource::Speed speed = 1.0;
    std::optional<PortAddress> port;          ///< none: a capture or a simulation
    std::optional<std::string> modemManager;  ///< which of its modems, empty: the first; none: it is not asked
    wire::Session::Options session;
    SerialLine::Options line;
    std::filesystem::path recordFrames;  ///< empty: the port's bytes are not recorded
    std::filesystem::path record;        ///< empty: nothing is recorded
    bool force = false;                  ///< a file that is there gives way to the recording
};

/// Options to work with, or the status to exit with at once.
struct ParsedOptions {
    std::optional<ServiceOptions> options;
    int exitStatus = 0;
};

/// Reads the command line, and where that names no source the configuration: what the command line says goes before it.
/// Prints help, and what has become of a check of the configuration, to standard output; errors, in one line, to
/// standard error.
ParsedOptions parseServiceOptions(int argc, const char* const* argv, const ConfigPlaces& places);

/// Shows the command line's description to `reader`, for the manual.
void describeServiceOptions(const std::function<void(const CLI::App&)>& reader);

}  // namespace kelvo
