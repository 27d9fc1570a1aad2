#pragma once

#include <cstdint>
#include <string>

#include "tests/telephony/wire/PlainFrame.h"

/// Bytes of recordings, made without the code that reads them.
namespace kelvo::test {

/// A record from its length on. `ticks` are units of 1.25 ms since 1980.
inline Bytes plainRecord(std::uint16_t code, std::uint64_t ticks, const Bytes& payload) {
    const auto length = static_cast<std::uint16_t>(12 + payload.size());
    Bytes record = {static_cast<std::uint8_t>(length),
                    static_cast<std::uint8_t>(length >> 8),
                    static_cast<std::uint8_t>(code),
                    static_cast<std::uint8_t>(code >> 8),
                    0,
                    0};
    for (int i = 0; i < 6; ++i) record.push_back(static_cast<std::uint8_t>(ticks >> (8 * i)));
    record.insert(record.end(), payload.begin(), payload.end());
    return record;
}

/// 2023-12-06 04:04:26: 43 years, 11 months after 1980-01-06.
inline constexpr std::uint64_t kTicks = std::uint64_t{1385870666} * 800;

/// The body of a frame with a record.
inline Bytes recordBodyOf(const Bytes& record) {
    Bytes body = {0x10, 0, record[0], record[1]};
    body.insert(body.end(), record.begin(), record.end());
    return body;
}

inline Bytes& operator+=(Bytes& bytes, const Bytes& more) {
    bytes.insert(bytes.end(), more.begin(), more.end());
    return bytes;
}

}  // namespace kelvo::test
