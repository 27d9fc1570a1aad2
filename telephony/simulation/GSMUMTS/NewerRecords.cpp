#include "telephony/simulation/GSMUMTS/NewerRecords.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation::gsm {
namespace {

constexpr std::size_t P = RecordWriter::kHeader;  // where the payload begins
constexpr std::uint64_t kBand = 8 << 12;          // above an ARFCN of 12 bits; that of the primary GSM 900 band

std::uint64_t withBand(Arfcn arfcn) { return static_cast<std::uint64_t>(arfcn) | kBand; }

/// 3GPP TS 45.008, section 8.1.4.
std::uint64_t level(double dBm) { return static_cast<std::uint64_t>(std::clamp(std::floor(dBm) + 111, 0.0, 63.0)); }

/// Version 2 has five bytes more in front of its lists.
template <int version>
constexpr std::size_t kListsAt = P + (version == 2 ? 7 : 2);

// clang-format off

template <int version>
Bytes umtsRanking(Time time, std::span<const RankedUmtsCell> cells) {
    constexpr std::size_t size = version == 2 ? 16 : 11;
    RecordWriter record(time, 0x4005, kListsAt<version> + size * cells.size());
    record.u8(P, cells.size() | version << 6);
    std::size_t at = kListsAt<version>;
    for (const RankedUmtsCell& cell : cells) {
        record
            .u16(at + 0, kDownlinkUarfcn)
            .u16(at + 2, cell.scramblingCode)
            .i8 (at + 4, std::lround(cell.rscp) + 21)
            .i16(at + 5, std::lround(cell.rscp))
            .i8 (at + 7, std::lround(cell.ecNo * 2))
            .i16(at + 8, std::lround(cell.rank));
        at += size;
    }
    return record.finish();
}

template <int version>
Bytes gsmRanking(Time time, std::span<const RankedGsmCell> cells) {
    constexpr std::size_t size = version == 2 ? 13 : 8;
    RecordWriter record(time, 0x4005, kListsAt<version> + size * cells.size());
    record.u8(P, version << 6).u8(P + 1, cells.size());
    std::size_t at = kListsAt<version>;
    for (const RankedGsmCell& cell : cells) {
        record
            .u16(at + 0, withBand(cell.arfcn))
            .u16(at + 2, cell.bsic)
            .i8 (at + 4, std::lround(cell.level))
            .i16(at + 5, std::lround(cell.rank));
        at += size;
    }
    return record.finish();
}

Bytes longRrcCell(Time time, const UmtsCell& cell) {
    return RecordWriter(time, 0x4127, P + 32)
        .u32(P +  0, kUplinkUarfcn)
        .u32(P +  4, kDownlinkUarfcn)
        .i32(P +  8, cell.cellId)
        .i16(P + 12, cell.uraId)
        .u16(P + 16, kMcc)  // behind what the short one has
        .u16(P + 20, kMnc)
        .finish();
}

Bytes extendedMeasurement(Time time, const GsmMeasurement& measurement) {
    constexpr std::size_t serving = 26;
    constexpr std::size_t neighbors = 25;
    RecordWriter record(time, 0x51FC, P + serving + neighbors * measurement.neighbors.size());
    record
        .u16(P +  0, kBand)
        .u8 (P +  5, level(measurement.level))
        .i32(P +  6, std::lround(measurement.c1))
        .i32(P + 10, std::lround(measurement.c2))
        .u8 (P + 24, measurement.isHysteresisApplied)
        .u8 (P + 25, measurement.neighbors.size());
    std::size_t at = P + serving;
    for (const GsmNeighbor& neighbor : measurement.neighbors) {
        record
            .u16(at + 0, withBand(neighbor.arfcn))
            .u8 (at + 5, level(neighbor.level))
            .i32(at + 6, std::lround(neighbor.c1));
        at += neighbors;
    }
    return record.finish();
}

// clang-format on

/// Packed as on the air (3GPP TS 24.008, 10.5.1.13).
void writePlmn(RecordWriter& record, std::size_t at, const Plmn& plmn) {
    const int mcc[] = {plmn.mcc / 100, plmn.mcc / 10 % 10, plmn.mcc % 10};
    const bool hasThree = plmn.mnc > 99;
    const int mnc[] = {hasThree ? plmn.mnc / 100 : plmn.mnc / 10, hasThree ? plmn.mnc / 10 % 10 : plmn.mnc % 10,
                       hasThree ? plmn.mnc % 10 : 15};
    record.u8(at, static_cast<std::uint64_t>(mcc[1] << 4 | mcc[0]))
        .u8(at + 1, static_cast<std::uint64_t>(mnc[2] << 4 | mcc[2]))
        .u8(at + 2, static_cast<std::uint64_t>(mnc[1] << 4 | mnc[0]));
}

/// Five places, of which the first are filled.
Bytes networkList(Time time, std::span<const Plmn> plmns) {
    constexpr std::size_t kPlaces = 5;
    const Bytes empty(3 * kPlaces, 0xFF);
    RecordWriter record(time, 0x7150, P + 4 + empty.size());
    writePlmn(record, P, {kMcc, kMnc});
    record.u8(P + 3, std::min(plmns.size(), kPlaces)).bytes(P + 4, empty);
    for (std::size_t i = 0; i < std::min(plmns.size(), kPlaces); ++i) writePlmn(record, P + 4 + 3 * i, plmns[i]);
    return record.finish();
}

constexpr std::array<Wording, 3> kWordings = {{
    {umtsRankingRecord, gsmRankingRecord, rrcCellRecord, measurementRecord, equivalentPlmnsRecord, false},
    {umtsRanking<1>, gsmRanking<1>, longRrcCell, extendedMeasurement, networkList, false},
    {umtsRanking<2>, gsmRanking<2>, longRrcCell, extendedMeasurement, networkList, true},
}};

}  // namespace

const Wording& wordingOf(Generation generation) { return kWordings[static_cast<std::size_t>(generation)]; }

Bytes ofFirstSim(Bytes message) {
    constexpr std::size_t kPrefix = 2;
    constexpr std::size_t kLength = kPrefix + 1;  // and the code two bytes behind it
    const auto add = [&message](std::size_t at, int what) {
        const int sum = (message[at] | message[at + 1] << 8) + what;
        message[at] = static_cast<std::uint8_t>(sum);
        message[at + 1] = static_cast<std::uint8_t>(sum >> 8);
    };
    const bool isGsm =
        message[kPrefix] == 1 && message[kLength + 3] >> 4 == 5;  // the equipment: bits 12-15 of the code
    if (!isGsm) return message;
    add(kLength, 1);
    add(kLength + 2, 0xA00);
    message.insert(message.begin() + static_cast<std::ptrdiff_t>(kPrefix + P), 0);
    return message;
}

}  // namespace kelvo::simulation::gsm
