#pragma once

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// 0x5137: the serving cell's level and criteria (RxLev, C1, C2), and its neighbors'. Two sections show the same bytes,
/// each in its own way.
struct GSMReselectionRecord {
    static constexpr std::size_t kMinimum = 29;

    // clang-format off
    static constexpr auto kServingCell = record(code::kGSMReselection, kMinimum, {  // GSM Serving Cell
        { 15, u8,              "RSSI",                     whole(1, 0, dBm)               },
        { 16, u32.bits(0, 15), "C1 Value",                 decimal                        },
        { 20, u32.bits(0, 15), "C2 Value",                 decimal                        },
    });
    static constexpr auto kQuality = record(code::kGSMReselection, kMinimum, {  // GSM RR Info
        { 15, u8,              "Serving Rx Level",         decimal                        },
        { 16, u32,             "Rx Quality Full",          asSigned                       },
        { 20, u32,             "Rx Quality Sub",           asSigned                       },
    });
    static constexpr auto kHysteresis = record(code::kGSMReselection, kMinimum, {  // GPRS Information
        { 26, u8,              "Cell Reselect Hysteresis", flag("Applied", "Not Applied") },
    });
    static constexpr auto kNeighbor = entry(14, {  // Neighboring Cells; from 29 on; their number is the u8 at 28
        {  0, u16,             "ARFCN",                    decimal                        },
        {  2, u8,              "RSSI",                     decimal                        },
        {  3, u32,             "C1 Value",                 asSigned                       },
    });
    // clang-format on

    static RecordEntries neighbors(RecordView record) { return kNeighbor.entries(kMinimum, record.count(28, u8)); }
};

}  // namespace kelvo
