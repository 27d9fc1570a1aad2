// Messages a second on the road into the display, for each family, with log lines thrown away unseen and with the
// application's log, whose thread writes them to /dev/null:
//     build/bench/bin/decode_bench --benchmark_filter=LTE
// KELVO_BENCH_MESSAGES=n decodes exactly n messages, for counting instructions.

#include <benchmark/benchmark.h>

#include <cstdio>
#include <cstdlib>
#include <deque>
#include <optional>

#include "LogGenerator/Factory.h"
#include "LogGenerator/RecordLedger.h"
#include "bench/Families.h"
#include "platform/host/HostSystemLog.h"
#include "platform/system/DirectoryResources.h"
#include "platform/system/Environment.h"

namespace {

using namespace kelvo;
using bench::Family;

constexpr int kMessagesBetweenRefreshes = 10'000;  // as at 5,000 messages a second

/// A generator and the state it works on, with the traffic meant for it.
struct Receiver {
    std::string_view technology;
    std::vector<Bytes> messages;
    std::unique_ptr<LogGenerator> generator{};
    Dictionary state{};
    RecordLedger records{};
    RecordLedger::Arrival now{0};

    /// What the model does with a message.
    void update(const Bytes& message) {
        if (records.isFull()) records.forgetAllBut(state["Display"]);
        const ByteView packet = generator->takesPackets() ? RecordLedger::packetOf(message) : ByteView();
        const RecordLedger::Counted counted(records, packet, now += std::chrono::microseconds(200));
        generator->updateState(state, message);
    }
};

void decode(benchmark::State& state, bool logs, std::deque<Receiver>& receivers) {
    const DirectoryResources resources(KELVO_RESOURCE_DIR);
    std::optional<HostSystemLog> log;
    if (logs) log.emplace("kelvo", HostSystemLog::To::StandardError);
    const Environment::Scope environment({.log = logs ? &*log : nullptr, .resources = &resources});

    struct Step {
        Receiver* receiver;
        const Bytes* message;
    };
    for (Receiver& receiver : receivers) {
        receiver.generator = generatorFromTechnology(receiver.technology);
        // The display is there, and its lists have grown.
        for (const Bytes& message : receiver.messages) receiver.update(message);
    }
    std::vector<Step> steps;
    for (std::size_t i = 0, before = 1; steps.size() != before; ++i) {
        before = steps.size();
        for (Receiver& receiver : receivers) {
            if (i < receiver.messages.size()) steps.push_back({&receiver, &receiver.messages[i]});
        }
    }
    std::size_t next = 0;
    int sinceRefresh = 0;
    for (auto _ : state) {
        const auto& [receiver, message] = steps[next];
        receiver->update(*message);
        next = next + 1 < steps.size() ? next + 1 : 0;
        if (++sinceRefresh < kMessagesBetweenRefreshes) continue;
        state.PauseTiming();
        for (Receiver& refreshed : receivers) refreshed.generator->generateLogUsingState(refreshed.state);
        sinceRefresh = 0;
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations());
    for (Receiver& receiver : receivers) receiver.generator.reset();
}

using Receivers = std::vector<std::pair<std::string_view, std::vector<Bytes>>>;

void add(const std::string& name, const Receivers& receivers) {
    for (const bool logs : {false, true}) {
        const auto run = [=](benchmark::State& state) {
            std::deque<Receiver> made;
            for (const auto& [technology, messages] : receivers) made.emplace_back(technology, messages);
            decode(state, logs, made);
        };
        auto* added = benchmark::RegisterBenchmark((name + (logs ? " / log" : " / nowhere")).c_str(), run);
        if (const char* count = std::getenv("KELVO_BENCH_MESSAGES")) added->Iterations(std::atol(count));
    }
}

const bench::Traffic& traffic(const Family& family, std::string_view name) {
    for (const bench::Traffic& traffic : family.traffic) {
        if (traffic.name == name) return traffic;
    }
    std::abort();
}

}  // namespace

int main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    if (std::freopen("/dev/null", "w", stderr) == nullptr) return 1;
    const Family lte = bench::lteFamily();
    const Family gsm = bench::gsmFamily();
    add("LTE and GSM/UMTS / cells and registration (0xB0C1, 0xB0C2, 0xB179, 0x7130 to 0x7135)",
        {{lte.technology, traffic(lte, "cells (0xB0C1, 0xB0C2, 0xB179)").messages},
         {gsm.technology, traffic(gsm, "registration (0x7130 to 0x7135)").messages}});
    for (const Family& family : {lte, gsm, bench::cdmaFamily(), bench::utranFamily(), bench::ifxFamily()}) {
        for (const auto& [name, messages] : family.traffic) {
            add(family.name + " / " + name, {{family.technology, messages}});
        }
    }
    benchmark::RunSpecifiedBenchmarks();
}
