#include <algorithm>

#include "bench/BinaryEncoder.h"
#include "bench/Families.h"
#include "platform/encodings/PropertyList.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo::bench {
namespace {

constexpr std::uint32_t kVariants = 32;

Bytes servingAndNeighbors(std::uint32_t i, std::uint32_t neighbors) {
    Record record(0x5137, 29 + neighbors * 14);
    record.u8(15, 60 + i).u32(16, 21 + i).u32(20, 24 + i).u8(28, neighbors);
    for (std::uint32_t j = 0; j < neighbors; ++j)
        record.u16(29 + 14 * j, 512 + j).u8(31 + 14 * j, 40 + (i + j) % 60).u32(32 + 14 * j, i * j);
    return record.bytes();
}

Bytes identities(std::uint32_t i, std::uint32_t neighbors) {
    Record record(0x51ff, 15 + neighbors * 4);
    record.u8(14, neighbors);
    for (std::uint32_t j = 0; j < neighbors; ++j) record.u16(15 + 4 * j, 512 + j).u8(17 + 4 * j, (i + j) % 64);
    return record.bytes();
}

Bytes searcher(std::uint32_t i, std::uint32_t cells, std::uint32_t active) {
    Record record(0x417a, 16 + cells * (15 + 44));
    record.u16(13, static_cast<std::uint32_t>(-700) + i).u8(15, cells);
    for (std::uint32_t j = 0; j < cells; ++j) {
        record.u16(16 + 15 * j + 7, (300 + j) | (j < active ? 0U : 1U) << 13);
        record.u32(16 + 15 * cells + 44 * j + 32, 90000 + 900 * i - 9000 * j);
    }
    return record.bytes();
}

Bytes ranking(std::uint32_t i, std::uint32_t umts, std::uint32_t gsm) {
    Record record(0x4005, 15 + std::max(umts * 10, gsm * 7));
    record.u8(13, umts).u8(14, gsm);
    for (std::uint32_t j = 0; j < umts; ++j) {
        record.u16(15 + 10 * j, 10562).u16(17 + 10 * j, 300 + j).u8(19 + 10 * j, 180 + (i + j) % 60);
        record.u8(22 + 10 * j, 200 + (i + 3 * j) % 50);
    }
    return record.bytes();
}

Bytes cellArray(std::uint32_t i) {  // 7 cells
    const ArrayRef cells = Array::make();
    for (std::uint32_t j = 0; j < 7; ++j) {
        cells->append(Dictionary::make({
            {kPLCellMonitorCellRadioAccessTechnology,
             j < 4 ? kPLCellMonitorRadioAccessTechnologyUMTS : kPLCellMonitorRadioAccessTechnologyGSM},
            {kPLCellMonitorCellType, j == 0 ? kPLCellMonitorCellTypeServing : kPLCellMonitorCellTypeNeighbor},
            {kPLCellMonitorMCC, 262},
            {kPLCellMonitorMNC, 1},
            {kPLCellMonitorLAC, 4566},
            {kPLCellMonitorCellId, std::int64_t{27447296} + j},
            {kPLCellMonitorARFCN, std::int64_t{512} + j},
            {kPLCellMonitorUARFCN, 10562},
            {kPLCellMonitorSCN, std::int64_t{300} + j},
            {kPLCellMonitorRSSI, std::int64_t{-50} - (i + j) % 30},
            {kPLCellMonitorRSCP, std::int64_t{-98} - (i + j) % 20},
            {kPLCellMonitorECN0, -11},
        }));
    }
    return withPayload(0xff0001, BinaryEncoder().encode(cells));
}

Bytes packetService(std::uint32_t i) { return Record(0x7130, 16).u8(13, i % 7).u8(14, i % 13).u8(15, i % 4).bytes(); }
Bytes circuitService(std::uint32_t i) { return Record(0x7131, 16).u8(13, 17 + i % 5).u8(14, i % 9).bytes(); }
Bytes registration(std::uint32_t i) { return Record(0x7132, 16).u8(13, i % 7).u8(14, i % 5).bytes(); }
Bytes network(std::uint32_t i) {
    return Record(0x7135, 32)
        .u8(13, i % 3)
        .u8(14, i % 5)
        .u8(15, 0x62)
        .u8(16, 0xF2)
        .u8(17, 0x10)
        .u16(18, 0xD611)
        .bytes();
}

Bytes downlink(std::uint32_t processes) {
    Record record(0x4221, 18 + 162 * processes + 9 * processes);
    record.u8(13, 2).u16(14, 2 << 10 | 200).u8(16, processes).u8(17, processes);
    for (std::uint32_t j = 0; j < 2 * processes; ++j) {
        const std::size_t at = j < processes ? 18 + 9 * j : 18 + 162 * processes + 9 * (j - processes);
        record.u8(at, j).u32(at + 1, 123456 * j).u16(at + 5, 100 + j).u16(at + 7, j);
    }
    return record.bytes();
}

Bytes blockErrors(std::uint32_t channels) {
    Record record(0x4116, 16 + 9 * channels);
    record.u8(13, channels).u16(14, 100);
    for (std::uint32_t j = 0; j < channels; ++j) record.u8(16 + 9 * j, j).u32(17 + 9 * j, 1000 * j).u32(21 + 9 * j, j);
    return record.bytes();
}

Bytes hopping(std::uint32_t channels) {
    Record record(0x51f8, 15 + 2 * channels);
    record.u8(13, 7).u8(14, channels);
    for (std::uint32_t j = 0; j < channels; ++j) record.u16(15 + 2 * j, 512 + j);
    return record.bytes();
}

Bytes equivalentNetworks(std::uint32_t networks) {
    Record record(0x7150, 17 + 3 * networks + 3);
    record.u8(16, networks);
    for (std::uint32_t j = 0; j < 3 * networks; ++j) record.u8(17 + j, j % 10);
    return record.bytes();
}

Bytes simFiles() {
    const DictionaryRef files = Dictionary::make();
    for (const char* file : {"ICCID", "MSISDN", "MBDN", "HPPLMN", "LOCI", "PSLOCI", "ACC", "AD", "FPLMN", "AHPLMN",
                             "RATMODE", "PNN", "OPL", "OPLMNAcT"}) {
        files->set(std::string("kSimFile_") + file, "98 94 02 10 32 54 76 98 10 32");
    }
    return withPayload(0xff0000, *writeXmlPropertyList(files));
}

}  // namespace

