#include "telephony/simulation/LTE/NewerRecords.h"

#include <algorithm>
#include <array>
#include <cmath>

#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation::lte {
namespace {

constexpr std::size_t P = RecordWriter::kHeader;  // where the payload begins
constexpr int kStrongestPower = 23;               // dBm, of a phone of power class 3
constexpr int kNoPower = 64;
constexpr std::uint32_t kNoThreshold = 63;

/// A level in sixteenths above `lowest`, as many as `bits` bits count.
std::uint32_t sixteenths(double value, int lowest, int bits) {
    const double most = std::ldexp(1, bits) - 1;
    return static_cast<std::uint32_t>(std::clamp(std::round((value - lowest) * 16), 0.0, most));
}
std::uint32_t rsrp(double dBm) { return sixteenths(dBm, -180, 12); }
std::uint32_t rsrq(double dB) { return sixteenths(dB, -30, 10); }
std::uint32_t rssi(double dBm) { return sixteenths(dBm, -110, 11); }
/// The connected phone's are signed and 16 bits wide.
std::int64_t wideRsrp(double dBm) { return std::lround((dBm + 180) * 16); }
std::int64_t wideRsrq(double dB) { return std::lround((dB + 30) * 16); }

std::uint32_t clamped(double value, int lowest, int bits) {
    return static_cast<std::uint32_t>(std::clamp(std::round(value - lowest), 0.0, std::ldexp(1, bits) - 1));
}
std::uint32_t minimumLevel(int dBm) { return clamped(dBm / 2.0, -70, 6); }
std::uint32_t threshold(const std::optional<int>& dB) { return dB ? clamped(*dB / 2.0, 0, 6) : kNoThreshold; }

std::int64_t frameNumber(Time time, const Cell& cell) {
    const auto milliseconds = std::chrono::duration_cast<std::chrono::milliseconds>(time).count();
    return (milliseconds / 10 + cell.frames) % 1024;
}

// clang-format off

template <int version>
Bytes masterInformationRecord(Time time, const Cell& cell) {
    constexpr std::size_t length = version == 2 ? 11 : 12;  // version 3 tells of a further block's schedule
    return RecordWriter(time, 0xB0C1, P + length)
        .u8 (P +  0, version)
        .u16(P +  1, cell.pci)
        .u32(P +  3, cell.carrier.downlink)
        .u16(P +  7, static_cast<std::uint64_t>(frameNumber(time, cell)))
        .u8 (P +  9, static_cast<std::uint64_t>(cell.antennas))
        .u8 (P + 10, static_cast<std::uint64_t>(cell.carrier.resourceBlocks))
        .finish();
}

Bytes wideServingCellRecord(Time time, const Cell& cell) {
    return RecordWriter(time, 0xB0C2, P + 29)
        .u8 (P +  0, 3)  // version
        .u16(P +  1, cell.pci)
        .u32(P +  3, cell.carrier.downlink)
        .u32(P +  7, cell.carrier.uplink)
        .u8 (P + 11, static_cast<std::uint64_t>(cell.carrier.resourceBlocks))  // downlink
        .u8 (P + 12, static_cast<std::uint64_t>(cell.carrier.resourceBlocks))  // uplink
        .u32(P + 13, cell.identity)
        .u16(P + 17, static_cast<std::uint64_t>(cell.trackingArea))
        .u32(P + 19, static_cast<std::uint64_t>(cell.carrier.band))
        .u16(P + 23, kMcc)
        .u8 (P + 25, 2)  // digits of the next
        .u16(P + 26, kMnc)
        .finish();
}

/// Each level stands twice.
void writeMeasured(RecordWriter& record, std::size_t at, const Neighbor& cell) {
    record
        .u16(at + 0, cell.pci)
        .i16(at + 2, wideRsrp(cell.reading.filteredRsrp))
        .i16(at + 4, wideRsrp(cell.reading.filteredRsrp))
        .i16(at + 6, wideRsrq(cell.reading.filteredRsrq))
        .i16(at + 8, wideRsrq(cell.reading.filteredRsrq))
        .u16(at + 10, 0);
}

template <int version>
Bytes connectedRecord(Time time, const Modem& modem) {
    constexpr bool isWide = version == 4;               // a channel of 32 bits, and what follows it two bytes on
    constexpr std::size_t behind = P + (isWide ? 2 : 0);
    RecordWriter record(time, 0xB179, behind + 24 + (isWide ? 2 : 0));
    record
        .u8 (P + 0, version)
        .u8 (P + 4, 0)  // the primary cell
        .u16(P + 8, modem.serving().carrier.downlink)
        .u16(behind + 10, modem.serving().pci)
        .u16(behind + 12, static_cast<std::uint64_t>(modem.subframe()))
        .i16(behind + 14, wideRsrp(modem.reading().filteredRsrp))
        .i16(behind + 16, wideRsrp(modem.reading().filteredRsrp))
        .i16(behind + 18, wideRsrq(modem.reading().filteredRsrq))
        .i16(behind + 20, wideRsrq(modem.reading().filteredRsrq))
        .u8 (behind + 22, modem.neighbors().size())
        .u8 (behind + 23, modem.detected().size());
    for (const Neighbor& cell : modem.neighbors()) writeMeasured(record, record.size(), cell);
    for (const Pci pci : modem.detected()) {
        const std::size_t at = record.size();
        record.u16(at, pci).u32(at + 12, 0);  // correlation and time: none
    }
    return record.finish();
}

template <int version>
Bytes idleRecord(Time time, const Cell& cell, const Reading& reading, const IdleState& idle) {
    constexpr bool isWide = version == 5;
    constexpr std::size_t words = P + (isWide ? 12 : 8);
    const std::uint32_t maximumPower = cell.maximumPower ? clamped(*cell.maximumPower, -30, 6) : kNoPower;
    return RecordWriter(time, 0xB17F, words + 24)
        .u8 (P + 0, version)
        .u16(P + 4, cell.carrier.downlink)
        .u16(P + (isWide ? 8 : 6), static_cast<std::uint64_t>(cell.pci | cell.priority << 9))
        .u32(words +  0, rsrp(reading.rsrp))
        .u32(words +  4, rsrp(reading.filteredRsrp))
        .u32(words +  8, rsrq(reading.rsrq)
                         | rsrq(reading.filteredRsrq) << 20)
        .u32(words + 12, rssi(reading.rssi) << 10)
        .u32(words + 16, minimumLevel(cell.minimumLevel)
                         | maximumPower << 6
                         | clamped(kStrongestPower, -30, 6) << 13
                         | clamped(idle.srxlev, -50, 7) << 19
                         | clamped(idle.failedCycles, 0, 6) << 26)
        .u32(words + 20, threshold(cell.searchIntra)
                         | threshold(cell.searchOther) << 6
                         | (idle.rulesChanged ? 1U : 0U) << 12
                         | static_cast<std::uint32_t>(idle.rules) << 13)
        .finish();
}

void writeIdleNeighbor(RecordWriter& record, std::size_t at, const Neighbor& cell) {
    const std::uint32_t timing = static_cast<std::uint32_t>(cell.frames | cell.samples << 11);
    record
        .u32(at +  0, static_cast<std::uint32_t>(cell.pci)
                      | rssi(cell.reading.rssi) << 9
                      | rsrp(cell.reading.rsrp) << 20)
        .u32(at +  4, rsrp(cell.reading.filteredRsrp) << 12)
        .u32(at +  8, rsrq(cell.reading.rsrq) << 12)
        .u32(at + 12, rsrq(cell.reading.filteredRsrq)
                      | clamped(cell.srxlev, -30, 6) << 20)
        .i16(at + 16, cell.frequencyError)
        .u32(at + 20, timing)
        .u32(at + 24, timing);
}

template <int version>
Bytes neighborsRecord(Time time, const Modem& modem) {
    constexpr bool isWide = version == 5;
    const auto& cells = modem.neighbors();
    RecordWriter record(time, 0xB180, P + (isWide ? 12 : 8));
    record
        .u8 (P + 0, version)
        .u16(P + 4, modem.neighborsCarrier().downlink);
    const auto demandAndCount = minimumLevel(modem.neighborsMinimumLevel()) | cells.size() << 6;
    if (isWide) {
        record.u32(P + 8, demandAndCount);
    } else {
        record.u16(P + 6, demandAndCount);
    }
    for (const Neighbor& cell : cells) writeIdleNeighbor(record, record.size(), cell);
    return record.finish();
}

/// One cell of 0xb193: the first antenna hears it best, the other 3 dB less of all there is.
struct EveryModeCell {
    Pci pci;
    bool isServing;
    const Reading& reading;
};
constexpr double kSecondAntenna = -3;

void writeCell19(RecordWriter& record, std::size_t at, const EveryModeCell& cell, int subframe) {
    const Reading& reading = cell.reading;
    record
        .u16(at +  0, static_cast<std::uint64_t>(cell.pci | (cell.isServing ? 1 << 12 : 0)))
        .u16(at +  4, static_cast<std::uint64_t>(subframe / 10 | subframe % 10 << 10))
        .u32(at + 16, rsrp(reading.rsrp) << 10)                        // antenna 0
        .u32(at + 20, rsrp(reading.rsrp + kSecondAntenna) << 12)       // antenna 1
        .u32(at + 24, rsrp(reading.rsrp) << 12)                        // combined: the better
        .u32(at + 28, rsrq(reading.rsrq) << 12)                        // antenna 0
        .u32(at + 32, rsrq(reading.rsrq) | rsrq(reading.rsrq) << 20)   // antenna 1, combined
        .u32(at + 36, rssi(reading.rssi) << 10 | rssi(reading.rssi + kSecondAntenna) << 21)
        .u32(at + 40, rssi(reading.rssi));                             // combined
}

void writeCell36(RecordWriter& record, std::size_t at, const EveryModeCell& cell, int subframe) {
    const Reading& reading = cell.reading;
    record
        .u16(at +  0, static_cast<std::uint64_t>(cell.pci | (cell.isServing ? 1 << 12 : 0)))
        .u16(at +  4, static_cast<std::uint64_t>(subframe / 10 | subframe % 10 << 10))
        .u32(at + 16, rsrp(reading.rsrp) << 10)                        // antenna 0
        .u32(at + 20, rsrp(reading.rsrp + kSecondAntenna) << 12)       // antenna 1
        .u32(at + 28, rsrp(reading.rsrp - 40) << 12)                   // combined, less 40 dB
        .u32(at + 32, rsrp(reading.rsrp) | rsrp(reading.filteredRsrp) << 12)
        .u32(at + 36, rsrq(reading.rsrq) | rsrq(reading.rsrq) << 20)   // antenna 0, antenna 1
        .u32(at + 44, rsrq(reading.rsrq) | rsrq(reading.filteredRsrq) << 20)
        .u32(at + 48, rssi(reading.rssi) | rssi(reading.rssi + kSecondAntenna) << 11)
        .u32(at + 56, rssi(reading.rssi));
}

// clang-format on

/// The generations of part 25, which always has four places for cells.
struct Part25 {
    int version;
    std::size_t body;
    std::size_t stride;
    void (*write)(RecordWriter&, std::size_t, const EveryModeCell&, int subframe);
};
constexpr Part25 kPart19{19, 360, 88, writeCell19};
constexpr Part25 kPart36{36, 520, 128, writeCell36};
constexpr std::size_t kPlaces = 4;

template <const Part25& part>
Bytes everyModeRecord(Time time, const Modem& modem) {
    constexpr std::size_t B = P + 8;  // where the part's body begins
    constexpr std::size_t cells = B + 8;
    const Cell& serving = modem.serving();
    RecordWriter record(time, 0xB193, B + part.body);
    record.u8(P, 1).u8(P + 1, 1);  // one part
    record.u8(P + 4, 25).u8(P + 5, static_cast<std::uint64_t>(part.version)).u16(P + 6, 4 + part.body);
    part.write(record, cells, {serving.pci, true, modem.reading()}, modem.subframe());
    std::size_t count = 1;
    if (modem.neighborsCarrier().downlink == serving.carrier.downlink) {
        for (const Neighbor& cell : modem.neighbors()) {
            if (count == kPlaces) break;
            part.write(record, cells + part.stride * count++, {cell.pci, false, cell.reading}, modem.subframe());
        }
    }
    record.u32(B, serving.carrier.downlink).u16(B + 4, count);
    if (part.version == 36) record.u16(B + 6, 3);  // two antennas
    return record.finish();
}

constexpr std::array<Wording, 3> kWordings = {{
    {antennasRecord, servingCellRecord, connectedMeasurementRecord, servingMeasurementRecord, neighborMeasurementRecord,
     nullptr},
    {masterInformationRecord<2>, wideServingCellRecord, connectedRecord<3>, idleRecord<4>, neighborsRecord<4>,
     everyModeRecord<kPart19>},
    {masterInformationRecord<3>, wideServingCellRecord, connectedRecord<4>, idleRecord<5>, neighborsRecord<5>,
     everyModeRecord<kPart36>},
}};

}  // namespace

const Wording& wordingOf(Generation generation) { return kWordings[static_cast<std::size_t>(generation)]; }

}  // namespace kelvo::simulation::lte
