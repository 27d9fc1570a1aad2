#pragma once

#include <cstdint>

#include "tools/share/RecordSharer.h"

namespace kelvo {

/// A snapshot's content with everything in it shared: raw records, cell monitors' trees, what the screens showed, the
/// DLF log, which is made anew from the shared records. The user's words, and what no snapshot has, are removed and
/// counted. None for what is no snapshot.
struct SharedSnapshot {
    Value content{};
    std::uint64_t records = 0;  ///< that were shared: raw ones and trees
    std::uint64_t read = 0;     ///< that there were
};
SharedSnapshot sharedSnapshot(RecordSharer& sharer, const Value& snapshot);

}  // namespace kelvo
