#pragma once

#include <cstdint>

#include "platform/values/Bytes.h"

/// Numbers as on the diagnostic port. The caller has made sure that what is read lies inside the bytes.
namespace kelvo::wire {

inline std::uint16_t u16At(ByteView bytes, std::size_t at) {
    return static_cast<std::uint16_t>(bytes[at] | bytes[at + 1] << 8);
}

inline std::uint32_t u32At(ByteView bytes, std::size_t at) {
    return u16At(bytes, at) | std::uint32_t{u16At(bytes, at + 2)} << 16;
}

inline std::uint64_t u64At(ByteView bytes, std::size_t at) {
    return u32At(bytes, at) | std::uint64_t{u32At(bytes, at + 4)} << 32;
}

inline void append16(Bytes& to, std::uint16_t value) {
    to.push_back(static_cast<std::uint8_t>(value));
    to.push_back(static_cast<std::uint8_t>(value >> 8));
}

inline void append32(Bytes& to, std::uint32_t value) {
    append16(to, static_cast<std::uint16_t>(value));
    append16(to, static_cast<std::uint16_t>(value >> 16));
}

}  // namespace kelvo::wire
