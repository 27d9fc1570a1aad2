#pragma once

#include <benchmark/benchmark.h>

#include <vector>

#include "platform/DirectoryResources.h"
#include "platform/Environment.h"
#include "platform/Value.h"

namespace kelvo::bench {

/// Messages per second on the road into the display, `messages` in turn, with log lines going to `log` or, without one,
/// thrown away. The history takes its snapshots outside the measurement, often enough that the raw log does not grow
/// without end.
template <class Generator>
void decodeLogging(benchmark::State& state, SystemLog* log, const std::vector<Bytes>& messages) {
    const DirectoryResources resources(KELVO_RESOURCE_DIR);
    const Environment::Scope environment({.log = log, .resources = &resources});
    Dictionary display;
    Generator generator;
    std::size_t next = 0;
    std::size_t collected = 0;
    for (auto _ : state) {
        generator.updateState(display, messages[next]);
        collected += messages[next].size();
        next = next + 1 < messages.size() ? next + 1 : 0;
        if (collected > 10'000'000) {
            state.PauseTiming();
            generator.generateLogUsingState(display);
            collected = 0;
            state.ResumeTiming();
        }
    }
    state.SetItemsProcessed(state.iterations());
}

template <class Generator>
void decode(benchmark::State& state, const std::vector<Bytes>& messages) {
    decodeLogging<Generator>(state, nullptr, messages);
}

}  // namespace kelvo::bench
