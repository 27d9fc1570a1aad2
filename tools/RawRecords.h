#pragma once

#include <cstddef>
#include <vector>

#include "platform/values/Bytes.h"

namespace kelvo {

/// The messages that stand end to end in a snapshot's raw records.
struct RawRecords {
    std::vector<ByteView> messages;  ///< views of the bytes they were split from
    std::size_t leftOver = 0;        ///< bytes at the end that form no whole message
};

/// Splits raw records by the length each one states: an optional prefix of two bytes, the first 0x81; the log type; and
/// a 16-bit little-endian length that counts from itself to the record's end. A record whose length does not fit ends
/// the list, because nothing says where the next one starts.
RawRecords splitRawRecords(ByteView bytes);

}  // namespace kelvo
