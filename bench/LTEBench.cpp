#include "LogGenerator/LTE/LTELogGenerator.h"
#include "bench/Decoding.h"
#include "bench/LTERecords.h"

namespace kelvo {
namespace {

using bench::candidates;
using bench::connectedMode;
using bench::idleNeighbors;
using bench::servingCell;
using bench::servingMeasurement;

constexpr auto decode = bench::decode<LTELogGenerator>;

BENCHMARK_CAPTURE(decode, B0C2_serving_cell, {servingCell()});
BENCHMARK_CAPTURE(decode, B17F_serving_measurement, {servingMeasurement()});
BENCHMARK_CAPTURE(decode, B179_with_4_cells, {connectedMode()});
BENCHMARK_CAPTURE(decode, B180_with_8_cells, {idleNeighbors()});
BENCHMARK_CAPTURE(decode, B186_with_6_candidates, {candidates()});
BENCHMARK_CAPTURE(decode, mix, {servingCell(), servingMeasurement(), connectedMode(), idleNeighbors(), candidates()});

}  // namespace
}  // namespace kelvo
