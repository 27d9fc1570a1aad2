#pragma once

#include "LogGenerator/FieldTable.h"
#include "LogGenerator/GSMUMTS/GSMUMTSCodes.h"

namespace kelvo {

/// 0x4005: UMTS and GSM neighbors in the order of cell reselection.
struct NeighborRankingRecord {
    static constexpr std::size_t kMinimum = 15;

    // clang-format off
    static constexpr auto kUMTSCell = entry(10, {  // their number is the u8 at 13
        { 2, u16, "Scrambling Code",    decimal                    },
        { 4, i8,  "RSCP",               whole(1, -21, dB)          },
        { 7, i8,  "Energy Per Chip",    linear(0.5, 0.0, "%f", dB) },
        { 0, i16, "Downlink Frequency", decimal                    },
        { 8, i16, "Ranking Value",      decimal                    },
        { 5, i16, "Rank Cell RSCP",     whole(1, 0, dB)            },
    });
    static constexpr auto kGSMCell = entry(7, {  // their number is the u8 at 14
        { 0, u16, "ARFCN",              decimal                    },
        { 2, u16, "BSIC",               decimal                    },
        { 4, i8,  "RSSI",               whole(1, 0, dBm)           },
        { 5, i16, "Ranking Value",      decimal                    },
    });
    // clang-format on

    // Intended: both lists begin at 15.
    static RecordEntries umtsCells(RecordView record) { return kUMTSCell.entries(kMinimum, record.count(13, u8)); }
    static RecordEntries gsmCells(RecordView record) { return kGSMCell.entries(kMinimum, record.count(14, u8)); }
};

}  // namespace kelvo
