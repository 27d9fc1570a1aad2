#include "LogGenerator/GSM/GSMLogGenerator.h"
#include "bench/Decoding.h"
#include "platform/PropertyList.h"

namespace kelvo {
namespace {

Value cell(int number) {
    return Dictionary::make({{"ARFCN", std::to_string(500 + number)},
                             {"BSIC", Dictionary::make({{"Value", std::to_string(number)}})},
                             {"RXLEV", "-87 dBm"},
                             {"C1", "12"},
                             {"C2", "14"}});
}

/// What a modem sends: a serving cell and `neighbors` others in an array behind its header.
Bytes tree(int neighbors) {
    const ArrayRef list = Array::make({"header"});
    for (int i = 0; i < neighbors; ++i) list->append(cell(i));
    return *writeXmlPropertyList(Dictionary::make({{"Serving", cell(0)}, {"Neighbours", list}}));
}

constexpr auto decode = bench::decode<GSMLogGenerator>;

BENCHMARK_CAPTURE(decode, serving_cell, {tree(0)});
BENCHMARK_CAPTURE(decode, with_6_neighbors, {tree(6)});
BENCHMARK_CAPTURE(decode, with_32_neighbors, {tree(32)});

void simplify(benchmark::State& state) {
    const Value received = *readPropertyList(tree(6));
    for (auto _ : state) benchmark::DoNotOptimize(GSMLogGenerator::processObject(received));
    state.SetItemsProcessed(state.iterations());
}
BENCHMARK(simplify);

}  // namespace
}  // namespace kelvo
