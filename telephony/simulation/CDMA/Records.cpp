#include "telephony/simulation/CDMA/Records.h"

#include <algorithm>
#include <cmath>

#include "telephony/simulation/CDMA/Network.h"
#include "telephony/simulation/Propagation.h"
#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation::cdma {
namespace {

constexpr std::uint64_t kVersion = 1;
constexpr int kNoPn = 65535;

long rounded(double value, double low, double high) { return std::lround(std::clamp(value, low, high)); }
long dBm8(double dBm) { return rounded(dBm, -128, 127); }
/// A ratio of powers in units of 1/512.
long ratio512(double dB) { return rounded(toMilliwatts(dB) * 512, 0, 65535); }

int pnOrNone(const std::optional<PnOffset>& pn) { return pn ? int{*pn} : kNoPn; }

std::uint64_t wholeSeconds(Time time) {
    return static_cast<std::uint64_t>(std::chrono::duration_cast<std::chrono::seconds>(time).count());
}

/// A record of sub-packets: how many at 14, the first at 17.
class Subpackets {
public:
    Subpackets(Time time, std::uint32_t code) : _record(time, code, kFirst) { _record.u8(13, kVersion); }

    /// Appends a sub-packet of `size` bytes and returns where it begins: its number at 0, its size at 2.
    std::size_t add(std::uint8_t id, std::size_t size) {
        const std::size_t at = _record.size();
        _record.u8(14, ++_count).u8(at, id).u16(at + 2, size).u8(at + size - 1, 0);
        return at;
    }
    RecordWriter& record() { return _record; }

private:
    static constexpr std::size_t kFirst = 17;
    RecordWriter _record;
    std::uint64_t _count = 0;
};

// The receiver's gain: a step of 0.334 dB, 0 at -63.248 dBm.
long gainSteps(double dBm) { return rounded((dBm + 63.248) / 0.334, -128, 127); }

void addState(Subpackets& packet, const OneXStatus& status) {
    const std::size_t at = packet.add(1, 8);
    packet.record().u8(at + 4, static_cast<std::uint64_t>(status.state));
}

void addRadio(Subpackets& packet, const OneXStatus& status) {
    const std::size_t at = packet.add(2, 16);
    packet.record()
        .u8(at + 4, kOneXCarrier.bandClass)  // of antenna 0
        .u8(at + 5, kOneXCarrier.bandClass)  // of antenna 1
        .u16(at + 6, kOneXCarrier.channel)
        .u16(at + 8, kOneXCarrier.channel)
        .i8(at + 10, gainSteps(status.rx0))
        .i8(at + 11, gainSteps(status.rx1))
        .i16(at + 12, rounded(status.tx * 10, -32768, 32767));
}

// The searcher adds up the energy of M stretches of N chips each, shifted by E:
// Ec/Io = 2^(2E - 3) X / (9 N N M) - 1/N. With these a step is 1/55296, and 0 dB is 56160.
constexpr int kChips = 64;
constexpr int kStretches = 3;
constexpr int kShift = 2;

long searcherEnergy(double dB) {
    const double scale = 9.0 * kChips * kChips * kStretches / std::exp2(2 * kShift - 3);
    return rounded((toMilliwatts(dB) + 1.0 / kChips) * scale, 0, 65535);
}

void addActiveSet(Subpackets& packet, const OneXStatus& status) {
    // Each pilot carries an entry for each antenna in use.
    const std::size_t entries = status.state == OneXState::Traffic ? 2 : 1;
    const std::size_t each = (6 * entries + 15) / 4 * 4;
    const std::size_t at = packet.add(3, 12 + each * status.active.size());
    packet.record()
        .u16(at + 4, kChips)
        .u8(at + 6, kStretches)
        .u8(at + 7, kShift)
        .u8(at + 8, status.active.size())
        .u8(at + 9, entries)
        .u16(at + 10, status.referencePn);
    for (std::size_t i = 0; i < status.active.size(); ++i) {
        const std::size_t pilot = at + 12 + each * i;
        packet.record()
            .u16(pilot, status.active[i].pn)
            .i16(pilot + 12 + 4 * entries, searcherEnergy(status.active[i].strength));
    }
}

}  // namespace

