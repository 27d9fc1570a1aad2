#pragma once

#include "telephony/adaptation/LayoutWords.h"

/// The layouts of LTE records: the fixed one of each code, and those of newer modems. Where a value lies in a range of
/// bits, the number is the little-endian word at the offset.
namespace kelvo::adaptation::lte {

// clang-format off

inline constexpr Steps kRsrpQuarter = steps(1, 4, -140);    // dBm
inline constexpr Steps kRsrpHalf    = steps(1, 2, -140);
inline constexpr Steps kRsrp16      = steps(1, 16, -180);
inline constexpr Steps kRsrqEighth  = steps(1, 8, -20);     // dB
inline constexpr Steps kRsrqQuarter = steps(1, 4, -30);
inline constexpr Steps kRsrq16      = steps(1, 16, -30);
inline constexpr Steps kRssiHalf    = steps(1, 2, -140);    // dBm
inline constexpr Steps kRssi16      = steps(1, 16, -110);

// 0xB0C1, master information block (3GPP TS 36.331)

inline constexpr auto kMasterInformation = fixedLayout(9, {
    { "version",            0, u8  },
    { "PCI",                1, u16 },
    { "EARFCN",             3, u16 },
    { "frame number",       5, u16 },
    { "antenna ports",      7, u8  },
    { "resource blocks",    8, u8  },
});
/// Versions 2 and 3 differ in their length alone.
consteval auto newerMasterInformation(std::size_t size) {
    return newerLayout(kMasterInformation, size, {
        always("version", 1),
        { "PCI",                1, u16 },
        { "EARFCN",             3, u32, Turn::Channel },
        { "frame number",       7, u16 },
        { "antenna ports",      9, u8  },
        { "resource blocks",   10, u8  },
    });
}
inline constexpr auto kMasterInformationV2 = newerMasterInformation(11);
inline constexpr auto kMasterInformationV3 = newerMasterInformation(12);
inline constexpr auto kMasterInformationV17 = newerLayout(kMasterInformation, 18, {  // narrow-band
    always("version", 1),
    { "PCI",                1, u16 },
    { "EARFCN",             3, u32, Turn::Channel },
    { "frame number",       7, u16 },
    { "antenna ports",     17, u8  },
    notToBeHad("resource blocks", 0),
});

// 0xB0C2, serving cell

inline constexpr auto kServingCell = fixedLayout(25, {
    { "version",             0, u8  },
    { "PCI",                 1, u16 },
    { "EARFCN down",         3, u16 },
    { "EARFCN up",           5, u16 },
    { "resource blocks down", 7, u8 },
    { "resource blocks up",  8, u8  },
    { "cell identity",       9, u32 },
    { "tracking area code", 13, u16 },
    { "band",               15, u32 },
    { "MCC",                19, u16 },
    { "MNC digits",         21, u8  },
    { "MNC",                22, u16 },
    { "allowed access",     24, u8  },
});
inline constexpr auto kServingCellV3 = newerLayout(kServingCell, 29, {
    always("version", 2),
    { "PCI",                 1, u16 },
    { "EARFCN down",         3, u32, Turn::Channel },
    { "EARFCN up",           7, u32, Turn::Channel },
    { "resource blocks down", 11, u8 },
    { "resource blocks up", 12, u8  },
    { "cell identity",      13, u32 },
    { "tracking area code", 17, u16 },
    { "band",               19, u32 },
    { "MCC",                23, u16 },
    { "MNC digits",         25, u8  },
    { "MNC",                26, u16 },
    { "allowed access",     28, u8  },
});

// 0xB179, connected mode, intra-frequency: header, measured entries, detected entries

inline constexpr auto kConnected = fixedLayout(16, {
    { "version",             0, u8  },
    { "EARFCN",              4, u16 },
    { "PCI",                 6, u16 },
    { "frame and sub-frame", 8, u16 },
    { "filtered RSRP",      10, u16, kRsrpQuarter },
    { "filtered RSRQ",      12, u16, kRsrqEighth },
    { "measured cells",     14, u8  },
    { "detected cells",     15, u8  },
});
/// Versions 3 and 4 differ in the width of the channel, and so in where the PCI and what follows it start.
consteval auto newerConnected(std::size_t size, NewerField earfcn, int pci) {
    return newerLayout(kConnected, size, {
        always("version", 2),
        earfcn,
        { "PCI",                 pci,      u16 },
        { "frame and sub-frame", pci +  2, u16 },
        { "filtered RSRP",       pci +  4, i16, kRsrp16 },
        { "filtered RSRQ",       pci +  8, i16, kRsrq16 },
        { "measured cells",      pci + 12, u8  },
        { "detected cells",      pci + 13, u8  },
    });
}
inline constexpr auto kConnectedV3 = newerConnected(24, { "EARFCN", 8, u16 }, 10);
inline constexpr auto kConnectedV4 = newerConnected(28, { "EARFCN", 8, u32, Turn::Channel }, 12);
inline constexpr auto kMeasuredCell = fixedLayout(6, {
    { "PCI",  0, u16 },
    { "RSRP", 2, u16, kRsrpQuarter },
    { "RSRQ", 4, u16, kRsrqEighth },
});
inline constexpr auto kMeasuredCellV3 = newerLayout(kMeasuredCell, 12, {
    { "PCI",  0, u16 },
    { "RSRP", 2, i16, kRsrp16 },  // and again at 4
    { "RSRQ", 6, i16, kRsrq16 },  // and again at 8
});
inline constexpr auto kDetectedCell   = fixedLayout(2, {{ "PCI", 0, u16 }});
inline constexpr auto kDetectedCellV3 = newerLayout(kDetectedCell, 16, {{ "PCI", 0, u32 }});
inline constexpr auto kDetectedCellV4 = newerLayout(kDetectedCell, 16, {{ "PCI", 0, u16 }});

// 0xB17F, serving cell, idle

inline constexpr auto kIdle = fixedLayout(20, {
    { "version",             0, u8  },
    { "release flag",        1, u8  },
    { "EARFCN",              4, u16 },
    { "PCI",                 6, u16.bits( 0,  8) },
    { "layer priority",      6, u16.bits( 9, 12) },
    { "measured RSRP",       8, u32.bits( 0,  8), kRsrpQuarter },
    { "averaged RSRP",       8, u32.bits( 9, 17), kRsrpQuarter },
    { "measured RSRQ",       8, u32.bits(18, 24), kRsrqQuarter },
    { "averaged RSRQ",       8, u32.bits(25, 31), kRsrqQuarter },
    { "RSSI",               12, u32.bits( 0,  8), kRssiHalf },
    { "Qrxlevmin",          12, u32.bits( 9, 14) },
    { "P_Max",              12, u32.bits(15, 21) },
    { "maximum power",      12, u32.bits(22, 27) },
    { "Srxlev",             16, u32.bits( 0,  6), steps(1, 1, -30) },
    { "DRX cycles",         16, u32.bits( 7, 12) },
    { "S intra",            16, u32.bits(13, 18) },
    { "S non intra",        16, u32.bits(19, 24) },
    { "rules updated",      16, u32.bit(25) },
    { "rules",              16, u32.bits(26, 29) },
});

/// Versions 3 to 5 differ in the width of the channel, and so in where the PCI and the words behind it start.
consteval auto newerIdle(std::size_t size, NewerField earfcn, int pci, int words) {
    return newerLayout(kIdle, size, {
        always("version", 2),
        { "release flag",    1, u8 },
        earfcn,
        { "PCI",            pci, u16.bits(0, 8) },
        { "layer priority", pci, u16.bits(9, 15), Turn::Cut },
        { "measured RSRP",  words,      u32.bits( 0, 11), kRsrp16 },
        { "averaged RSRP",  words +  4, u32.bits( 0, 11), kRsrp16 },
        { "measured RSRQ",  words +  8, u32.bits( 0,  9), kRsrq16 },
        { "averaged RSRQ",  words +  8, u32.bits(20, 29), kRsrq16 },
        { "RSSI",           words + 12, u32.bits(10, 20), kRssi16 },
        { "Qrxlevmin",      words + 16, u32.bits( 0,  5) },
        { "P_Max",          words + 16, u32.bits( 6, 12) },
        { "maximum power",  words + 16, u32.bits(13, 18) },
        { "Srxlev",         words + 16, u32.bits(19, 25), steps(1, 1, -50) },
        { "DRX cycles",     words + 16, u32.bits(26, 31) },
        { "S intra",        words + 20, u32.bits( 0,  5), Turn::Search },
        { "S non intra",    words + 20, u32.bits( 6, 11), Turn::Search },
        { "rules updated",  words + 20, u32.bit(12) },
        { "rules",          words + 20, u32.bits(13, 16) },
    });
}
inline constexpr auto kIdleV3 = newerIdle(32, { "EARFCN", 4, u16 }, 6, 8);  // and version 4
inline constexpr auto kIdleV5 = newerIdle(36, { "EARFCN", 4, u32, Turn::Channel }, 8, 12);
inline constexpr std::size_t kRelease9Word = 4;  // behind either, when the release flag is 1

// 0xB180, neighbors, idle: header and entries

inline constexpr auto kNeighbors = fixedLayout(8, {
    { "version",   0, u8  },
    { "EARFCN",    4, u16 },
    { "Qrxlevmin", 6, u16.bits(0, 5) },
});
inline constexpr FixedField kNeighborCountLessOne{"number of cells, less one", 6, u16.bits(6, 10)};
inline constexpr auto kNeighborsV4 = newerLayout(kNeighbors, 8, {
    always("version", 2),
    { "EARFCN",    4, u16 },
    { "Qrxlevmin", 6, u16.bits(0, 5) },
});
inline constexpr auto kNeighborsV5 = newerLayout(kNeighbors, 12, {
    always("version", 2),
    { "EARFCN",    4, u32, Turn::Channel },
    { "Qrxlevmin", 8, u32.bits(0, 5) },
});
inline constexpr auto kNeighbor = fixedLayout(20, {
    { "PCI",                0, u32.bits( 0,  8) },
    { "RSSI",               0, u32.bits( 9, 16), kRssiHalf },
    { "RSRP",               0, u32.bits(17, 25), kRsrpHalf },
    { "averaged RSRP",      4, u32.bits( 0,  8), kRsrpHalf },
    { "RSRQ",               4, u32.bits( 9, 15), kRsrqQuarter },
    { "averaged RSRQ",      4, u32.bits(16, 22), kRsrqQuarter },
    { "Srxlev",             4, u32.bits(23, 29) },
    { "frequency offset",   8, u16 },
    { "frame, antenna 0",  12, u32.bits( 0, 10) },
    { "sample, antenna 0", 12, u32.bits(11, 29) },
    { "frame, antenna 1",  16, u32.bits( 0, 10) },
    { "sample, antenna 1", 16, u32.bits(11, 29) },
});
inline constexpr auto kNeighborV4 = newerLayout(kNeighbor, 28, {  // and version 5
    { "PCI",                0, u32.bits( 0,  8) },
    { "RSSI",               0, u32.bits( 9, 19), kRssi16 },
    { "RSRP",               0, u32.bits(20, 31), kRsrp16 },
    { "averaged RSRP",      4, u32.bits(12, 23), kRsrp16 },
    { "RSRQ",               8, u32.bits(12, 21), kRsrq16 },
    { "averaged RSRQ",     12, u32.bits( 0,  9), kRsrq16 },
    { "Srxlev",            12, u32.bits(20, 25) },
    { "frequency offset",  16, u16 },
    { "frame, antenna 0",  20, u32.bits( 0, 10) },
    { "sample, antenna 0", 20, u32.bits(11, 29) },
    { "frame, antenna 1",  24, u32.bits( 0, 10) },
    { "sample, antenna 1", 24, u32.bits(11, 29) },
});

// 0xB193, serving cell, every mode. Part 25 holds one place for a cell or four; the offsets are those of the first.

/// What the part says of a cell, as fields of 0xB17F. What it does not say comes from the last 0xB17F of the cell, and
/// where there is none it is what the standard takes for silence: no demand on the level (Qrxlevmin 0 is -140 dBm), no
/// limits, power class 3 (23 dBm).
consteval auto anyModeCell(std::size_t size, NewerField pci, NewerField rsrp, NewerField filteredRsrp,
                           NewerField rsrq, NewerField filteredRsrq, NewerField rssi) {
    return newerLayout(kIdle, size, {
        always("version", 2),
        always("release flag", 0),
        { "EARFCN", 0, u32, Turn::Channel },
        pci,
        notToBeHad("layer priority", 0),
        rsrp,
        filteredRsrp,
        rsrq,
        filteredRsrq,
        rssi,
        notToBeHad("Qrxlevmin", 0),
        notToBeHad("P_Max", 64),
        notToBeHad("maximum power", 53),
        { "Srxlev", rsrp.at, rsrp.raw, steps(1, 16, -180 + 140) },
        notToBeHad("DRX cycles", 0),
        notToBeHad("S intra", 32),
        notToBeHad("S non intra", 32),
        notToBeHad("rules updated", 0),
        notToBeHad("rules", 0),
    });
}
inline constexpr auto kAnyModeV18 = anyModeCell(92,
    { "PCI",            4, u16.bits( 0,  8) },
    { "measured RSRP", 28, u32.bits(12, 23), kRsrp16 },
    { "averaged RSRP", 28, u32.bits(12, 23), kRsrp16 },
    { "measured RSRQ", 36, u32.bits(20, 29), kRsrq16 },
    { "averaged RSRQ", 36, u32.bits(20, 29), kRsrq16 },
    { "RSSI",          44, u32.bits( 0, 10), kRssi16 });
inline constexpr auto kAnyModeV19 = anyModeCell(360,
    { "PCI",            8, u16.bits( 0,  8) },
    { "measured RSRP", 32, u32.bits(12, 23), kRsrp16 },
    { "averaged RSRP", 32, u32.bits(12, 23), kRsrp16 },
    { "measured RSRQ", 40, u32.bits(20, 29), kRsrq16 },
    { "averaged RSRQ", 40, u32.bits(20, 29), kRsrq16 },
    { "RSSI",          48, u32.bits( 0, 10), kRssi16 });
inline constexpr auto kAnyModeV36 = anyModeCell(520,
    { "PCI",            8, u16.bits( 0,  8) },
    { "measured RSRP", 40, u32.bits( 0, 11), kRsrp16 },
    { "averaged RSRP", 40, u32.bits(12, 23), kRsrp16 },
    { "measured RSRQ", 52, u32.bits( 0,  9), kRsrq16 },
    { "averaged RSRQ", 52, u32.bits(20, 29), kRsrq16 },
    { "RSSI",          64, u32.bits( 0, 10), kRssi16 });

// clang-format on

}  // namespace kelvo::adaptation::lte
