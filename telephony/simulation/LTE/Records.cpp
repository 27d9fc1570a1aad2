#include "telephony/simulation/LTE/Records.h"

#include <algorithm>
#include <cmath>

#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation::lte {
namespace {

constexpr int kVersion = 1;
constexpr int kAbsentPower = 64;
constexpr int kAbsentThreshold = 32;
constexpr int kStrongestPower = 23;  // dBm, of a phone of power class 3
constexpr std::size_t kMostNeighbors = 32;

// Steps of `step` from `lowest` up to the value, as many as `bits` bits count.
std::uint32_t steps(double value, double lowest, double step, int bits) {
    const double most = std::ldexp(1, bits) - 1;
    return static_cast<std::uint32_t>(std::clamp(std::round((value - lowest) / step), 0.0, most));
}

std::uint32_t halves(double dBm, int bits) { return steps(dBm, -140, 0.5, bits); }
std::uint32_t quarters(double dBm) { return steps(dBm, -140, 0.25, 9); }
std::uint32_t quality(double dB) { return steps(dB, -30, 0.25, 7); }

std::uint32_t minimumLevel(int dBm) { return steps(dBm, -140, 2, 6); }
std::uint32_t threshold(const std::optional<int>& dB) { return dB ? steps(*dB, 0, 2, 6) : kAbsentThreshold; }

void writeConnected(RecordWriter& record, std::size_t at, const Reading& reading) {
    record.u16(at, steps(reading.filteredRsrp, -140, 0.25, 16))
        .u16(at + 2, steps(reading.filteredRsrq, -20, 0.125, 16));
}

void writeNeighbor(RecordWriter& record, std::size_t at, const Neighbor& cell) {
    const Reading& reading = cell.reading;
    const std::uint32_t timing = cell.frames | cell.samples << 11;
    // clang-format off
    record.u32(at,      cell.pci                                // bits  0-8
                        | halves(reading.rssi, 8) << 9          // bits  9-16
                        | halves(reading.rsrp, 9) << 17)        // bits 17-25
          .u32(at + 4,  halves(reading.filteredRsrp, 9)         // bits  0-8
                        | quality(reading.rsrq) << 9            // bits  9-15
                        | quality(reading.filteredRsrq) << 16   // bits 16-22
                        | steps(cell.srxlev, -30, 1, 7) << 23)  // bits 23-29
          .u16(at + 8,  cell.frequencyError)
          .u32(at + 12, timing)   // antenna 0: frames in bits 0-10, samples in bits 11-29
          .u32(at + 16, timing);  // antenna 1
    // clang-format on
}

void write(RecordWriter& record, std::size_t at, const Candidate::Lte& cell) {
    record.u16(at + 4, cell.channel).u16(at + 6, cell.pci << 7);
}
void write(RecordWriter& record, std::size_t at, const Candidate::Utran& cell) {
    record.u16(at + 4, cell.channel).u16(at + 6, cell.scramblingCode);
}
void write(RecordWriter& record, std::size_t at, const Candidate::Geran& cell) {
    record.u16(at + 4, cell.channel).u8(at + 6, cell.band).u8(at + 7, cell.bsic);
}
void write(RecordWriter& record, std::size_t at, const Candidate::Cdma& cell) {
    record.u8(at + 4, cell.bandClass).u16(at + 8, cell.channel).u16(at + 10, cell.pilot);
}

void writeCandidate(RecordWriter& record, std::size_t at, const Candidate& candidate) {
    record.u16(at, candidate.priority).u16(at + 2, candidate.cell.index());
    std::visit([&](const auto& cell) { write(record, at, cell); }, candidate.cell);
}

}  // namespace

