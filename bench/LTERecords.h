#pragma once

#include "tests/support/Record.h"

/// One plausible record of each kind that the LTE sections decode.
namespace kelvo::bench {

using test::Record;

inline Bytes servingCell() {
    return Record(0xB0C2, 38).u16(14, 301).u16(16, 5780).u8(20, 50).u32(22, 12345678).bytes();
}

inline Bytes servingMeasurement() {
    return Record(0xB17F, 33).u16(17, 5780).u32(21, 0x9C4A2D87).u32(25, 0x1234567).bytes();
}

inline Bytes connectedMode() {
    Record record(0xB179, 53);
    record.u16(17, 5780).u8(27, 4);
    for (std::uint32_t i = 0; i < 4; ++i) record.u16(29 + 6 * i, 300 + i).u16(31 + 6 * i, 130 + i).u16(33 + 6 * i, 70);
    return record.bytes();
}

inline Bytes idleNeighbors() {
    Record record(0xB180, 181);
    record.u16(17, 5780).u16(19, 7 << 6 | 5);
    for (std::uint32_t i = 0; i < 8; ++i) record.u32(21 + 20 * i, 0x12345678 + i).u32(25 + 20 * i, 0x2345678);
    return record.bytes();
}

inline Bytes candidates() {
    Record record(0xB186, 53);
    record.u16(15, 5780).u8(19, 6);
    for (std::uint32_t i = 0; i < 6; ++i) record.u16(21 + 4 * i, i).u16(23 + 4 * i, i % 4);
    return record.bytes();
}

}  // namespace kelvo::bench
