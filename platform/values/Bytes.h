#pragma once

#include <cstdint>
#include <span>
#include <string_view>
#include <vector>

namespace kelvo {

/// Owned raw bytes.
using Bytes = std::vector<std::uint8_t>;

/// Borrowed raw bytes; valid for the call it is handed to unless the callee says otherwise.
using ByteView = std::span<const std::uint8_t>;

inline ByteView bytesOf(std::string_view text) {
    return {reinterpret_cast<const std::uint8_t*>(text.data()), text.size()};
}

inline std::string_view textOf(ByteView bytes) { return {reinterpret_cast<const char*>(bytes.data()), bytes.size()}; }

}  // namespace kelvo
