#pragma once

#include <string>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"

namespace kelvo {

/// Writes `bytes` to `path` in place, where others may have put something: over a plain file of this user alone, and
/// never through a link; anything else fails and stays as it is. A new file has mode 0600. The reason of a failure does
/// not name the file. A file that could not be written to its end is removed, so that none passes for whole.
Result<void> writeFileInPlace(const std::string& path, ByteView bytes);

}  // namespace kelvo
