#include "LogGenerator/LTE/LTELogGenerator.h"
#include "bench/Decoding.h"
#include "tests/support/Record.h"

namespace kelvo {
namespace {

using test::Record;

Bytes servingCell() { return Record(0xB0C2, 38).u16(14, 301).u16(16, 5780).u8(20, 50).u32(22, 12345678).bytes(); }

Bytes servingMeasurement() { return Record(0xB17F, 33).u16(17, 5780).u32(21, 0x9C4A2D87).u32(25, 0x1234567).bytes(); }

Bytes connectedMode() {
    Record record(0xB179, 53);
    record.u16(17, 5780).u8(27, 4);
    for (std::uint32_t i = 0; i < 4; ++i) record.u16(29 + 6 * i, 300 + i).u16(31 + 6 * i, 130 + i).u16(33 + 6 * i, 70);
    return record.bytes();
}

Bytes idleNeighbors() {
    Record record(0xB180, 181);
    record.u16(17, 5780).u16(19, 7 << 6 | 5);
    for (std::uint32_t i = 0; i < 8; ++i) record.u32(21 + 20 * i, 0x12345678 + i).u32(25 + 20 * i, 0x2345678);
    return record.bytes();
}

Bytes candidates() {
    Record record(0xB186, 53);
    record.u16(15, 5780).u8(19, 6);
    for (std::uint32_t i = 0; i < 6; ++i) record.u16(21 + 4 * i, i).u16(23 + 4 * i, i % 4);
    return record.bytes();
}

constexpr auto decode = bench::decode<LTELogGenerator>;

BENCHMARK_CAPTURE(decode, B0C2_serving_cell, {servingCell()});
BENCHMARK_CAPTURE(decode, B17F_serving_measurement, {servingMeasurement()});
BENCHMARK_CAPTURE(decode, B179_with_4_cells, {connectedMode()});
BENCHMARK_CAPTURE(decode, B180_with_8_cells, {idleNeighbors()});
BENCHMARK_CAPTURE(decode, B186_with_6_candidates, {candidates()});
BENCHMARK_CAPTURE(decode, mix, {servingCell(), servingMeasurement(), connectedMode(), idleNeighbors(), candidates()});

}  // namespace
}  // namespace kelvo
