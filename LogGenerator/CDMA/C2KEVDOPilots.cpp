#include "LogGenerator/CDMA/C2KEVDOPilots.h"

#include <cmath>

#include "LogGenerator/CDMA/C2KPilotList.h"
#include "LogGenerator/CDMA/C2KStoreDisplayValue.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

/// Where a record keeps its pilots.
struct PilotLayout {
    std::size_t start;     ///< of the first entry, and the length of a record without any
    std::size_t stride;    ///< from one entry to the next
    std::size_t energyAt;  ///< offset in the entry of the energy (u16); the PN (u16) is at 0
};

constexpr PilotLayout kActiveSet{.start = 25, .stride = 12, .energyAt = 2};  // count at 15
constexpr PilotLayout kFingers{.start = 23, .stride = 14, .energyAt = 6};    // count at 22
constexpr std::int64_t kNoPilot = 65535;

double decibels(std::int64_t energy) { return 10 * std::log10(static_cast<double>(energy) / 512); }

}  // namespace

void decodeActiveSetPilots(ByteView packet, Dictionary&, const DictionaryRef& lookup) {
    if (packet.size() < kActiveSet.start) {
        logLine(Level::Error, "Log code 0x12b6 is %u bytes long but must be at least %lu bytes.", packet.size(),
                kActiveSet.start);
        return;
    }
    const RecordView record(packet);
    const RecordEntries entries(kActiveSet.start, kActiveSet.stride, record.count(15, u8));
    if (packet.size() < kActiveSet.start + kActiveSet.stride * entries.count()) {
        logLine(Level::Error, "Log code 0x12b6 is %u bytes long, but has %d substructs.", packet.size(),
                entries.count());
        return;
    }
    C2KPilotList pilots(entries.count());
    for (std::size_t i = 0; i < entries.count(); ++i) {
        const std::size_t at = entries.offsetOf(i);
        pilots.add(i, record.read(at, u16), decibels(record.read(at + kActiveSet.energyAt, u16)));
    }
    C2KStoreDisplayValue("kActiveSetPilots", pilots.rowsOrNone(), lookup);
}

void decodeFingerC2I(ByteView packet, Dictionary&, const DictionaryRef& lookup) {
    if (packet.size() < kFingers.start) {
        logLine(Level::Error, "Log code 0x108a is %u bytes long but must be at least %lu bytes.", packet.size(),
                kFingers.start);
        return;
    }
    const RecordView record(packet);
    const RecordEntries entries(kFingers.start, kFingers.stride, record.count(22, u8));
    if (packet.size() != kFingers.start + kFingers.stride * entries.count()) {
        logLine(Level::Error, "Log code 0x108a has bad length of %u bytes, but has %d substructs (size=%lu).",
                packet.size(), entries.count(), kFingers.start);
        return;
    }
    C2KPilotList fingers(entries.count());
    for (std::size_t i = 0; i < entries.count(); ++i) {
        const std::size_t at = entries.offsetOf(i);
        const std::int64_t pn = record.read(at, u16);
        if (pn != kNoPilot) fingers.add(i, pn, decibels(record.read(at + kFingers.energyAt, u16)));
    }
    C2KStoreDisplayValue("kFingerC2I", fingers.rowsOrNone(), lookup);
}

}  // namespace kelvo
