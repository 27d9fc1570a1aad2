#pragma once

#include <functional>
#include <span>

#include "platform/values/Bytes.h"

namespace kelvo {

/// What the diagnostic device of a phone wraps around its bytes: u32 32 before every frame that is written; a read
/// gives u32 32, u32 n, then n pieces of u32 length and that many bytes. Little-endian.
namespace DeviceEnvelope {

/// One frame, as it is written.
Bytes wrap(ByteView frame);
/// Hands over the pieces of one read, as far as they lie in it; false when it is none or breaks off.
bool unwrap(std::span<std::uint8_t> read, const std::function<void(std::span<std::uint8_t>)>& take);

}  // namespace DeviceEnvelope

}  // namespace kelvo
