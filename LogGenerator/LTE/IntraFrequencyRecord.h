#pragma once

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// 0xB179: the serving cell in connected mode, then the cells that were measured beside it, then those only detected.
struct IntraFrequencyRecord {
    // clang-format off
    static constexpr auto kServingCell = record(code::kLTEIntraFrequency, 29, {
        { 17, u16, "E-ARFCN",                  decimal                             },
        { 19, u16, "Serving Physical Cell ID", decimal                             },
        { 21, u16, "Subframe Number",          decimal                             },
        { 23, u16, "Serving Filtered RSRP",    linear(0.25,  -140.0, "%4.2f", dBm) },
        { 25, u16, "Serving Filtered RSRQ",    linear(0.125,  -20.0, "%4.2f", dB)  },
    });
    static constexpr auto kMeasuredCell = entry(6, {  // from 29 on; their number is the u8 at 27
        {  0, u16, "Physical Cell ID",         decimal                             },
        {  2, u16, "Filtered RSRP",            linear(0.25,  -140.0, "%4.2f", dBm) },
        {  4, u16, "Filtered RSRQ",            linear(0.125,  -20.0, "%4.2f", dB)  },
    });
    static constexpr auto kDetectedCell = entry(2, {  // behind the measured cells; their number is the u8 at 28
        {  0, u16, "Physical Cell ID",         decimal                             },
    });
    // clang-format on

    static RecordEntries measuredCells(RecordView record) { return kMeasuredCell.entries(29, record.count(27, u8)); }
    static RecordEntries detectedCells(RecordView record) {
        return kDetectedCell.entries(29 + kMeasuredCell.size * record.count(27, u8), record.count(28, u8));
    }
};

}  // namespace kelvo
