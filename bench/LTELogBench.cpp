#include <spdlog/sinks/null_sink.h>

#include <memory>

#include "LogGenerator/LTE/LTELogGenerator.h"
#include "bench/Decoding.h"
#include "bench/LTERecords.h"
#include "platform/host/HostSystemLog.h"

namespace kelvo {
namespace {

/// With the application's log: every line goes through its queue to its thread, and is thrown away there.
void decode(benchmark::State& state, const Bytes& message) {
    HostSystemLog log(std::make_shared<spdlog::sinks::null_sink_st>());
    bench::decodeLogging<LTELogGenerator>(state, &log, {message});
}

BENCHMARK_CAPTURE(decode, B0C2_serving_cell, bench::servingCell());
BENCHMARK_CAPTURE(decode, B17F_serving_measurement, bench::servingMeasurement());
BENCHMARK_CAPTURE(decode, B179_with_4_cells, bench::connectedMode());

}  // namespace
}  // namespace kelvo
