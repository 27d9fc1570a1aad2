#include "LogGenerator/CDMA/C2KSystemIdentification.h"

#include "LogGenerator/CDMA/C2KStoreDisplayValue.h"
#include "LogGenerator/CDMA/CDMACodes.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr std::size_t kMinimum = 171;
constexpr std::int64_t kVersion = 2;
constexpr std::int64_t kSystemWithIds = 2;  // the only type of system that has a SID and a NID

// clang-format off
constexpr ValueTable kRoamingIndicator({
    {  0, "OFF [0]"                            },
    {  1, "ON [1]"                             },
    {  2, "Flashing [2]"                       },
    {  3, "Out of Neighborhood [3]"            },
    {  4, "Out of Building [4]"                },
    {  5, "Preferred system [5]"               },
    {  6, "Available system [6]"               },
    {  7, "Alliance partner [7]"               },
    {  8, "Premium partner [8]"                },
    {  9, "Full service functionality [9]"     },
    { 10, "Partial service functionality [10]" },
    { 11, "Banner ON [11]"                     },
    { 12, "Banner OFF [12]"                    },
}, "ERI - %d");

constexpr Shown kUnknownSystem = Shown::Name{{}, "(unknown system type %d)"};

constexpr auto kRoaming = record(code::kCDMASystem, kMinimum, {
    {  42, i32, "k1xRoamingHome",    label(kRoamingIndicator) },
});
constexpr auto kIds = record(code::kCDMASystem, kMinimum, {
    {  50, u16, "kSystemId",         decimal                  },
    {  52, u16, "kNetworkId",        decimal                  },
});
constexpr auto kNoIds = record(code::kCDMASystem, kMinimum, {
    {  46, i32, "kSystemId",         kUnknownSystem           },
    {  46, i32, "kNetworkId",        kUnknownSystem           },
});
constexpr auto kStation = record(code::kCDMASystem, kMinimum + 15, {  // intended: the base station lies past the least length of a record
    { 131, u8,  "kPacketZoneId",     decimal                  },
    { 184, u16, "kBaseId",           decimal                  },
    { 133, u8,  "kProtocolRevision", decimal                  },
});
// clang-format on

}  // namespace

void decodeSystemIdentification(ByteView packet, Dictionary&, const DictionaryRef& lookup) {
    if (packet.size() < kMinimum) {
        logLine(Level::Error, "Log code 0x134f is %d bytes long but must be at least %lu bytes.", packet.size(),
                kMinimum);
        return;
    }
    const RecordView record(packet);
    const auto version = static_cast<int>(record.read(13, u8));
    if (version < kVersion) {
        logLine(Level::Error, "Log code 0x134f has version=%d; only version 2 or higher expected; dropping.", version);
        return;
    }
    C2KStoreFields(record, 0, kRoaming.fields, lookup);
    if (record.read(46, u32) == kSystemWithIds) {
        C2KStoreFields(record, 0, kIds.fields, lookup);
    } else {
        C2KStoreFields(record, 0, kNoIds.fields, lookup);
    }
    C2KStoreFields(record, 0, kStation.fields, lookup);
}

}  // namespace kelvo
