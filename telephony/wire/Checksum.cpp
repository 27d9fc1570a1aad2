#include "telephony/wire/Checksum.h"

#include <array>
#include <cstddef>

namespace kelvo::wire {
namespace {

constexpr std::size_t kStride = 16;  // bytes that are looked up at once

using Table = std::array<std::uint16_t, 256>;

// In the n-th table: what a byte that n more bytes follow does to the checksum.
constexpr std::array<Table, kStride> kTables = [] {
    std::array<Table, kStride> tables{};
    for (unsigned byte = 0; byte < 256; ++byte) {
        unsigned crc = byte;
        for (int bit = 0; bit < 8; ++bit) crc = crc >> 1 ^ ((crc & 1) != 0 ? 0x8408U : 0U);
        tables[0][byte] = static_cast<std::uint16_t>(crc);
    }
    for (std::size_t n = 1; n < kStride; ++n) {
        for (std::size_t byte = 0; byte < 256; ++byte) {
            const unsigned before = tables[n - 1][byte];
            tables[n][byte] = static_cast<std::uint16_t>(before >> 8 ^ tables[0][before & 0xFF]);
        }
    }
    return tables;
}();

}  // namespace

std::uint16_t checksum(ByteView bytes) {
    unsigned crc = 0xFFFF;
    const std::uint8_t* at = bytes.data();
    const std::uint8_t* const end = at + bytes.size();
    for (; static_cast<std::size_t>(end - at) >= kStride; at += kStride) {
        unsigned next = kTables[15][at[0] ^ (crc & 0xFF)] ^ kTables[14][at[1] ^ crc >> 8];
        for (std::size_t i = 2; i < kStride; ++i) next ^= kTables[kStride - 1 - i][at[i]];
        crc = next;
    }
    for (; at != end; ++at) crc = crc >> 8 ^ kTables[0][(crc ^ *at) & 0xFF];
    return static_cast<std::uint16_t>(crc ^ 0xFFFF);
}

}  // namespace kelvo::wire
