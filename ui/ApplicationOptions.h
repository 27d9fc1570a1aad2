#pragma once

#include <functional>
#include <optional>

namespace CLI {
class App;
}

namespace kelvo {

/// Reads the application's command line. The status to exit with at once, when it asks for help or the version or is
/// wrong; none: start.
std::optional<int> applicationExitStatus(int argc, const char* const* argv);

/// Shows the command line's description to `reader`, for the manual.
void describeApplicationOptions(const std::function<void(const CLI::App&)>& reader);

}  // namespace kelvo
