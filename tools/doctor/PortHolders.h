#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace kelvo {

/// Who has a port open.
struct PortHolders {
    struct Holder {
        int process = 0;
        std::string name;  ///< of its program; may be empty
    };
    std::vector<Holder> known{};  ///< in the order of their numbers
    bool someHidden = false;      ///< processes of others may be among them: this user may not look into those
};

/// Looks through the open files of every process below `proc` ("/proc") for the node `port`. This process is left out.
PortHolders holdersOf(const std::filesystem::path& port, const std::filesystem::path& proc);

}  // namespace kelvo
