// What it costs to turn a newer modem's records into the fixed layouts, and that nothing is allocated for one.
//
// The streams are simulated LTE drives of each generation, or the records of the file that KELVO_BENCH_FRAMES names.
#include <benchmark/benchmark.h>

#include <cstdlib>
#include <new>

#include "LogGenerator/Framing.h"
#include "telephony/adaptation/RecordAdapter.h"
#include "telephony/recordings/FramesRecording.h"
#include "telephony/simulation/MakeSimulation.h"

namespace {

std::size_t allocations = 0;

}  // namespace

// Every allocation is counted.
void* operator new(std::size_t size) {
    ++allocations;
    if (void* memory = std::malloc(size)) return memory;
    throw std::bad_alloc();
}
void operator delete(void* memory) noexcept { std::free(memory); }
void operator delete(void* memory, std::size_t) noexcept { std::free(memory); }

namespace {

using namespace kelvo;
using namespace std::chrono_literals;

std::vector<Bytes> drive(simulation::Generation generation) {
    const auto modem = simulation::makeSimulation(Technology::LTE, 1, generation);
    std::vector<Bytes> packets;
    for (auto message = modem->next(); message.time < 10min; message = modem->next()) {
        const ByteView packet = stripPrefix(message.bytes);
        if (packet[0] == 1) packets.emplace_back(packet.begin(), packet.end());
    }
    return packets;
}

std::vector<Bytes> recorded(const char* path) {
    std::vector<Bytes> packets;
    auto file = RecordingFile::open(path);
    if (!file) return packets;
    FramesRecording frames(std::move(file).value());
    for (auto next = frames.next(); next && *next; next = frames.next())
        packets.emplace_back((*next)->message.begin(), (*next)->message.end());
    return packets;
}

void measure(benchmark::State& state, const std::vector<Bytes>& packets) {
    if (packets.empty()) return state.SkipWithError("there are no records");
    adaptation::RecordAdapter adapter;
    std::size_t turned = 0;
    std::size_t allocated = 0;
    for (auto _ : state) {
        const std::size_t before = allocations;
        for (const Bytes& packet : packets) {
            const adaptation::Adapted adapted = adapter.adapt(packet);
            turned += adapted.outcome == adaptation::Adapted::Outcome::Turned ? 1 : 0;
            benchmark::DoNotOptimize(adapted.packet.data());
        }
        allocated += allocations - before;
    }
    const auto records = static_cast<std::int64_t>(state.iterations() * packets.size());
    state.SetItemsProcessed(records);
    state.counters["turned"] = static_cast<double>(turned) / static_cast<double>(records);
    state.counters["allocations"] = static_cast<double>(allocated);
    if (allocated != 0) state.SkipWithError("adapting allocates");
}

void registerAll() {
    using simulation::Generation;
    for (const Generation generation : {Generation::Of2010, Generation::Of2014, Generation::Of2018}) {
        const std::string name = "a drive of " + std::string(simulation::yearOf(generation));
        benchmark::RegisterBenchmark(name.c_str(), measure, drive(generation));
    }
    if (const char* const path = std::getenv("KELVO_BENCH_FRAMES"))
        benchmark::RegisterBenchmark("recorded", measure, recorded(path));
}

}  // namespace

int main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    registerAll();
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
}
