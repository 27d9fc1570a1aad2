#pragma once

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// 0x51f6: what the serving cell tells of its packet service. Two sections show the timer at 16, each in its own way.
struct GPRSCellOptionsRecord {
    static constexpr std::size_t kMinimum = 24;

    // clang-format off
    static constexpr auto kT3192 = ValueTable({
        { 0, "500 ms"  },
        { 1, "1000 ms" },
        { 2, "1500 ms" },
        { 3, "0 ms"    },
        { 4, "80 ms"   },
        { 5, "120 ms"  },
        { 6, "160 ms"  },
        { 7, "200 ms"  },
    }, "?? ms");

    static constexpr auto kOptions = record(code::kGPRSCellOptions, kMinimum, {  // GPRS Information
        { 15, u8, "T3192",             label(kT3192)                         },
        { 17, u8, "Access Burst Type", flag("11-bit format", "8-bit format") },
        { 16, u8, "DRX Timer Max",     decimal                               },
    });
    static constexpr auto kDRX = record(code::kGPRSCellOptions, kMinimum, {  // GSM RR Info
        { 16, u8, "DRX Used",          whole(1, 0, inSeconds)                },
    });
    // clang-format on
};

}  // namespace kelvo
