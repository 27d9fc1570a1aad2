#include "tools/doctor/PortHolders.h"

#include <unistd.h>

#include <algorithm>
#include <charconv>
#include <fstream>
#include <optional>
#include <system_error>

namespace kelvo {
namespace {

namespace fs = std::filesystem;

std::optional<int> processNumber(const fs::path& directory) {
    const std::string name = directory.filename().string();
    int number = 0;
    const auto [end, error] = std::from_chars(name.data(), name.data() + name.size(), number);
    if (error != std::errc() || end != name.data() + name.size() || number == ::getpid()) return std::nullopt;
    return number;
}

// The system keeps 15 letters of a name; what the program was started as has the rest.
std::string programName(const fs::path& process) {
    std::string name;
    std::getline(std::ifstream(process / "comm"), name);
    std::string command;
    std::getline(std::ifstream(process / "cmdline"), command, '\0');
    const std::string whole = fs::path(command).filename().string();
    return whole.starts_with(name) ? whole : name;
}

bool hasOpen(const fs::path& process, const fs::path& port, std::error_code& error) {
    fs::directory_iterator file(process / "fd", error);
    for (; !error && file != fs::directory_iterator(); file.increment(error)) {
        std::error_code gone;  // it may be closed meanwhile
        if (fs::read_symlink(file->path(), gone) == port && !gone) return true;
    }
    return false;
}

}  // namespace

PortHolders holdersOf(const fs::path& port, const fs::path& proc) {
    PortHolders holders;
    std::error_code error;
    const fs::path node = fs::weakly_canonical(port, error);
    fs::directory_iterator process(proc, error);
    for (; !error && process != fs::directory_iterator(); process.increment(error)) {
        const auto number = processNumber(process->path());
        if (!number) continue;
        std::error_code refused;
        if (hasOpen(process->path(), node, refused)) holders.known.push_back({*number, programName(process->path())});
        holders.someHidden |= refused == std::errc::permission_denied;
    }
    std::ranges::sort(holders.known, {}, &PortHolders::Holder::process);
    return holders;
}

}  // namespace kelvo
