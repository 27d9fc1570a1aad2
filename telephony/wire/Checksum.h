#pragma once

#include <cstdint>

#include "platform/values/Bytes.h"

namespace kelvo::wire {

/// CRC-16/X-25: polynomial 0x1021 reflected, initial 0xFFFF, final xor 0xFFFF. "123456789" gives 0x906E.
std::uint16_t checksum(ByteView bytes);

}  // namespace kelvo::wire
