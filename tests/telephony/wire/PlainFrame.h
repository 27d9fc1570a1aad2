#pragma once

#include <cstdint>
#include <initializer_list>

#include "platform/values/Bytes.h"

/// Frames made bit by bit, without any of the code that is tested.
namespace kelvo::test {

inline std::uint16_t plainChecksum(ByteView bytes) {
    std::uint16_t crc = 0xFFFF;
    for (const std::uint8_t byte : bytes) {
        crc ^= byte;
        for (int bit = 0; bit < 8; ++bit)
            crc = static_cast<std::uint16_t>((crc & 1) != 0 ? crc >> 1 ^ 0x8408 : crc >> 1);
    }
    return crc ^ 0xFFFF;
}

inline Bytes plainFrame(Bytes body) {
    const std::uint16_t crc = plainChecksum(body);
    body.push_back(static_cast<std::uint8_t>(crc));
    body.push_back(static_cast<std::uint8_t>(crc >> 8));
    Bytes frame;
    for (const std::uint8_t byte : body) {
        if (byte == 0x7D) {
            frame.insert(frame.end(), {0x7D, 0x5D});
        } else if (byte == 0x7E) {
            frame.insert(frame.end(), {0x7D, 0x5E});
        } else {
            frame.push_back(byte);
        }
    }
    frame.push_back(0x7E);
    return frame;
}

inline Bytes joined(std::initializer_list<Bytes> parts) {
    Bytes all;
    for (const Bytes& part : parts) all.insert(all.end(), part.begin(), part.end());
    return all;
}

}  // namespace kelvo::test
