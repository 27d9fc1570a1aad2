#pragma once

#include <string>

#include "model/SnapshotFile.h"

namespace kelvo {

/// The snapshot at `path`, packed with gzip or not. A failure's reason names the file.
Result<SnapshotFile> readSnapshot(const std::string& path);

}  // namespace kelvo
