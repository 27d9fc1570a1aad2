// Records of a GSM/UMTS modem through the generator, onto the screens of the real template.

#include <benchmark/benchmark.h>

#include <cstdint>
#include <vector>

#include "LogGenerator/GSMUMTS/OSK_GSMLogGenerator.h"
#include "bench/BinaryEncoder.h"
#include "platform/DirectoryResources.h"
#include "platform/Environment.h"
#include "platform/TelephonyConstants.h"
#include "tests/support/Record.h"

namespace {

using namespace kelvo;
using test::Record;

constexpr int kRecordsBetweenRefreshes = 20000;

Record servingAndNeighbours() {  // 6 neighbours
    Record record(0x5137, 29 + 6 * 14);
    record.u8(15, 60).u32(16, 21).u32(20, 24).u8(28, 6);
    for (std::uint32_t i = 0; i < 6; ++i) record.u16(29 + 14 * i, 512 + i).u8(31 + 14 * i, 40 + i).u32(32 + 14 * i, i);
    return record;
}

Record searcher() {  // 8 cells, 3 of them in the active set
    Record record(0x417a, 16 + 8 * (15 + 44));
    record.u16(13, static_cast<std::uint32_t>(-700)).u8(15, 8);
    for (std::uint32_t i = 0; i < 8; ++i) {
        record.u16(16 + 15 * i + 7, (300 + i) | (i < 3 ? 0U : 1U) << 13).u32(136 + 44 * i + 32, 90000 - 9000 * i);
    }
    return record;
}

Record ranking() {  // 6 UMTS and 4 GSM cells
    Record record(0x4005, 15 + 6 * 10);
    record.u8(13, 6).u8(14, 4);
    for (std::uint32_t i = 0; i < 6; ++i) {
        record.u16(15 + 10 * i, 10562).u16(17 + 10 * i, 300 + i).u8(19 + 10 * i, 180 + i).u8(22 + 10 * i, 240 + i);
    }
    return record;
}

Record cellArray() {  // 7 cells
    const ArrayRef cells = Array::make();
    for (int i = 0; i < 7; ++i) {
        cells->append(Dictionary::make({
            {kPLCellMonitorCellRadioAccessTechnology,
             i < 4 ? kPLCellMonitorRadioAccessTechnologyUMTS : kPLCellMonitorRadioAccessTechnologyGSM},
            {kPLCellMonitorCellType, i == 0 ? kPLCellMonitorCellTypeServing : kPLCellMonitorCellTypeNeighbor},
            {kPLCellMonitorMCC, 262},
            {kPLCellMonitorMNC, 1},
            {kPLCellMonitorLAC, 4566},
            {kPLCellMonitorCellId, 27447296 + i},
            {kPLCellMonitorARFCN, 512 + i},
            {kPLCellMonitorUARFCN, 10562},
            {kPLCellMonitorSCN, 300 + i},
            {kPLCellMonitorRSSI, -50 - i},
            {kPLCellMonitorRSCP, -98 - i},
            {kPLCellMonitorECN0, -11},
        }));
    }
    Record record(0xff0001, 13);
    const Bytes payload = bench::BinaryEncoder().encode(cells);
    for (std::size_t i = 0; i < payload.size(); ++i) record.u8(13 + i, payload[i]);
    return record;
}

std::vector<Record> registration() {
    return {Record(0x7130, 16).u8(13, 3), Record(0x7131, 16).u8(13, 19).u8(14, 8), Record(0x7132, 16).u8(13, 1),
            Record(0x7135, 32).u8(14, 3).u8(15, 0x62).u8(16, 0xF2).u8(17, 0x10).u16(18, 0xD611)};
}

/// The records in turn, one an iteration; the generator's raw log is emptied now and then, as each refresh does.
void decode(benchmark::State& state, const std::vector<Record>& records) {
    const DirectoryResources resources{KELVO_RESOURCE_DIR};
    const Environment::Scope environment({.resources = &resources});
    OSK_GSMLogGenerator generator;
    Dictionary display;
    std::size_t next = 0;
    int sinceRefresh = 0;
    for (auto _ : state) {
        generator.updateState(display, records[next].bytes());
        next = next + 1 < records.size() ? next + 1 : 0;
        if (++sinceRefresh < kRecordsBetweenRefreshes) continue;
        state.PauseTiming();
        generator.generateLogUsingState(display);
        sinceRefresh = 0;
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations());  // records
}

void BM_Neighbours(benchmark::State& state) { decode(state, {servingAndNeighbours()}); }
BENCHMARK(BM_Neighbours);

void BM_Searcher(benchmark::State& state) { decode(state, {searcher()}); }
BENCHMARK(BM_Searcher);

void BM_Ranking(benchmark::State& state) { decode(state, {ranking()}); }
BENCHMARK(BM_Ranking);

void BM_Registration(benchmark::State& state) { decode(state, registration()); }
BENCHMARK(BM_Registration);

void BM_CellArray(benchmark::State& state) { decode(state, {cellArray()}); }
BENCHMARK(BM_CellArray);

void BM_Mix(benchmark::State& state) {
    std::vector<Record> records = registration();
    for (const Record& record : {servingAndNeighbours(), searcher(), ranking(), cellArray()}) records.push_back(record);
    decode(state, records);
}
BENCHMARK(BM_Mix);

}  // namespace
