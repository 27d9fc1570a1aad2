#include "LogGenerator/GSMUMTS/GPRSInformation.h"

#include "LogGenerator/GSMUMTS/GPRSCellOptionsRecord.h"
#include "LogGenerator/GSMUMTS/GSMReselectionRecord.h"
#include "LogGenerator/GSMUMTS/ServingPLMNRecord.h"
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

constexpr ValueTable kSI13Positions({
    {   0, "Located on BCCH"          },
    {   1, "Located on Extended BCCH" },
    { 255, "Not Available"            },
}, "Unknown");

constexpr auto kControl = record(code::kGPRSNetworkControl, 18, {
    { 15, u8, "Network Control Order",     label(kControlOrders)                  },
    { 13, u8, "PFC Supported",             label(kFlowContexts)                   },
    { 14, u8, "Priority Access Threshold", label(kAccessThresholds)               },
});

constexpr auto kBroadcastChannel = record(code::kGPRSBroadcastChannel, 34, {
    { 13, u8, "PBCCH Present",             decimal                                },
});

constexpr auto kSystemInformation = record(code::kGPRSSystemInformation, 35, {
    { 16, u8, "Ext Measurement Order",     decimal                                },
    { 13, u8, "Packet PSI Status",         decimal                                },
    { 33, u8, "Packet SI Status",          flag("Supported", "Not Supported")     },
    { 14, u8, "Count LR",                  decimal                                },
    { 15, u8, "Count HR",                  decimal                                },
});

constexpr auto kSI13 = record(code::kGPRSSI13Position, 15, {
    { 14, u8, "SI13 Position",             label(kSI13Positions)                  },
});
// clang-format on

}  // namespace

void GPRSInformation::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "GPRSInformation");
    showOneOf(data, logCode, kControl, GPRSCellOptionsRecord::kOptions, kBroadcastChannel, kSystemInformation, kSI13,
              GSMReselectionRecord::kHysteresis, ServingPLMNRecord::kOperatingMode);
}

}  // namespace kelvo
