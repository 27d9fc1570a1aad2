#pragma once

#include <filesystem>

namespace kelvo {

/// Where this system keeps what belongs to the program and its user.
struct HostPaths {
    /// The application's resources, "../share/kelvo" beside the program: the same in a build tree and installed.
    /// Needs a QCoreApplication.
    static std::filesystem::path resourcesDirectory();

    /// The user's configuration: $XDG_CONFIG_HOME or ~/.config.
    static std::filesystem::path configDirectory();

    /// Where the user's programs find each other's message ports: "kelvo/ports" in $XDG_RUNTIME_DIR, or in a directory
    /// of the user's under /tmp on a system that has no such place.
    static std::filesystem::path portDirectory();
};

}  // namespace kelvo
