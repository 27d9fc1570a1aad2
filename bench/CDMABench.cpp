#include <benchmark/benchmark.h>

#include <vector>

#include "LogGenerator/CDMA/C2KLogGenerator.h"
#include "bench/Decoding.h"
#include "tests/support/Record.h"
#include "tests/support/Subpackets.h"

namespace kelvo {
namespace {

using test::Record;
using test::Subpackets;

Record evdoStatus() { return Record(0x1183, 50).u8(13, 0x2C).u8(14, 3).u8(15, 0xB5).u8(36, 5).u8(37, 4).u16(18, 168); }

Record fingers() {
    Record record = Record(0x108a, 23 + 14 * 6).u8(22, 6);
    for (std::uint32_t i = 0; i < 6; ++i)
        record.u16(23 + 14 * i, i < 4 ? 168 + i : 65535).u16(29 + 14 * i, 90 + 70 * i);
    return record;
}

Record activeSetPilots() {
    Record record = Record(0x12b6, 25 + 12 * 3).u8(15, 3);
    for (std::uint32_t i = 0; i < 3; ++i) record.u16(25 + 12 * i, 168 + i).u16(27 + 12 * i, 90 + 70 * i);
    return record;
}

Record status1x() {
    Subpackets packet = Subpackets(0x119c).add(1, 8).u8(4, 8).add(2, 16).u8(10, 0x9C).u8(11, 0x98).u16(12, 235);
    packet.add(3, 12 + 3 * 20).u16(4, 4).u8(6, 8).u8(7, 3).u8(8, 3).u8(9, 1).u16(10, 168);
    for (std::uint32_t i = 0; i < 3; ++i) packet.u16(12 + 20 * i, 168 + i).u16(28 + 20 * i, 72 + 50 * i);
    return packet.add(4, 40);
}

Record trafficFrame() { return Subpackets(0x119d).add(3, 9).add(11, 25); }

Record forwardRate(std::uint32_t seq) { return Record(0x1192, 241).u32(13, seq).u32(29, seq * 600); }
Record reverseRate(std::uint32_t seq) { return Record(0x127e, 1750).u32(14, seq).u32(18 + 96, seq * 150); }

Record identification() { return Record(0x134f, 200).u8(13, 2).u32(42, 1).u32(46, 2).u16(50, 4139).u16(52, 17); }

/// What a phone in a call sends within about a second: mostly frames and levels, now and then the rest.
std::vector<Bytes> plausibleMix() {
    std::vector<Bytes> messages;
    for (std::uint32_t i = 0; i < 10; ++i) {
        for (int frame = 0; frame < 5; ++frame) messages.push_back(trafficFrame().bytes());
        for (const Record& record : {evdoStatus(), fingers(), activeSetPilots(), status1x()}) {
            messages.push_back(record.bytes());
        }
        messages.push_back(forwardRate(i).bytes());
        messages.push_back(reverseRate(i).bytes());
    }
    messages.push_back(identification().bytes());
    return messages;
}

void BM_PlausibleMix(benchmark::State& state) { bench::decode<C2KLogGenerator>(state, plausibleMix()); }
BENCHMARK(BM_PlausibleMix);

void BM_FingerC2I(benchmark::State& state) { bench::decode<C2KLogGenerator>(state, {fingers().bytes()}); }
BENCHMARK(BM_FingerC2I);
void BM_EVDOStatus(benchmark::State& state) { bench::decode<C2KLogGenerator>(state, {evdoStatus().bytes()}); }
BENCHMARK(BM_EVDOStatus);
void BM_ForwardDataRate(benchmark::State& state) {
    bench::decode<C2KLogGenerator>(state, {forwardRate(1).bytes(), forwardRate(2).bytes()});
}
BENCHMARK(BM_ForwardDataRate);
void BM_ActiveSetPilots(benchmark::State& state) { bench::decode<C2KLogGenerator>(state, {activeSetPilots().bytes()}); }
BENCHMARK(BM_ActiveSetPilots);
void BM_1xStatus(benchmark::State& state) { bench::decode<C2KLogGenerator>(state, {status1x().bytes()}); }
BENCHMARK(BM_1xStatus);
void BM_TrafficFER(benchmark::State& state) { bench::decode<C2KLogGenerator>(state, {trafficFrame().bytes()}); }
BENCHMARK(BM_TrafficFER);
void BM_ReverseDataRate(benchmark::State& state) {
    bench::decode<C2KLogGenerator>(state, {reverseRate(1).bytes(), reverseRate(2).bytes()});
}
BENCHMARK(BM_ReverseDataRate);
void BM_SystemIdentification(benchmark::State& state) {
    bench::decode<C2KLogGenerator>(state, {identification().bytes()});
}
BENCHMARK(BM_SystemIdentification);

}  // namespace
}  // namespace kelvo
