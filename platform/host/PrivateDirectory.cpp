#include "platform/host/PrivateDirectory.h"

#include <fcntl.h>
#include <fmt/format.h>
#include <sys/stat.h>

#include <cerrno>
#include <cstring>

namespace kelvo {
namespace {

Failure failed(const std::filesystem::path& path, int error) {
    return {fmt::format("cannot open directory {}: {}", path.native(), std::strerror(error))};
}

UniqueFd openDirectory(const std::filesystem::path& path) {
    return UniqueFd(::open(path.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
}

// A parent may be shared, but then with the sticky bit, so that nobody renames what lies in it.
bool mayHoldPrivateEntries(const struct stat& status) {
    const bool othersWrite = (status.st_mode & (S_IWGRP | S_IWOTH)) != 0;
    return (status.st_uid == ::geteuid() || status.st_uid == 0) && (!othersWrite || (status.st_mode & S_ISVTX) != 0);
}

bool isPrivate(const struct stat& status) {
    return status.st_uid == ::geteuid() && (status.st_mode & (S_IRWXG | S_IRWXO)) == 0;
}

}  // namespace

Result<UniqueFd> openPrivateDirectory(const std::filesystem::path& path) {
    const std::filesystem::path parent = path.parent_path();
    ::mkdir(parent.c_str(), S_IRWXU);  // there already, most of the time
    struct stat status {};
    const UniqueFd outer = openDirectory(parent);
    if (!outer || ::fstat(outer.get(), &status) != 0) return failed(parent, errno);
    if (!mayHoldPrivateEntries(status)) return failed(parent, EPERM);

    const std::string name = path.filename();
    ::mkdirat(outer.get(), name.c_str(), S_IRWXU);
    UniqueFd inner(::openat(outer.get(), name.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC));
    if (!inner || ::fstat(inner.get(), &status) != 0) return failed(path, errno);
    if (!isPrivate(status)) return failed(path, EPERM);
    return inner;
}

}  // namespace kelvo
