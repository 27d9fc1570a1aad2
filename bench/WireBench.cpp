// What a modem's stream costs: frames, checksums and records handed over, in reads of 64 KiB.
//
// The stream is a simulated LTE drive behind the diagnostic protocol, or the file that KELVO_BENCH_FRAMES names.
#include <benchmark/benchmark.h>

#include <cstdlib>
#include <fstream>
#include <iterator>

#include "LogGenerator/Framing.h"
#include "telephony/simulation/MakeSimulation.h"
#include "telephony/wire/FrameWriter.h"
#include "telephony/wire/RecordConfiguration.h"
#include "telephony/wire/RecordFrame.h"
#include "telephony/wire/Session.h"

namespace {

using namespace kelvo;
using namespace std::chrono_literals;

constexpr std::size_t kStreamSize = std::size_t{16} << 20;
constexpr std::size_t kDrive = std::size_t{1} << 18;  // repeated: simulating takes longer than reading
constexpr std::size_t kRead = 65'536;

Bytes simulated() {
    const auto modem = simulation::makeSimulation(Technology::LTE, 1);
    Bytes stream;
    while (stream.size() < kDrive) {
        const Bytes message = modem->next().bytes;
        const ByteView packet = stripPrefix(message);
        if (packet[0] == 1) wire::appendFrame(stream, wire::recordBody(0, packet.subspan(1)));
    }
    return stream;
}

Bytes stream() {
    const char* const path = std::getenv("KELVO_BENCH_FRAMES");
    Bytes frames;
    if (path == nullptr) {
        frames = simulated();
    } else {
        std::ifstream file(path, std::ios::binary);
        frames.assign(std::istreambuf_iterator<char>(file), {});
    }
    Bytes all;
    while (all.size() < kStreamSize && !frames.empty()) all.insert(all.end(), frames.begin(), frames.end());
    return all;
}

template <class Take>
void inReads(wire::MutableBytes bytes, Take take) {
    for (std::size_t at = 0; at < bytes.size(); at += kRead)
        take(bytes.subspan(at, std::min(kRead, bytes.size() - at)));
}

// The reader writes to what it reads: each pass has a fresh copy, made outside the time.
template <class Pass>
void measure(benchmark::State& state, Pass pass) {
    const Bytes original = stream();
    std::size_t records = 0;
    for (auto _ : state) {
        state.PauseTiming();
        Bytes bytes = original;
        state.ResumeTiming();
        records += pass(bytes);
    }
    state.SetBytesProcessed(static_cast<std::int64_t>(state.iterations() * original.size()));
    state.SetItemsProcessed(static_cast<std::int64_t>(records));
}

void BM_FramesAndChecksums(benchmark::State& state) {
    measure(state, [](wire::MutableBytes bytes) {
        wire::FrameReader reader;
        inReads(bytes, [&](wire::MutableBytes input) {
            while (const auto body = reader.next(input)) benchmark::DoNotOptimize(body->data());
        });
        return reader.counts().frames;
    });
}
BENCHMARK(BM_FramesAndChecksums)->Unit(benchmark::kMillisecond);

/// Takes every record.
struct Taker final : wire::Session::Owner {
    void sendToModem(ByteView) override {}
    wire::Session::Taken takeRecord(ByteView packet, std::uint64_t) override {
        benchmark::DoNotOptimize(packet.data());
        return wire::Session::Taken::Delivered;
    }
};

// A modem that has everything, and agrees to every mask.
void start(wire::Session& session, std::chrono::nanoseconds& now) {
    const auto say = [&session](ByteView body) {
        Bytes frame = wire::frameOf(body);
        session.receive(frame);
    };
    session.begin("bench");
    now += 200ms;
    session.tick();
    say(Bytes(47));
    Bytes build(20);
    build[0] = 0x7C;
    say(build);
    wire::Ranges ranges;
    ranges.fill(4096);
    say(wire::configurationAnswer(wire::Operation::Ranges, 0, wire::rangesData(ranges)));
    for (std::uint32_t id = 0; id < wire::kEquipmentIds; ++id)
        say(wire::configurationAnswer(wire::Operation::SetMask, 0, wire::maskData(wire::LogMask(id, 4096))));
}

void BM_RecordsHandedOver(benchmark::State& state) {
    measure(state, [](wire::MutableBytes bytes) {
        Taker taker;
        std::chrono::nanoseconds now = 1000s;
        wire::Session session(taker, [&now] { return now; }, {.technology = Technology::LTE, .subscription = {}});
        start(session, now);
        inReads(bytes, [&](wire::MutableBytes input) { session.receive(input); });
        return session.counts().delivered;
    });
}
BENCHMARK(BM_RecordsHandedOver)->Unit(benchmark::kMillisecond);

}  // namespace

BENCHMARK_MAIN();
