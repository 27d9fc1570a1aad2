#include "telephony/simulation/GSMUMTS/GsmRecords.h"

#include <algorithm>
#include <cmath>

#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation::gsm {
namespace {

/// 3GPP TS 45.008, section 8.1.4: 0 is below -110 dBm, 63 is -48 dBm and above.
int rxLev(double dBm) { return std::clamp(static_cast<int>(std::floor(dBm)) + 111, 0, 63); }

}  // namespace

// clang-format off

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

Bytes dedicatedCarrierRecord(Time time, int arfcn) {
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
    for (const int arfcn : cell.mobileAllocation) {
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

// clang-format on

}  // namespace kelvo::simulation::gsm
