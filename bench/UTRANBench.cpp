#include "LogGenerator/UTRAN/UTRANLogGenerator.h"
#include "bench/Decoding.h"
#include "tests/support/Record.h"

namespace kelvo {
namespace {

using test::Record;

Bytes rrcState() { return Record(0xD0E0, 15).u8(13, 1).u8(14, 3).bytes(); }
Bytes servingCell() { return Record(0xD0E2, 26).u16(17, 9400).u16(19, 10054).u32(21, 12345678).bytes(); }

Bytes neighbors() {
    Record record(0xD00A, 168 + 16 * 8);
    record.u8(16, 8 << 1);
    for (std::uint32_t i = 0; i < 8; ++i) record.u32(168 + 16 * i, 0x12345678 + i);
    return record.bytes();
}

Bytes channels() { return Record(0xD00C, 289 + 34 * 4 + 8 * 2).u16(14, 2 << 12 | 4 << 6).bytes(); }

constexpr auto decode = bench::decode<UTRANLogGenerator>;

BENCHMARK_CAPTURE(decode, D0E0_rrc_state, {rrcState()});
BENCHMARK_CAPTURE(decode, D0E2_serving_cell, {servingCell()});
BENCHMARK_CAPTURE(decode, D00A_with_8_neighbors, {neighbors()});
BENCHMARK_CAPTURE(decode, D00C_with_4_channels, {channels()});
BENCHMARK_CAPTURE(decode, mix, {rrcState(), servingCell(), neighbors(), channels()});

}  // namespace
}  // namespace kelvo
