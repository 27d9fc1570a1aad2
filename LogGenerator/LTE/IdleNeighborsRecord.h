#pragma once

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/LTE/LTECodes.h"

namespace kelvo {

/// 0xB180: one frequency in idle mode and 1 to 32 neighbor cells on it.
struct IdleNeighborsRecord {
    // clang-format off
    static constexpr auto kFrequency = record(code::kLTENeighborCellsIdle, 21, {
        { 13, u8,               "Version",             decimal                            },
        { 17, u16,              "E-ARFCN",             decimal                            },
        { 19, u8.bits(0, 5),    "Qrxlevmin",           whole(2, -140, dBm)                },
    });
    static constexpr auto kCell = entry(20, {  // from 21 on; their number, less one, is bits 6 to 10 of the u16 at 19
        {  0, u32.bits( 0,  8), "Physical Cell ID",    decimal                            },
        {  0, u32.bits( 9, 16), "Measured RSSI",       linear(0.5,  -140.0, "%4.2f", dBm) },
        {  0, u32.bits(17, 25), "Measured RSRP",       linear(0.5,  -140.0, "%4.2f", dBm) },  // intended: the serving cell's steps are 0.25
        {  4, u32.bits( 0,  8), "Average RSRP",        linear(0.5,  -140.0, "%4.2f", dBm) },
        {  4, u32.bits( 9, 15), "Measured RSRQ",       linear(0.25,  -30.0, "%4.2f", dB)  },
        {  4, u32.bits(16, 22), "Average RSRQ",        linear(0.25,  -30.0, "%4.2f", dB)  },
        {  4, u32.bits(23, 29), "Srxlev",              whole(1, -30, dBm)                 },
        {  8, u16,              "Frequency Offset",    decimal                            },
        { 12, u32.bits( 0, 10), "Ant 0 Frame Offset",  decimal                            },
        { 12, u32.bits(11, 29), "Ant 0 Sample Offset", decimal                            },
        { 12, u32.bits( 0, 10), "Ant 1 Frame Offset",  decimal                            },  // intended: antenna 0's bits;
        { 12, u32.bits(11, 29), "Ant 1 Sample Offset", decimal                            },  // bytes 16 to 19 are not read
    });
    // clang-format on

    static RecordEntries cells(RecordView record) { return kCell.entries(21, record.count(19, u16.bits(6, 10)) + 1); }
};

}  // namespace kelvo
