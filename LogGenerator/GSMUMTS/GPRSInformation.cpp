#include "LogGenerator/GSMUMTS/GPRSInformation.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr ValueTable kControlOrders({
    {   0, "NC0"           },
    {   1, "NC1"           },
    {   2, "NC2"           },
    { 255, "Not Available" },
}, "Unknown");

constexpr ValueTable kFlowContexts({
    {   0, "Not Supported" },
    {   1, "Supported"     },
    { 255, "Available"     },  // not "Not Available", as intended
}, "Unknown");

constexpr ValueTable kAccessThresholds({
    {   0, "Barred (PKT access not allowed in the Cell)" },
    {   1, "Barred"        },
    {   2, "Barred"        },
    {   3, "1 Only"        },
    {   4, "1 to 2"        },
    {   5, "1 to 3"        },
    {   6, "1 to 4"        },
    {   7, "Allowed"       },
    { 255, "Not Available" },
}, "Unknown");

constexpr ValueTable kT3192({
    { 0, "500 ms"  },
    { 1, "1000 ms" },
    { 2, "1500 ms" },
    { 3, "0 ms"    },
    { 4, "80 ms"   },
    { 5, "120 ms"  },
    { 6, "160 ms"  },
    { 7, "200 ms"  },
}, "?? ms");

constexpr ValueTable kSI13Positions({
    {   0, "Located on BCCH"          },
    {   1, "Located on Extended BCCH" },
    { 255, "Not Available"            },
}, "Unknown");

constexpr ValueTable kOperatingModes({
    { 0, "Class 1" },
    { 1, "Class 2" },
    { 2, "Class 3" },
}, "Unknown");

constexpr auto kControl = record(18, {  // 0x51f5
    { 15, u8, "Network Control Order",     label(kControlOrders)                  },
    { 13, u8, "PFC Supported",             label(kFlowContexts)                   },
    { 14, u8, "Priority Access Threshold", label(kAccessThresholds)               },
});

constexpr auto kCellOptions = record(24, {  // 0x51f6
    { 15, u8, "T3192",                     label(kT3192)                          },
    { 17, u8, "Access Burst Type",         flag("11-bit format", "8-bit format")  },
    { 16, u8, "DRX Timer Max",             decimal                                },
});

constexpr auto kBroadcastChannel = record(34, {  // 0x51fb
    { 13, u8, "PBCCH Present",             decimal                                },
});

constexpr auto kSystemInformation = record(35, {  // 0x51fd
    { 16, u8, "Ext Measurement Order",     decimal                                },
    { 13, u8, "Packet PSI Status",         decimal                                },
    { 33, u8, "Packet SI Status",          flag("Supported", "Not Supported")     },
    { 14, u8, "Count LR",                  decimal                                },
    { 15, u8, "Count HR",                  decimal                                },
});

constexpr auto kSI13 = record(15, {  // 0x51f4
    { 14, u8, "SI13 Position",             label(kSI13Positions)                  },
});

constexpr auto kMeasurement = record(29, {  // 0x5137
    { 26, u8, "Cell Reselect Hysteresis",  flag("Applied", "Not Applied")         },
});

constexpr auto kNetwork = record(32, {  // 0x7135
    { 13, u8, "Network Operating Mode",    label(kOperatingModes)                 },
});
// clang-format on

}  // namespace

void GPRSInformation::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "GPRSInformation");
    switch (logCode) {
        case 0x51f5: show(data, kControl); break;
        case 0x51f6: show(data, kCellOptions); break;
        case 0x51fb: show(data, kBroadcastChannel); break;
        case 0x51fd: show(data, kSystemInformation); break;
        case 0x51f4: show(data, kSI13); break;
        case 0x5137: show(data, kMeasurement); break;
        case 0x7135: show(data, kNetwork); break;
        default: reportUnknown(logCode);
    }
}

}  // namespace kelvo
