#pragma once

#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "platform/values/Result.h"

namespace CLI {
class App;
}

namespace kelvo {

/// Where a service that is told nothing else looks what to start with.
struct ConfigPlaces {
    std::filesystem::path user;    ///< first: "kelvo/telephonyd.conf" in the user's configuration directory
    std::filesystem::path system;  ///< else: "/etc/kelvo/telephonyd.conf"

    static ConfigPlaces ofHost();
    /// The first of them that is there; none when neither is.
    std::optional<std::filesystem::path> existing() const;
};

/// Reads a configuration file: the long names of `commandLine`'s options without their dashes, a line each,
///     port = "auto"
///     no-dtr-rts = true
/// and gives them as the command line has them, "--port=auto", "--no-dtr-rts". What the option makes of its value is
/// not looked at. An option that is for a single run (--help, --status, …) is refused, as is a file that is none of
/// this.
Result<std::vector<std::string>> readServiceConfig(const std::filesystem::path& file, const CLI::App& commandLine);

/// Whether the option `name`, with its dashes, stands among these arguments.
bool isGiven(const std::vector<std::string>& arguments, const std::string& name);

}  // namespace kelvo
