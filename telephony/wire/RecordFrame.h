#pragma once

#include <cstdint>
#include <optional>

#include "telephony/wire/FrameReader.h"

namespace kelvo::wire {

/// The body of a frame that carries a record (0x10):
///
///     offset  width  field
///          0      1  0x10
///          1      1  how many more records wait in the modem
///          2      2  length of what follows
///          4      2  the same: the record begins here, this field included
///          6      2  record code
///          8      8  timestamp
///         16         payload
struct RecordFrame {
    std::uint8_t waiting = 0;
    std::uint16_t code = 0;
    std::uint64_t timestamp = 0;
    ByteView record;  ///< from its length on, as in a DLF file
};

/// None when the lengths agree neither with each other nor with the body, or are below a record's 12 bytes.
std::optional<RecordFrame> parseRecord(ByteView body);

/// The body of a record's frame as the packet that clients get: the byte 1, which overwrites the one before the record,
/// and the record. `body` has been parsed.
ByteView packetOf(MutableBytes body);

/// The frame's body that carries `record`, which begins with its length; a packet without its first byte is one.
Bytes recordBody(std::uint8_t waiting, ByteView record);

}  // namespace kelvo::wire
