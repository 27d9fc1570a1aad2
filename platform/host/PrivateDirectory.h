#pragma once

#include <filesystem>

#include "platform/host/UniqueFd.h"
#include "platform/values/Result.h"

namespace kelvo {

/// Opens a directory that nobody but this user can enter, and makes it (mode 0700) when it is missing, with one missing
/// parent. Fails with a reason when it, or its parent, is a symbolic link or in the hands of another user: in a place
/// that everybody can write, such as /tmp, somebody else may have been there first.
Result<UniqueFd> openPrivateDirectory(const std::filesystem::path& path);

}  // namespace kelvo
