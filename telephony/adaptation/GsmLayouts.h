#pragma once

#include "telephony/adaptation/LayoutWords.h"

/// The layouts of UMTS and GSM records: the fixed one of each code, and those of newer modems.
namespace kelvo::adaptation::gsm {

// clang-format off

// 0x4005, reselection ranking: the entries of its two lists. Longer entries add at their end what the fixed layout has not.

inline constexpr auto kRankedUmtsCell = fixedLayout(10, {
    { "UARFCN",    0, u16 },
    { "PSC",       2, u16 },
    { "RSCP",      4, u8  },  // s8, - 21 dBm
    { "RSCP rank", 5, u16 },
    { "Ec/Io",     7, u8  },  // s8, 1/2 dB
    { "rank",      8, u16 },
});
consteval auto newerRankedUmtsCell(std::size_t size) {
    return newerLayout(kRankedUmtsCell, size, {
        { "UARFCN",    0, u16 },
        { "PSC",       2, u16 },
        { "RSCP",      4, u8  },
        { "RSCP rank", 5, u16 },
        { "Ec/Io",     7, u8  },
        { "rank",      8, u16 },
    });
}
inline constexpr auto kRankedUmtsCellV0 = newerRankedUmtsCell(10);
inline constexpr auto kRankedUmtsCellV1 = newerRankedUmtsCell(11);
inline constexpr auto kRankedUmtsCellV2 = newerRankedUmtsCell(16);

inline constexpr auto kRankedGsmCell = fixedLayout(7, {
    { "ARFCN", 0, u16 },
    { "BSIC",  2, u16 },
    { "RSSI",  4, u8  },  // s8, dBm
    { "rank",  5, u16 },
});
consteval auto newerRankedGsmCell(std::size_t size) {
    return newerLayout(kRankedGsmCell, size, {
        { "ARFCN", 0, u16.bits(0, 11) },  // the band lies above it
        { "BSIC",  2, u16 },
        { "RSSI",  4, u8  },
        { "rank",  5, u16 },
    });
}
inline constexpr auto kRankedGsmCellV0 = newerRankedGsmCell(7);
inline constexpr auto kRankedGsmCellV1 = newerRankedGsmCell(8);
inline constexpr auto kRankedGsmCellV2 = newerRankedGsmCell(13);

// 0x5137, serving cell and neighbors, and 0x51FC, which holds the same and more

inline constexpr auto kCells = fixedLayout(16, {
    { "ARFCN",       0, u16 },
    { "RxLev",       2, u8  },
    { "C1",          3, u32 },
    { "C2",          7, u32 },
    { "timer",      11, u8  },
    { "barred",     12, u8  },
    { "reselected", 13, u8  },  // in the last 15 s, in which 5 dB of hysteresis apply
    { "count",      15, u8  },
});
inline constexpr auto kExtendedCells = newerLayout(kCells, 26, {
    { "ARFCN",       0, u16.bits(0, 11) },  // the band lies above it
    { "RxLev",       5, u8  },
    { "C1",          6, u32 },
    { "C2",         10, u32 },
    { "timer",      22, u8  },
    { "barred",     23, u8  },
    { "reselected", 24, u8  },
    { "count",      25, u8  },
});
inline constexpr auto kNeighborCell = fixedLayout(14, {
    { "ARFCN",      0, u16 },
    { "RxLev",      2, u8  },
    { "C1",         3, u32 },
    { "C2",         7, u32 },
    { "timer",     11, u8  },
    { "barred",    12, u8  },
    { "same area", 13, u8  },
});
inline constexpr auto kExtendedNeighborCell = newerLayout(kNeighborCell, 25, {
    { "ARFCN",      0, u16.bits(0, 11) },
    { "RxLev",      5, u8  },
    { "C1",         6, u32 },
    { "C2",        10, u32 },
    { "timer",     22, u8  },
    { "barred",    23, u8  },
    { "same area", 24, u8  },
});

// clang-format on

}  // namespace kelvo::adaptation::gsm
