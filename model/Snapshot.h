#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "LogGenerator/SnapshotFormat.h"
#include "platform/system/Clock.h"
#include "platform/values/Bytes.h"
#include "platform/values/Result.h"
#include "platform/values/Value.h"

namespace kelvo {

/// One saved snapshot: when it was taken, the contents a generator hands out, and what the user says about it.
/// LogGenerator/SnapshotFormat.h says what the file holds: without `data` the time alone, without a description the
/// time and the data.
struct Snapshot {
    Clock::TimePoint timestamp;
    ArrayRef data;
    std::optional<std::string> description;

    /// The file's one dictionary.
    DictionaryRef dictionary() const;
    /// The file's bytes, an XML property list.
    Result<Bytes> propertyList() const;

    /// The file's path in `directory`, by whole seconds since 1970: two in one second share it.
    static std::string pathInDirectory(std::string_view directory, Clock::TimePoint now);
};

}  // namespace kelvo