Bytes oneXStatusRecord(Time time, const OneXStatus& status) {
    Subpackets packet(time, 0x119C);
    addState(packet, status);
    addRadio(packet, status);
    addActiveSet(packet, status);
    packet.add(4, 8);  // fingers: none told
    return packet.record().finish();
}

Bytes trafficFrameRecord(Time time, bool erased) {
    Subpackets packet(time, 0x119D);
    const std::size_t at = packet.add(11, 28);
    packet.record().u8(at + 24, erased ? 1 : 0);
    return packet.record().finish();
}

Bytes systemRecord(Time time, const System& system) {
    return RecordWriter(time, 0x134F, 186)
        .u8(13, 2)  // version
        .i32(42, system.roamingIndicator)
        .i32(46, system.type)
        .i16(50, system.sid)
        .i16(52, system.nid)
        .i8(131, system.packetZone)
        .i8(133, system.protocolRevision)
        .i16(184, system.baseId)
        .finish();
}

Bytes evdoStatusRecord(Time time, const EvdoStatus& status) {
    return RecordWriter(time, 0x1183, 50)
        .u16(13, kEvdoCarrier.bandClass << 11 | kEvdoCarrier.channel)
        .i8(15, dBm8(status.rx0))
        .i8(16, dBm8(status.rx1))
        .i8(17, dBm8(status.tx))
        .u16(18, pnOrNone(status.servingPn))
        .u8(36, static_cast<std::uint64_t>(status.state))
        .u8(37, static_cast<std::uint64_t>(status.session))
        .u16(38, status.uati)
        .u8(40, status.uati >> 16)
        .i8(41, status.colorCode)
        .finish();
}

Bytes evdoPilotsRecord(Time time, const std::vector<PilotReading>& active) {
    RecordWriter record(time, 0x12B6, 25 + 12 * active.size());
    record.u8(13, kVersion).u8(15, active.size());
    for (std::size_t i = 0; i < active.size(); ++i) {
        record.i16(25 + 12 * i, active[i].pn).i16(27 + 12 * i, ratio512(active[i].strength));
    }
    return record.finish();
}

Bytes fingersRecord(Time time, const std::vector<Finger>& fingers) {
    RecordWriter record(time, 0x108A, 23 + 14 * fingers.size());
    record.u8(13, kVersion).u8(22, fingers.size());
    for (std::size_t i = 0; i < fingers.size(); ++i) {
        record.u16(23 + 14 * i, pnOrNone(fingers[i].pn));
        if (fingers[i].pn) record.i16(29 + 14 * i, ratio512(fingers[i].carrierToInterference));
    }
    return record.finish();
}

Bytes forwardPacketsRecord(Time time, const PacketCounters& counters) {
    RecordWriter record(time, 0x1192, 241);
    record.u32(13, wholeSeconds(time));
    std::size_t at = 17;  // by format: packets received, by size; then those lost
    const auto put = [&record, &at](std::uint32_t packets) {
        record.u32(at, packets);
        at += 4;
    };
    for (std::size_t format = 0; format < kForwardFormats.size(); ++format) {
        for (std::size_t size = 0; size < 4; ++size) {
            if (kForwardFormats[format].bits[size] != 0) put(counters.forward[format].received[size]);
        }
        put(counters.forward[format].lost);
    }
    return record.finish();
}

Bytes reversePacketsRecord(Time time, const PacketCounters& counters) {
    RecordWriter record(time, 0x127E, 1750);
    record.u8(13, kVersion).u32(14, wholeSeconds(time));
    std::size_t at = 18;  // by mode, interlace and size: packets by the sub-packets they took; then those lost
    for (const auto* mode : {&counters.highCapacity, &counters.lowLatency}) {
        for (const auto& interlace : *mode) {
            for (const PacketCounters::Reverse& size : interlace) {
                for (std::size_t i = 0; i < 4; ++i) record.u32(at + 4 * i, size.acknowledged[i]);
                record.u32(at + 16, size.lost);
                at += 24;
            }
        }
    }
    return record.finish();
}

}  // namespace kelvo::simulation::cdma
