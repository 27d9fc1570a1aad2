#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "platform/values/Bytes.h"

namespace kelvo {

/// The bytes that `text` stands for in Base64 (RFC 4648, section 4). White space may stand anywhere; none when another
/// character does, or when the last group of four is incomplete.
std::optional<Bytes> bytesFromBase64(std::string_view text);

/// Appends `data` in Base64, padded and on one line, to `out`.
void appendBase64(std::string& out, ByteView data);

}  // namespace kelvo
