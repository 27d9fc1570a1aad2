#include "telephony/simulation/GSMUMTS/UmtsRecords.h"

#include <algorithm>
#include <cmath>

#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation::gsm {
namespace {

/// The searcher's energies: a ratio in units of 2^-19.
std::uint64_t energy(double dB) { return static_cast<std::uint64_t>(std::lround(524288 * std::pow(10, dB / 10))); }

/// The receiver's gain control counts tenths of a dB from 54.8 dB above its lowest level of -106 dBm.
long receivedPower(double dBm) { return std::lround((dBm + 106) * 10) - 512; }

/// The transmitter's counts tenths of a dB likewise, from -70 dBm; 0 means that it is off, so that -18.8 dBm is told
/// as its neighbor.
long transmittedPower(double dBm) {
    const long tenths = std::lround((dBm + 70) * 10) - 512;
    return tenths == 0 ? 1 : tenths;
}

}  // namespace

// clang-format off

Bytes searcherRecord(Time time, double rssi, std::span<const SearchedCell> cells) {
    constexpr double kSecondPath = -4;  // dB to the first
    constexpr double kThirdPath  = -8;
    RecordWriter record(time, 0x417a, 16 + (15 + 44) * cells.size());
    record
        .i16(13, receivedPower(rssi))
        .u8 (15, cells.size());
    std::size_t entry = 16;
    std::size_t paths = 16 + 15 * cells.size();
    for (const SearchedCell& cell : cells) {
        record
            .i8 (entry + 7, cell.scramblingCode & 0xff)
            .i8 (entry + 8, cell.scramblingCode >> 8 | static_cast<int>(cell.set) << 5)
            .u32(paths + 32, energy(cell.ecNo))
            .u32(paths + 36, energy(cell.ecNo + kSecondPath))
            .u32(paths + 40, energy(cell.ecNo + kThirdPath));
        entry += 15;
        paths += 44;
    }
    return record.finish();
}

// Both kinds of entries have their place at 15: a record holds the cells of one system only.
Bytes umtsRankingRecord(Time time, std::span<const RankedUmtsCell> cells) {
    RecordWriter record(time, 0x4005, 15);
    record
        .u8(13, cells.size())
        .u8(14, 0);
    std::size_t at = 15;
    for (const RankedUmtsCell& cell : cells) {
        record
            .i16(at + 0, kDownlinkUarfcn)
            .i16(at + 2, cell.scramblingCode)
            .i8 (at + 4, std::lround(cell.rscp) + 21)
            .i16(at + 5, std::lround(cell.rscp))
            .i8 (at + 7, std::lround(cell.ecNo * 2))
            .i16(at + 8, std::lround(cell.rank));
        at += 10;
    }
    return record.finish();
}

Bytes gsmRankingRecord(Time time, std::span<const RankedGsmCell> cells) {
    RecordWriter record(time, 0x4005, 15);
    record
        .u8(13, 0)
        .u8(14, cells.size());
    std::size_t at = 15;
    for (const RankedGsmCell& cell : cells) {
        record
            .i16(at + 0, cell.arfcn)
            .i16(at + 2, cell.bsic)
            .i8 (at + 4, std::lround(cell.level))
            .i16(at + 5, std::lround(cell.rank));
        at += 7;
    }
    return record.finish();
}

Bytes rrcStateRecord(Time time, RrcState state) {
    return RecordWriter(time, 0x4125, 14).i8(13, static_cast<int>(state)).finish();
}

Bytes rrcCellRecord(Time time, const UmtsCell& cell) {
    return RecordWriter(time, 0x4127, 29)
        .i32(13, kUplinkUarfcn)
        .i32(17, kDownlinkUarfcn)
        .i32(21, cell.cellId)
        .i16(25, cell.uraId)
        .finish();
}

Bytes cipheringRecord(Time time, bool isCiphered) {
    return RecordWriter(time, 0x4157, 19).u8(13, isCiphered).finish();
}

Bytes transmitPowerRecord(Time time, std::span<const std::optional<double>> slots) {
    RecordWriter record(time, 0x4031, 16 + 14 * slots.size());
    record.u8(14, slots.size());
    std::size_t at = 16;
    for (const auto& dBm : slots) {
        record.i16(at + 4, dBm ? transmittedPower(*dBm) : 0);
        at += 14;
    }
    return record.finish();
}

Bytes blockErrorsRecord(Time time, const BlockErrors& errors) {
    RecordWriter record(time, 0x4116, 16);
    record
        .u8 (13, errors.channels.size())
        .i16(14, errors.windowSize);
    std::size_t at = 16;
    for (const TransportChannel& channel : errors.channels) {
        record
            .i8 (at + 0, channel.id)
            .i32(at + 1, channel.received)
            .i32(at + 5, channel.inError);
        at += 9;
    }
    return record.finish();
}

namespace {

void writeProcesses(RecordWriter& record, std::size_t at, std::span<const HarqProcess> processes) {
    for (const HarqProcess& process : processes) {
        record
            .i8 (at + 0, process.id)
            .u32(at + 1, process.bits)
            .i16(at + 5, process.newTransmissions)
            .i16(at + 7, process.blockErrors);
        at += 9;
    }
}

}  // namespace

Bytes hsdpaRecord(Time time, const HsdpaReport& report) {
    constexpr int kVersion = 2;
    constexpr int kDualCarrier = 2;
    const std::size_t primaries = report.primary.size();
    RecordWriter record(time, 0x4221, 18);
    record
        .i8 (13, kVersion)
        .i16(14, report.subFrames | (report.hasTwoCarriers ? kDualCarrier << 10 : 0))
        .u8 (16, primaries)
        .u8 (17, report.secondary.size());
    writeProcesses(record, 18, report.primary);
    writeProcesses(record, 18 + 162 * primaries, report.secondary);
    return record.finish();
}

// clang-format on

}  // namespace kelvo::simulation::gsm
