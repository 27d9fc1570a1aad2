#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"
#include "platform/values/Value.h"

namespace kelvo {

/// A snapshot file as it was read. What a snapshot does not hold, or holds in another form, is told in `odd` and left
/// out; the rest stands. An entry's number is its place in the file, from 1.
struct SnapshotFile {
    struct Entry {
        std::optional<std::string> description;
        std::optional<std::string> date;
        Value displayState;  ///< data: raw records; another kind: a cell-monitor tree; none when there is none
        Value display;
        Value dlf;  ///< data or none
    };

    std::optional<std::string> timestamp;
    std::optional<std::string> description;
    std::vector<Entry> entries;
    std::vector<std::string> odd;  ///< one short sentence each

    /// Reads the bytes of the file called `name`, which may be cut, hostile or something else altogether: a failure's
    /// reason names the file.
    static Result<SnapshotFile> read(const std::string& name, ByteView bytes);
};

}  // namespace kelvo
