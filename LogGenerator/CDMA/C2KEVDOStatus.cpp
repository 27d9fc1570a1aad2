#include "LogGenerator/CDMA/C2KEVDOStatus.h"

#include "LogGenerator/CDMA/C2KBandClass.h"
#include "LogGenerator/CDMA/C2KStoreDisplayValue.h"
#include "LogGenerator/CDMA/CDMACodes.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr std::size_t kSize = 50;
constexpr std::size_t kDeviceStateAt = 36;
constexpr std::int64_t kAccess = 4;

// clang-format off
constexpr ValueTable kDeviceState({
    { 0, "Inactive [0]"    },
    { 1, "Acquisition [1]" },
    { 2, "Sync [2]"        },
    { 3, "Idle [3]"        },
    { 4, "Access [4]"      },
    { 5, "Connected [5]"   },
}, "[Reserved %d]");

constexpr ValueTable kSessionState({
    { 0, "Closed [0]"           },
    { 1, "AMP setup [1]"        },
    { 2, "AT-initiated neg [2]" },
    { 3, "Initiated neg [3]"    },
    { 4, "Open [4]"             },
}, "[Reserved %d]");

constexpr Shown kLevel = whole(1, 0, dBm, "%+d");

constexpr auto kReceiver = record(code::kEVDOStatus, kSize, {
    // at             raw               lookup key            shown as
    { 13,             u16.bits( 0, 10), "kChannel",           decimal              },
    { kDeviceStateAt, u8,               "k1xEVDODeviceState", label(kDeviceState)  },
    { 14,             u8.bits(3, 7),    "kBandClass",         label(kC2KBandClass) },
    { 15,             i8,               "kRxAGC0",            kLevel               },
});
constexpr auto kWithAccess = record(code::kEVDOStatus, kSize, {
    { 16,             i8,               "kRxAGC1",            kLevel               },
    { 17,             i8,               "kTxAGC",             kLevel               },
});
constexpr auto kSession = record(code::kEVDOStatus, kSize, {
    { 18,             u16,              "kServingPNOffset",   whole(1, 0, pnOffset).unless(65535, "Invalid Value") },
    { 37,             u8,               "kSessionState",      label(kSessionState) },
    { 38,             u32.bits( 0, 23), "kUATI24",            hexadecimal("0x%06x") },
    { 41,             u8,               "kColorCode",         decimal              },
});
// clang-format on

}  // namespace

void decodeEVDOStatus(ByteView packet, Dictionary&, const DictionaryRef& lookup) {
    if (packet.size() != kSize) {
        logLine(Level::Error, "Log code 0x1183 is %u bytes long but should be %lu bytes.", packet.size(), kSize);
        return;
    }
    const RecordView record(packet);
    C2KStoreFields(record, 0, kReceiver.fields, lookup);
    if (record.read(kDeviceStateAt, u8) < kAccess) {
        C2KStoreNotAvailable(kWithAccess.fields, lookup);
    } else {
        C2KStoreFields(record, 0, kWithAccess.fields, lookup);
    }
    C2KStoreFields(record, 0, kSession.fields, lookup);
}

}  // namespace kelvo
