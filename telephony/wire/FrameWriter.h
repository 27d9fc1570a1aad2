#pragma once

#include <cstdint>

#include "platform/values/Bytes.h"

namespace kelvo::wire {

inline constexpr std::uint8_t kFrameEnd = 0x7E;
inline constexpr std::uint8_t kEscape = 0x7D;  ///< the byte behind it is meant with kEscapeBit turned over
inline constexpr std::uint8_t kEscapeBit = 0x20;

/// Appends `body` as one frame: escaped, with its checksum and the end mark.
void appendFrame(Bytes& to, ByteView body);

/// `body` as one frame.
Bytes frameOf(ByteView body);

}  // namespace kelvo::wire
