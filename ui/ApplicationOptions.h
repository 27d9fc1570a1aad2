#pragma once

#include <functional>
#include <optional>
#include <string>

namespace CLI {
class App;
}

namespace kelvo {

/// What the application's command line asks for.
struct ApplicationOptions {
    /// A capture to replay or a snapshot to show, as a path or a file URL; none: the log of the telephony service.
    std::optional<std::string> file;
};

/// Options to work with, or the status to exit with at once.
struct ParsedApplicationOptions {
    std::optional<ApplicationOptions> options;
    int exitStatus = 0;
};

/// Reads the command line. Prints help to standard output and errors, in one line, to standard error.
ParsedApplicationOptions parseApplicationOptions(int argc, const char* const* argv);

/// Shows the command line's description to `reader`, for the manual.
void describeApplicationOptions(const std::function<void(const CLI::App&)>& reader);

}  // namespace kelvo
