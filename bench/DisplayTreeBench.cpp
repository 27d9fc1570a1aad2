#include <benchmark/benchmark.h>

#include <string>

#include "model/KelvoModelNode.h"

namespace kelvo {
namespace {

/// Twenty-six sections of 16 values each: thirteen of scalar values, eleven of them sorted, and thirteen lists of two
/// cells.
Value typicalScreen() {
    const DictionaryRef display = Dictionary::make();
    for (int section = 0; section < 26; ++section) {
        const std::string name = "Section with a usual name " + std::to_string(section);
        const auto values = [](int count, bool sorted) {
            const DictionaryRef part = Dictionary::make();
            if (sorted) part->set("_sorted", "");
            for (int i = 0; i < count; ++i)
                part->set(std::to_string(i) + ";Measured Value " + std::to_string(i), "-97.25 dBm");
            return part;
        };
        if (section < 13) {
            display->set(name, values(16, section < 11));
        } else {
            display->set(name, Array::make({values(8, false), values(8, false)}));
        }
    }
    return display;
}

void BM_TypicalScreen(benchmark::State& state) {  // one rebuild, the tree before it thrown away
    const Value display = typicalScreen();
    NodesByPath nodes;
    for (auto _ : state) {
        nodes.clear();
        benchmark::DoNotOptimize(KelvoModelNode::makeTreeFromObject(display, nodes));
    }
    state.counters["nodes"] = static_cast<double>(nodes.size());
}
BENCHMARK(BM_TypicalScreen)->Unit(benchmark::kMicrosecond);

}  // namespace
}  // namespace kelvo