Bytes servingCellRecord(Time time, const Cell& cell) {
    return RecordWriter(time, 0xB0C2, 38)
        .u8(13, 2)  // version
        .u16(14, cell.pci)
        .u16(16, cell.carrier.downlink)
        .u16(18, cell.carrier.uplink)
        .u8(20, cell.carrier.resourceBlocks)  // downlink
        .u8(21, cell.carrier.resourceBlocks)  // uplink
        .u32(22, cell.identity)
        .u16(26, cell.trackingArea)
        .u32(28, cell.carrier.band)
        .finish();
}

Bytes antennasRecord(Time time, const Cell& cell) {
    return RecordWriter(time, 0xB0C1, 22).u8(13, 1).u8(20, cell.antennas).finish();  // version 1
}

Bytes connectedMeasurementRecord(Time time, const Modem& modem) {
    RecordWriter record(time, 0xB179, 29);
    record.u16(17, modem.serving().carrier.downlink).u16(19, modem.serving().pci).u16(21, modem.subframe());
    writeConnected(record, 23, modem.reading());
    record.u8(27, modem.neighbors().size()).u8(28, modem.detected().size());
    for (const Neighbor& cell : modem.neighbors()) {
        const std::size_t at = record.size();
        record.u16(at, cell.pci);
        writeConnected(record, at + 2, cell.reading);
    }
    for (const Pci pci : modem.detected()) record.u16(record.size(), pci);
    return record.finish();
}

Bytes servingMeasurementRecord(Time time, const Cell& cell, const Reading& reading, const IdleState& idle) {
    const std::uint32_t maximumPower = cell.maximumPower ? steps(*cell.maximumPower, -30, 1, 6) : kAbsentPower;
    // clang-format off
    return RecordWriter(time, 0xB17F, 33)
        .u8 (13, kVersion)
        .u16(17, cell.carrier.downlink)
        .u16(19, cell.pci                                         // bits  0-8
                 | cell.priority << 9)                            // bits  9-12
        .u32(21, quarters(reading.rsrp)                           // bits  0-8
                 | quarters(reading.filteredRsrp) << 9            // bits  9-17
                 | quality(reading.rsrq) << 18                    // bits 18-24
                 | quality(reading.filteredRsrq) << 25)           // bits 25-31
        .u32(25, halves(reading.rssi, 9)                          // bits  0-8
                 | minimumLevel(cell.minimumLevel) << 9           // bits  9-14
                 | maximumPower << 15                             // bits 15-21
                 | steps(kStrongestPower, -30, 1, 6) << 22)       // bits 22-27
        .u32(29, steps(idle.srxlev, -30, 1, 7)                    // bits  0-6
                 | steps(idle.failedCycles, 0, 1, 6) << 7         // bits  7-12
                 | threshold(cell.searchIntra) << 13              // bits 13-18
                 | threshold(cell.searchOther) << 19              // bits 19-24
                 | (idle.rulesChanged ? 1U : 0U) << 25            // bit  25
                 | static_cast<std::uint32_t>(idle.rules) << 26)  // bits 26-29
        .finish();
    // clang-format on
}

Bytes neighborMeasurementRecord(Time time, const Modem& modem) {
    const auto& cells = modem.neighbors();
    const std::size_t count = std::min(cells.size(), kMostNeighbors);
    RecordWriter record(time, 0xB180, 21);
    record.u8(13, kVersion)
        .u16(17, modem.neighborsCarrier().downlink)
        .u16(19, minimumLevel(modem.neighborsMinimumLevel()) | (count - 1) << 6);  // bits 0-5, bits 6-10
    for (std::size_t i = 0; i < count; ++i) writeNeighbor(record, 21 + 20 * i, cells[i]);
    return record.finish();
}

Bytes candidatesRecord(Time time, const Modem& modem) {
    const auto& candidate = modem.candidate();
    RecordWriter record(time, 0xB186, 21);
    record.u8(13, kVersion)
        .u16(15, modem.serving().carrier.downlink)
        .u16(17, modem.serving().pci)
        .u16(19, candidate ? 1 : 0);
    if (candidate) writeCandidate(record, 21, *candidate);
    return record.finish();
}

}  // namespace kelvo::simulation::lte
