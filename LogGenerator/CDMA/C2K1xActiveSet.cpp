#include "LogGenerator/CDMA/C2K1xActiveSet.h"

#include <cmath>

#include "LogGenerator/CDMA/C2KPilotList.h"

namespace kelvo {

namespace {

constexpr ShownReal kReferencePilotLevel("(ref pilot) %+.2f", dB);

/// What the levels of one active set are measured against.
struct Scale {
    double normaliser;
    double factor;
    int exponent;

    double decibels(std::int64_t energy) const {
        const double total = 9 * normaliser * normaliser * factor;
        const double ratio = std::ldexp(static_cast<double>(energy), 2 * exponent - 3) / total - 1 / normaliser;
        return 10 * std::log10(std::fmax(ratio, 0.00001));  // of a number and a NaN, fmax takes the number
    }
};

/// The pilots' entries: 15 bytes and 6 for each extra one, in whole words.
constexpr std::size_t strideOf(std::size_t extras) { return (6 * extras + 15) / 4 * 4; }

}  // namespace

DictionaryRef C2K1xActiveSet(RecordView record, std::size_t base) {
    const Scale scale{.normaliser = static_cast<double>(record.read(base + 4, u16)),
                      .factor = static_cast<double>(record.read(base + 6, u8)),
                      .exponent = static_cast<int>(record.read(base + 7, u8))};
    const auto count = record.count(base + 8, u8);
    const auto extras = record.count(base + 9, u8);
    const std::int64_t reference = record.read(base + 10, u16);
    const RecordEntries entries = RecordEntries(base + 12, strideOf(extras), count).within(record.size());

    C2KPilotList pilots(entries.count());
    for (std::size_t i = 0; i < entries.count(); ++i) {
        const std::int64_t pn = record.read(entries.offsetOf(i), u16);
        const double level = scale.decibels(record.read(entries.offsetOf(i) + 12 + 4 * extras, u16));
        pilots.add(i, pn, level, pn == reference ? kReferencePilotLevel : kC2KPilotLevel);
    }
    return pilots.rows();
}

}  // namespace kelvo
