#include "LogGenerator/CDMA/C2K1xStatus.h"

#include "LogGenerator/CDMA/C2K1xActiveSet.h"
#include "LogGenerator/CDMA/C2KBandClass.h"
#include "LogGenerator/CDMA/C2KFindSubpacket.h"
#include "LogGenerator/CDMA/C2KStoreDisplayValue.h"
#include "LogGenerator/CDMA/C2KTrafficFER.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr std::size_t kMinimum = 17;
constexpr std::int64_t kTraffic = 8;

// clang-format off
constexpr ValueTable kState({
    {  0, "Inactive [0]"                        },
    {  1, "Deep sleep in start state [1]"       },
    {  2, "Initial state for CDMA operation [2]" },
    {  3, "Acquisition [3]"                     },
    {  4, "Sync [4]"                            },
    {  5, "Slew [5]"                            },
    {  6, "Paging [6]"                          },
    {  7, "Slotted mode sleep state [7]"        },
    {  8, "Traffic [8]"                         },
    {  9, "UnSlew [9]"                          },
    { 10, "Operation in PCG state [10]"         },
    { 11, "Powerup state [11]"                  },
}, "[Bad Value %d]");

constexpr Shown kReceiveLevel = linear(0.334, -63.248, "%+.2f", dBm);
constexpr Shown kTransmitLevel = linear(0.1, 0.0, "%+.2f", dBm);

// Offsets count from the sub-packet.
constexpr auto kSystemState = entry(5, {  // sub-packet 1
    {  4, u8,  "k1xDeviceState",  label(kState)        },
});
constexpr auto kChain0 = entry(14, {  // sub-packet 2
    {  4, u8,  "k1xRx0BandClass", label(kC2KBandClass) },
    {  6, u16, "k1xRx0ChanNum",   decimal              },
    { 10, i8,  "k1xRxAGC0",       kReceiveLevel        },
});
constexpr auto kInTraffic = entry(14, {  // sub-packet 2
    {  5, u8,  "k1xRx1BandClass", label(kC2KBandClass) },
    {  8, u16, "k1xRx1ChanNum",   decimal              },
    { 11, i8,  "k1xRxAGC1",       kReceiveLevel        },
    { 12, i16, "k1xTxAGC",        kTransmitLevel       },
});
// clang-format on

}  // namespace

void decode1xStatus(ByteView packet, Dictionary& state, const DictionaryRef& lookup) {
    if (packet.size() < kMinimum) {
        logLine(Level::Error, "Log code 0x119c is %u bytes long but must be at least %lu bytes.", packet.size(),
                kMinimum);
        return;
    }
    const auto systemState = C2KFindSubpacket(packet, 1);
    const auto radio = C2KFindSubpacket(packet, 2);
    const auto activeSet = C2KFindSubpacket(packet, 3);
    const auto fingers = C2KFindSubpacket(packet, 4);  // must be there, though nothing of it is shown
    if (!systemState || !radio || !activeSet || !fingers) {
        logLine(Level::Warning, "Log code 0x119c: missing subpacket (ss=%d,rf=%d,ai=%d,fi=%d).",
                int{systemState.has_value()}, int{radio.has_value()}, int{activeSet.has_value()},
                int{fingers.has_value()});
        return;
    }
    const RecordView record(packet);
    const bool inTraffic = record.read(*systemState + 4, u8) == kTraffic;
    C2KStoreFields(record, *systemState, kSystemState.fields, lookup);
    C2KStoreFields(record, *radio, kChain0.fields, lookup);
    if (inTraffic) {
        C2KStoreFields(record, *radio, kInTraffic.fields, lookup);
    } else {
        C2KStoreNotAvailable(kInTraffic.fields, lookup);
    }
    C2KStoreDisplayValue("k1xActiveSetInfo", C2K1xActiveSet(record, *activeSet), lookup);
    if (!inTraffic) endTrafficFER(state, lookup);
}

}  // namespace kelvo
