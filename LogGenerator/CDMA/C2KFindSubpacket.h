#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>

#include "platform/values/Bytes.h"

namespace kelvo {

/// The offset of the first sub-packet with the id `wanted`; none when there is no such sub-packet. A size in the chain
/// that leads too far ends the search with one log line, even at a sub-packet with the wanted id.
///
/// A packet of sub-packets has their count (u8) at offset 14 and the first of them at offset 17. Each begins with its
/// id (u8 at 0) and its size (u16 at 2), header included; the next follows at once. What the sub-packet holds may lie
/// past the packet's end.
std::optional<std::size_t> C2KFindSubpacket(ByteView packet, std::uint8_t wanted);

}  // namespace kelvo
