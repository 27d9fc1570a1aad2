#include "telephony/simulation/GSMUMTS/Records.h"

#include <algorithm>
#include <cmath>

#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation::gsm {
namespace {

constexpr int kUpdated = 0;
constexpr int kNotUpdated = 1;
constexpr int kAutomatic = 0;

/// 3GPP TS 45.008, section 8.1.4: 0 is below -110 dBm, 63 is -48 dBm and above.
int rxLev(double dBm) { return std::clamp(static_cast<int>(std::floor(dBm)) + 111, 0, 63); }

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

// clang-format off

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

// Mobility management.

Bytes packetStateRecord(Time time, const Mobility& mobility) {
    return RecordWriter(time, 0x7130, 16)
        .i8(13, static_cast<int>(mobility.gmm))
        .i8(14, static_cast<int>(mobility.gmmSub))
        .i8(15, mobility.isRoutingUpdated ? kUpdated : kNotUpdated)
        .finish();
}

Bytes circuitStateRecord(Time time, const Mobility& mobility) {
    return RecordWriter(time, 0x7131, 16)
        .i8(13, static_cast<int>(mobility.mm))
        .i8(14, static_cast<int>(mobility.mmSub))
        .i8(15, mobility.isLocationUpdated ? kUpdated : kNotUpdated)
        .finish();
}

Bytes registrationRecord(Time time, const Mobility& mobility) {
    return RecordWriter(time, 0x7132, 16)
        .i8(13, static_cast<int>(mobility.registration))
        .i8(14, kAutomatic)
        .finish();
}

Bytes servingNetworkRecord(Time time, const ServingNetwork& network) {
    constexpr int kFiller = 0xf;  // in the place of a third digit of the network code
    const int mcc[] = {kMcc / 100, kMcc / 10 % 10, kMcc % 10};
    const int mnc[] = {kMnc / 10, kMnc % 10, kFiller};
    return RecordWriter(time, 0x7135, 32)
        .i8(13, network.operationMode)
        .i8(14, static_cast<int>(network.service))
        .i8(15, mcc[1] << 4 | mcc[0])
        .i8(16, mnc[2] << 4 | mcc[2])
        .i8(17, mnc[1] << 4 | mnc[0])
        .i8(18, network.area.lac >> 8)  // big-endian, as on the air
        .i8(19, network.area.lac & 0xff)
        .i8(20, network.area.rac)
        .finish();
}

Bytes equivalentPlmnsRecord(Time time, std::span<const Plmn> plmns) {
    RecordWriter record(time, 0x7150, 17);
    record.u8(16, plmns.size());
    std::size_t at = 17;
    for (const Plmn& plmn : plmns) {
        record
            .i8(at + 0, plmn.mcc / 100)
            .i8(at + 1, plmn.mnc / 100)
            .i8(at + 2, plmn.mcc / 10 % 10)
            .i8(at + 3, plmn.mnc / 10 % 10)
            .i8(at + 4, plmn.mcc % 10)
            .i8(at + 5, plmn.mnc % 10);
        at += 3;
    }
    return record.finish();
}

// GSM.

Bytes servingCellRecord(Time time, const GsmCell& cell) {
    return RecordWriter(time, 0x5134, 26)
        .u16(13, static_cast<unsigned>(cell.arfcn))
        .u16(15, static_cast<unsigned>(cell.bsic))
        .u16(17, static_cast<unsigned>(cell.cellId))
        .finish();
}

Bytes measurementRecord(Time time, const GsmMeasurement& measurement) {
    RecordWriter record(time, 0x5137, 29 + 14 * measurement.neighbors.size());
    record
        .i8 (15, rxLev(measurement.level))
        .i32(16, std::lround(measurement.c1))
        .i32(20, std::lround(measurement.c2))
        .u8 (26, measurement.isHysteresisApplied)
        .u8 (28, measurement.neighbors.size());
    std::size_t at = 29;
    for (const GsmNeighbor& neighbor : measurement.neighbors) {
        record
            .i16(at + 0, neighbor.arfcn)
            .i8 (at + 2, rxLev(neighbor.level))
            .i32(at + 3, std::lround(neighbor.c1));
        at += 14;
    }
    return record.finish();
}

Bytes decodedCellsRecord(Time time, std::span<const GsmNeighbor> neighbors) {
    RecordWriter record(time, 0x51ff, 15);
    record.u8(14, neighbors.size());
    std::size_t at = 15;
    for (const GsmNeighbor& neighbor : neighbors) {
        record
            .i16(at + 0, neighbor.arfcn)
            .i8 (at + 2, neighbor.bsic)
            .u8 (at + 3, 0);
        at += 4;
    }
    return record.finish();
}

Bytes rrStatusRecord(Time time, const RrStatus& status) {
    return RecordWriter(time, 0x512c, 17)
        .i8(13, static_cast<int>(status.state))
        .i8(14, status.subState)
        .i8(15, status.status)
        .u8(16, status.isData)
        .finish();
}

Bytes dedicatedCarrierRecord(Time time, Arfcn arfcn) {
    return RecordWriter(time, 0x5076, 17).i16(13, arfcn).finish();
}

Bytes channelModeRecord(Time time, bool isDtxUsed) {
    return RecordWriter(time, 0x5072, 20).u8(19, isDtxUsed).finish();
}

Bytes mobileAllocationRecord(Time time, const GsmCell& cell) {
    RecordWriter record(time, 0x51f8, 15);
    record
        .i8(13, cell.hoppingSequence)
        .u8(14, cell.mobileAllocation.size());
    std::size_t at = 15;
    for (const Arfcn arfcn : cell.mobileAllocation) {
        record.i16(at, arfcn);
        at += 2;
    }
    return record.finish();
}

Bytes si13PositionRecord(Time time, const GprsOptions& options) {
    return RecordWriter(time, 0x51f4, 15).u8(14, options.isSi13OnExtendedBcch).finish();
}

Bytes si13Record(Time time, const GprsOptions& options) {
    return RecordWriter(time, 0x51f5, 18)
        .u8(13, options.hasPacketFlowContexts)
        .i8(14, options.priorityAccessThreshold)
        .i8(15, options.networkControlOrder)
        .finish();
}

Bytes cellOptionsRecord(Time time, const GprsOptions& options) {
    return RecordWriter(time, 0x51f6, 24)
        .i8(15, options.t3192)
        .i8(16, options.drxTimerMax)
        .u8(17, options.longAccessBursts)
        .finish();
}

Bytes pbcchRecord(Time time, const GprsOptions& options) {
    return RecordWriter(time, 0x51fb, 34).u8(13, options.hasPbcch).finish();
}

Bytes packetStatusRecord(Time time, const GprsOptions& options) {
    return RecordWriter(time, 0x51fd, 35)
        .u8(13, options.hasPbcch)  // the PSI status is asked for on a PBCCH
        .i8(14, options.psiCountLow)
        .i8(15, options.psiCountHigh)
        .u8(16, options.hasExtendedMeasurementOrder)
        .u8(33, options.hasPacketSystemInformation)
        .finish();
}

// UMTS.

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
