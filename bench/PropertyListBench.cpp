// Reading and writing cell-information arrays, of the size the telephony service sends and of a large one.

#include <benchmark/benchmark.h>

#include <cstdint>

#include "bench/BinaryEncoder.h"
#include "platform/encodings/PropertyList.h"
#include "platform/telephony/TelephonyConstants.h"

namespace {

using namespace kelvo;
using bench::BinaryEncoder;

Value cellInformation(std::int64_t cells) {
    const ArrayRef array = Array::make();
    for (int i = 0; i < cells; ++i) {
        array->append(Dictionary::make({
            {kPLCellMonitorCellRadioAccessTechnology, kPLCellMonitorRadioAccessTechnologyLTE},
            {kPLCellMonitorCellType, i == 0 ? kPLCellMonitorCellTypeServing : kPLCellMonitorCellTypeNeighbor},
            {kPLCellMonitorMCC, 262},
            {kPLCellMonitorMNC, 1},
            {kPLCellMonitorTAC, 4097 + i},
            {kPLCellMonitorCellId, 27447296 + i},
            {kPLCellMonitorPID, i % 504},
            {kPLCellMonitorUARFCN, 1300 + i % 100},
            {kPLCellMonitorBandInfo, 3},
            {kPLCellMonitorRSSI, 32767},
            {kPLCellMonitorRSCP, -98 - i % 30},
            {kPLCellMonitorECN0, -11},
        }));
    }
    return array;
}

void read(benchmark::State& state, const Bytes& document) {
    for (auto _ : state) benchmark::DoNotOptimize(readPropertyList(document));
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(document.size()));
    state.SetItemsProcessed(state.iterations() * state.range(0));  // cells
}

void BM_ReadXml(benchmark::State& state) { read(state, *writeXmlPropertyList(cellInformation(state.range(0)))); }
BENCHMARK(BM_ReadXml)->Arg(7)->Arg(10000);

void BM_ReadBinary(benchmark::State& state) { read(state, BinaryEncoder().encode(cellInformation(state.range(0)))); }
BENCHMARK(BM_ReadBinary)->Arg(7)->Arg(10000);

void BM_WriteXml(benchmark::State& state) {
    const Value cells = cellInformation(state.range(0));
    const std::size_t size = writeXmlPropertyList(cells)->size();
    for (auto _ : state) benchmark::DoNotOptimize(writeXmlPropertyList(cells));
    state.SetBytesProcessed(state.iterations() * static_cast<std::int64_t>(size));
    state.SetItemsProcessed(state.iterations() * state.range(0));  // cells
}
BENCHMARK(BM_WriteXml)->Arg(7)->Arg(10000);

}  // namespace
