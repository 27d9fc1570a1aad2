#include "overview/Bands.h"

#include <fmt/format.h>

#include <span>
#include <string_view>

namespace kelvo::overview {
namespace {

/// Channels that lie side by side: the downlink's carrier is base + spacing x (number - first).
struct Range {
    std::string_view band;
    std::int64_t first;
    std::int64_t last;
    double downMHz;  ///< of `first`
    double upMHz;    ///< likewise; kNoUplink, or kBoth for a band with one carrier
    double spacing;  ///< MHz
};
constexpr double kNoUplink = -1;
constexpr double kBoth = 0;

struct LteBand {
    int band;
    std::int64_t first;
    std::int64_t last;
    double downMHz;
    double upMHz;
    std::int64_t firstUp;  ///< the EARFCN of the uplink's first channel
};

// clang-format off
constexpr LteBand kLte[] = {
    //     EARFCN        down     up
    {  1,     0,   599, 2110,   1920,   18000 },
    {  2,   600,  1199, 1930,   1850,   18600 },
    {  3,  1200,  1949, 1805,   1710,   19200 },
    {  4,  1950,  2399, 2110,   1710,   19950 },
    {  5,  2400,  2649,  869,    824,   20400 },
    {  6,  2650,  2749,  875,    830,   20650 },
    {  7,  2750,  3449, 2620,   2500,   20750 },
    {  8,  3450,  3799,  925,    880,   21450 },
    {  9,  3800,  4149, 1844.9, 1749.9, 21800 },
    { 10,  4150,  4749, 2110,   1710,   22150 },
    { 11,  4750,  4949, 1475.9, 1427.9, 22750 },
    { 12,  5010,  5179,  729,    699,   23010 },
    { 13,  5180,  5279,  746,    777,   23180 },
    { 14,  5280,  5379,  758,    788,   23280 },
    { 17,  5730,  5849,  734,    704,   23730 },
    { 18,  5850,  5999,  860,    815,   23850 },
    { 19,  6000,  6149,  875,    830,   24000 },
    { 20,  6150,  6449,  791,    832,   24150 },
    { 21,  6450,  6599, 1495.9, 1447.9, 24450 },
    { 22,  6600,  7399, 3510,   3410,   24600 },
    { 23,  7500,  7699, 2180,   2000,   25500 },
    { 24,  7700,  8039, 1525,   1626.5, 25700 },
    { 25,  8040,  8689, 1930,   1850,   26040 },
    { 26,  8690,  9039,  859,    814,   26690 },
    { 27,  9040,  9209,  852,    807,   27040 },
    { 28,  9210,  9659,  758,    703,   27210 },
    { 29,  9660,  9769,  717,   kNoUplink,  0 },
    { 30,  9770,  9869, 2350,   2305,   27660 },
    { 31,  9870,  9919,  462.5,  452.5, 27760 },
    { 32,  9920, 10359, 1452,   kNoUplink,  0 },
    { 33, 36000, 36199, 1900,   kBoth,  36000 },
    { 34, 36200, 36349, 2010,   kBoth,  36200 },
    { 35, 36350, 36949, 1850,   kBoth,  36350 },
    { 36, 36950, 37549, 1930,   kBoth,  36950 },
    { 37, 37550, 37749, 1910,   kBoth,  37550 },
    { 38, 37750, 38249, 2570,   kBoth,  37750 },
    { 39, 38250, 38649, 1880,   kBoth,  38250 },
    { 40, 38650, 39649, 2300,   kBoth,  38650 },
    { 41, 39650, 41589, 2496,   kBoth,  39650 },
    { 42, 41590, 43589, 3400,   kBoth,  41590 },
    { 43, 43590, 45589, 3600,   kBoth,  43590 },
    { 44, 45590, 46589,  703,   kBoth,  45590 },
    { 45, 46590, 46789, 1447,   kBoth,  46590 },
    { 46, 46790, 54539, 5150,   kBoth,  46790 },
    { 47, 54540, 55239, 5855,   kBoth,  54540 },
    { 48, 55240, 56739, 3550,   kBoth,  55240 },
    { 49, 56740, 58239, 3550,   kBoth,  56740 },
    { 50, 58240, 59089, 1432,   kBoth,  58240 },
    { 51, 59090, 59139, 1427,   kBoth,  59090 },
    { 52, 59140, 60139, 3300,   kBoth,  59140 },
};

constexpr Range kUtraFdd[] = {
    // band     UARFCN        down     up     MHz a channel
    { "I",     10562, 10838, 2112.4, 1922.4, 0.2 },
    { "II",     9662,  9938, 1932.4, 1852.4, 0.2 },
    { "III",    1162,  1513, 1807.4, 1712.4, 0.2 },
    { "IV",     1537,  1738, 2112.4, 1712.4, 0.2 },
    { "V",      4357,  4458,  871.4,  826.4, 0.2 },
    { "VI",     4387,  4413,  877.4,  832.4, 0.2 },
    { "VII",    2237,  2563, 2622.4, 2502.4, 0.2 },
    { "VIII",   2937,  3088,  927.4,  882.4, 0.2 },
    { "IX",     9237,  9387, 1847.4, 1752.4, 0.2 },
    { "X",      3112,  3388, 2112.4, 1712.4, 0.2 },
    { "XI",     3712,  3787, 1478.4, 1430.4, 0.2 },
    { "XII",    3842,  3903,  731.4,  701.4, 0.2 },
    { "XIII",   4017,  4043,  748.4,  779.4, 0.2 },
    { "XIV",    4117,  4143,  760.4,  790.4, 0.2 },
    { "XIX",     712,   763,  877.4,  832.4, 0.2 },
    { "XX",     4512,  4638,  793.4,  834.4, 0.2 },
    { "XXI",     862,   912, 1498.4, 1450.4, 0.2 },
    { "XXII",   4662,  5038, 3512.4, 3412.4, 0.2 },
    { "XXV",    5112,  5438, 1932.4, 1852.4, 0.2 },
    { "XXVI",   5762,  5913,  861.4,  816.4, 0.2 },
    // The additional channels, 100 kHz off the raster: every 25th number, 5 MHz apart.
    { "II",      412,   687, 1932.5, 1852.5, 0.2 },
    { "IV",     1887,  2087, 2112.5, 1712.5, 0.2 },
    { "V",      1007,  1087,  871.5,  826.5, 0.2 },
};

constexpr Range kUtraTdd[] = {
    { "a", 9504, 9596, 1900.8, kBoth, 0.2 },
    { "a", 10054, 10121, 2010.8, kBoth, 0.2 },
    { "b", 9254, 9546, 1850.8, kBoth, 0.2 },
    { "b", 9654, 9946, 1930.8, kBoth, 0.2 },
    { "c", 9554, 9646, 1910.8, kBoth, 0.2 },
    { "d", 12854, 13096, 2570.8, kBoth, 0.2 },
    { "e", 11504, 11996, 2300.8, kBoth, 0.2 },
    { "f", 9404, 9596, 1880.8, kBoth, 0.2 },
};

constexpr Range kGsm[] = {
    { "GSM 900",    0,  124,  935.0,  890.0, 0.2 },
    { "GSM 900",  955, 1023,  921.2,  876.2, 0.2 },
    { "DCS 1800", 512,  885, 1805.2, 1710.2, 0.2 },
    { "PCS 1900", 512,  810, 1930.2, 1850.2, 0.2 },
    { "GSM 850",  128,  251,  869.2,  824.2, 0.2 },
    { "GSM 450",  259,  293,  460.6,  450.6, 0.2 },
    { "GSM 480",  306,  340,  489.0,  479.0, 0.2 },
    { "GSM 710",  438,  511,  747.2,  777.2, 0.2 },
};
// clang-format on

struct CdmaRange {
    int bandClass;
    Range range;
};
// clang-format off
constexpr CdmaRange kCdma[] = {
    {  0, { "BC 0",     1,  799,  870.03,    825.03,   0.03   } },
    {  0, { "BC 0",   991, 1023,  869.04,    824.04,   0.03   } },
    {  0, { "BC 0",  1024, 1323,  860.04,    815.04,   0.03   } },
    {  1, { "BC 1",     0, 1199, 1930.0,    1850.0,    0.05   } },
    {  2, { "BC 2",     0, 1000,  917.0125,  872.0125, 0.025  } },
    {  3, { "BC 3",     1,  799,  860.0125,  915.0125, 0.0125 } },
    {  3, { "BC 3",   801, 1039,  843.0125,  898.0125, 0.0125 } },
    {  3, { "BC 3",  1041, 1199,  832.0125,  887.0125, 0.0125 } },
    {  3, { "BC 3",  1201, 1600,  838.0125,  893.0125, 0.0125 } },
    {  4, { "BC 4",     0,  599, 1840.0,    1750.0,    0.05   } },
    {  5, { "BC 5",     1,  400,  460.0,     450.0,    0.025  } },
    {  6, { "BC 6",     0, 1199, 2110.0,    1920.0,    0.05   } },
    {  7, { "BC 7",     0,  240,  746.0,     776.0,    0.05   } },
    {  8, { "BC 8",     0, 1499, 1805.0,    1710.0,    0.05   } },
    {  9, { "BC 9",     0,  699,  925.0,     880.0,    0.05   } },
    { 10, { "BC 10",    0,  719,  851.0,     806.0,    0.025  } },
    { 10, { "BC 10",  720,  919,  935.0,     896.0,    0.025  } },
    { 12, { "BC 12",    0,  239,  915.0125,  870.0125, 0.025  } },
};
// clang-format on

BandChannel channelIn(const Range& range, std::int64_t number) {
    const double offset = range.spacing * static_cast<double>(number - range.first);
    BandChannel channel{std::string(range.band), range.downMHz + offset, std::nullopt};
    if (range.upMHz == kBoth) {
        channel.upMHz = channel.downMHz;
    } else if (range.upMHz != kNoUplink) {
        channel.upMHz = range.upMHz + offset;
    }
    return channel;
}

std::vector<BandChannel> bandsIn(std::span<const Range> ranges, std::int64_t number) {
    std::vector<BandChannel> bands;
    for (const Range& range : ranges) {
        if (number >= range.first && number <= range.last) bands.push_back(channelIn(range, number));
    }
    return bands;
}

}  // namespace

std::vector<BandChannel> lteBands(std::int64_t earfcn) {
    std::vector<BandChannel> bands;
    for (const LteBand& band : kLte) {
        if (earfcn < band.first || earfcn > band.last) continue;
        const std::string name = std::to_string(band.band);
        bands.push_back(channelIn({name, band.first, band.last, band.downMHz, band.upMHz, 0.1}, earfcn));
    }
    return bands;
}

std::vector<BandChannel> utraFddBands(std::int64_t uarfcn) { return bandsIn(kUtraFdd, uarfcn); }

std::vector<BandChannel> utraTddBands(std::int64_t uarfcn) { return bandsIn(kUtraTdd, uarfcn); }

std::vector<BandChannel> gsmBands(std::int64_t arfcn) { return bandsIn(kGsm, arfcn); }

std::vector<BandChannel> cdmaBands(std::int64_t bandClass, std::int64_t channel) {
    std::vector<BandChannel> bands;
    for (const CdmaRange& entry : kCdma) {
        if (entry.bandClass != bandClass || channel < entry.range.first || channel > entry.range.last) continue;
        bands.push_back(channelIn(entry.range, channel));
    }
    return bands;
}

std::optional<double> lteUplinkMHz(std::int64_t earfcn) {
    for (const LteBand& band : kLte) {
        if (band.upMHz == kNoUplink) continue;
        const std::int64_t count = band.last - band.first;
        if (earfcn < band.firstUp || earfcn > band.firstUp + count) continue;
        const double base = band.upMHz == kBoth ? band.downMHz : band.upMHz;
        return base + 0.1 * static_cast<double>(earfcn - band.firstUp);
    }
    return std::nullopt;
}

}  // namespace kelvo::overview
