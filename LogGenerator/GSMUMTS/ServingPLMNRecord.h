#pragma once

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// 0x7135: the network and the areas in which the phone is registered. Two sections show it.
struct ServingPLMNRecord {
    static constexpr std::size_t kMinimum = 32;

    // clang-format off
    static constexpr auto kOperatingModes = ValueTable({
        { 0, "Class 1" },
        { 1, "Class 2" },
        { 2, "Class 3" },
    }, "Unknown");
    static constexpr auto kServiceTypes = ValueTable({
        { 0, "NO_SERVICE"      },
        { 1, "CS_ONLY"         },
        { 2, "PS_ONLY"         },
        { 3, "CS_PS_SERVICE"   },
        { 4, "LIMITED_SERVICE" },
    }, "Unknown");

    static constexpr auto kOperatingMode = record(code::kServingPLMN, kMinimum, {  // GPRS Information
        { 13, u8,              "Network Operating Mode", label(kOperatingModes) },
    });
    static constexpr auto kAreas = record(code::kServingPLMN, kMinimum, {  // Serving PLMN; the network is at 15 to 17
        { 18, u16.bigEndian(), "Location Area Code",     decimal                },
        { 20, u8,              "Routing Area Code",      decimal                },
        { 14, u8,              "Service Type",           label(kServiceTypes)   },
    });
    // clang-format on
};

}  // namespace kelvo