Family gsmFamily() {
    const std::vector<std::vector<Bytes>> states = {vary(kVariants, packetService), vary(kVariants, circuitService),
                                                    vary(kVariants, registration), vary(kVariants, network)};
    std::vector<std::vector<Bytes>> kinds = states;
    kinds.push_back(vary(kVariants, [](std::uint32_t i) { return servingAndNeighbors(i, 6); }));
    kinds.push_back(vary(kVariants, [](std::uint32_t i) { return searcher(i, 8, 3); }));
    kinds.push_back(vary(kVariants, [](std::uint32_t i) { return ranking(i, 6, 4); }));
    const auto cells = vary(kVariants, cellArray);
    kinds.push_back(cells);
    return {"GSM/UMTS",
            kPLLogChannelTechnology_Oskra_GSM,
            {{"mix", interleave(kinds)},
             {"registration (0x7130 to 0x7135)", interleave(states)},
             {"cell array of 7 cells", cells}}};
}

std::vector<Bytes> fullestGSMScreen() {
    std::vector<Bytes> messages = gsmFamily().traffic.front().messages;
    for (const Bytes& full : {identities(0, 32), servingAndNeighbors(0, 32), searcher(0, 32, 8), ranking(0, 32, 32),
                              downlink(8), blockErrors(8), hopping(64), equivalentNetworks(15), simFiles()}) {
        messages.push_back(full);
    }
    return messages;
}

}  // namespace kelvo::bench
