#include "LogGenerator/GSMUMTS/ActiveSet.h"

#include "LogGenerator/RowWriter.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr std::size_t kCellSize = 15;
constexpr std::size_t kMeasurementSize = 44;

// clang-format off
constexpr auto kCell = entry(kCellSize, {
    { 7, u16.bits(0, 12), "Scrambling Code", decimal },
});
// clang-format on
constexpr Raw kSetType = u16.bits(13, 15);  // at 7 as well; 0 is the active set
constexpr Shown kDecibel = whole(1, 0, dB);
constexpr Key kRSCP("RSCP");
constexpr Key kEnergyPerChip("Energy Per Chip");

/// The cell's energy in dB: the first of its three measurements that is there.
std::int64_t energyOf(RecordView record, std::size_t measurement) {
    std::int64_t raw = 0;
    for (std::size_t at : {32, 36, 40}) {
        if (raw == 0) raw = record.read(measurement + at, u32);
    }
    return Base::lookUpECNO(static_cast<std::uint32_t>(raw));
}

}  // namespace

void ActiveSet::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "ActiveSet");
    if (logCode != code::kUMTSCellSets) return reportUnknown(logCode);
    if (data.size() < 16) return;
    showActiveCells(data, RecordView(data).count(15, u8));
}

void ActiveSet::showActiveCells(ByteView data, std::size_t count) const {
    const RecordView record(data);
    const std::int64_t rssi = (record.read(13, i16) + 512) / 10 - 106;
    const RecordEntries cells = RecordEntries(16, kCellSize, count).within(data.size());
    const RecordEntries measurements(16 + kCellSize * count, kMeasurementSize, count);
    RowWriter rows(list());
    for (std::size_t i = 0; i < cells.count(); ++i) {
        if (record.read(cells.offsetOf(i) + 7, kSetType) != 0) continue;
        const std::int64_t energy = energyOf(record, measurements.offsetOf(i));
        Dictionary::Rewrite cell = rows.next();
        showFields(cell, record, cells.offsetOf(i), kCell.fields);
        showValue(cell.next(kRSCP), rssi + energy, kDecibel);
        showValue(cell.next(kEnergyPerChip), energy, kDecibel);
    }
}

}  // namespace kelvo
