#include "tools/doctor/PortAccess.h"

#include <grp.h>
#include <sys/stat.h>
#include <unistd.h>

namespace kelvo {
namespace {

constexpr mode_t kGroupMay = S_IRGRP | S_IWGRP;
constexpr gid_t kRoot = 0;

}  // namespace

PortAccess accessTo(const std::filesystem::path& port) {
    PortAccess access;
    struct stat status {};
    if (::stat(port.c_str(), &status) != 0) return access;
    access.exists = true;
    access.mayOpen = ::access(port.c_str(), R_OK | W_OK) == 0;
    if ((status.st_mode & kGroupMay) != kGroupMay || status.st_gid == kRoot) return access;
    const group* const entry = ::getgrgid(status.st_gid);
    access.group = entry != nullptr ? entry->gr_name : std::to_string(status.st_gid);
    return access;
}

}  // namespace kelvo
