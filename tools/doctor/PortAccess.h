#pragma once

#include <filesystem>
#include <string>

namespace kelvo {

/// Whether this user may open a port.
struct PortAccess {
    bool exists = false;
    bool mayOpen = false;  ///< to read and to write
    std::string group{};   ///< that may, when the user is in it; empty: no group may
};

PortAccess accessTo(const std::filesystem::path& port);

}  // namespace kelvo
