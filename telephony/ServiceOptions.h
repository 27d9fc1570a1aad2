#pragma once

#include <filesystem>
#include <optional>

#include "telephony/ReplaySource.h"

namespace kelvo {

/// What the command line of the service asks for.
struct ServiceOptions {
    std::filesystem::path replay;  ///< the capture
    ReplaySource::Options replayOptions;
};

/// Options to work with, or the status to exit with at once.
struct ParsedOptions {
    std::optional<ServiceOptions> options;
    int exitStatus = 0;
};

/// Reads the command line. Prints help to standard output and errors, in one line, to standard error.
ParsedOptions parseServiceOptions(int argc, const char* const* argv);

}  // namespace kelvo
