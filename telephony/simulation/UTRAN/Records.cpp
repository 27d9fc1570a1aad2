#include "telephony/simulation/UTRAN/Records.h"

#include <algorithm>
#include <cmath>

#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation::utran {
namespace {

int floorStep(double value, double lowest, double step, int last) {
    return static_cast<int>(std::clamp(std::floor((value - lowest) / step) + 1, 0.0, static_cast<double>(last)));
}

}  // namespace

int rscpLevel(double dBm) { return floorStep(dBm, -115, 1, 91); }

int blerLevel(double share) {
    return share > 0 ? std::max(floorStep(std::log10(share), -4.03 - 0.065, 0.065, 63), 1) : 0;
}

int sirLevel(double dB) { return floorStep(dB, -11, 0.5, 63); }

Bytes rrcStateRecord(Time time, RrcState state) {
    return RecordWriter(time, 0xD0E0, 15)
        .u8(13, 1)  // the state is known
        .u8(14, static_cast<std::uint64_t>(state))
        .finish();
}

Bytes servingCellRecord(Time time, const Modem& modem) {
    const Cell& cell = modem.serving();
    return RecordWriter(time, 0xD0E2, 26)
        .u8(14, cell.barredClasses)
        .u8(15, cell.registrationArea)
        .u16(17, cell.uarfcn)  // uplink
        .u16(19, cell.uarfcn)  // downlink
        .u32(21, cell.identity)
        .u8(25, modem.isRegistered() ? 0 : 1)  // bit 0: emergency calls only
        .finish();
}

Bytes cellsRecord(Time time, const Modem& modem) {
    RecordWriter record(time, 0xD00A, 168);
    record.u8(16, modem.measurements().size() << 1);
    for (const Measurement& measured : modem.measurements()) {
        const Cell& cell = modem.cells()[measured.cell];
        const std::size_t at = record.size();                                                      // 16 bytes a cell
        record.u32(at, static_cast<std::uint32_t>(cell.uarfcn)                                     // bits  0-13
                           | static_cast<std::uint32_t>(cell.parameterId) << 14                    // bits 14-20
                           | static_cast<std::uint32_t>(rscpLevel(measured.rscp)) << 21            // bits 21-28
                           | static_cast<std::uint32_t>(measured.set) << 29                        // bits 29-30
                           | static_cast<std::uint32_t>(measured.isJointlyDetected ? 1 : 0) << 31  // bit  31
        );
        record.u32(at + 12, 0);
    }
    return record.finish();
}

Bytes gsmCellsRecord(Time time, const Modem& modem) {
    RecordWriter record(time, 0xD00E, 17);
    record.u8(16, modem.gsmMeasurements().size());
    for (const GsmMeasurement& measured : modem.gsmMeasurements()) {
        const Cell& cell = modem.cells()[measured.cell];
        const std::size_t at = record.size();  // 8 bytes a cell
        record
            .u16(at, cell.gsmIdentity | (measured.isIdentified ? 1 << 15 : 0))  // bits 0-13; bit 14, the band: 1800
            .u8(at + 2, cell.ncc)
            .u8(at + 3, cell.bcc)
            .u16(at + 4, cell.gsmArfcn)
            .i16(at + 6, measured.rssi);
    }
    return record.finish();
}

Bytes channelsRecord(Time time, const Modem& modem) {
    const auto& channels = modem.transportChannels();
    const auto& composites = modem.composites();
    RecordWriter record(time, 0xD00C, 17);
    record.u16(14, channels.size() << 6 | composites.size() << 12);
    for (std::size_t i = 0; i < channels.size(); ++i) {
        record.u8(17 + 2 * i, channels[i].id).u8(18 + 2 * i, blerLevel(channels[i].blockErrors));
    }
    const std::size_t first = 289 + 34 * channels.size();
    for (std::size_t i = 0; i < composites.size(); ++i) {
        const std::size_t at = first + 8 * i;
        record.u8(at, composites[i].id).u8(at + 1, composites[i].timeslots);
        for (std::size_t slot = 0; slot < composites[i].sir.size(); ++slot) {
            const auto& sir = composites[i].sir[slot];
            record.u8(at + 2 + slot, sir ? sirLevel(*sir) : 0);
        }
    }
    return record.finish();
}

}  // namespace kelvo::simulation::utran
