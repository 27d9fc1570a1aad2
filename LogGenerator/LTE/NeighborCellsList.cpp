#include "LogGenerator/LTE/NeighborCellsList.h"

#include "LogGenerator/LTE/IdleNeighborsRecord.h"
#include "platform/system/Environment.h"

namespace kelvo {

namespace {

constexpr std::span<const Field> kFields = IdleNeighborsRecord::kCell.fields;
constexpr NumberFormat kCellLine("Physical Cell ID: %d\n");
constexpr NumberFormat kLevelLine("Measured RSSI: %lf\n");  // intended: this text for all five levels

// Up to two hundred lines a record: the formats print them, several times faster than logLine would.
void reportCells(ByteView data, const RecordEntries& cells) {
    logLine(Level::Warning, "Number of neighboring cells being reported: %d\n", cells.count());
    const RecordView record(data);
    const RecordEntries present = cells.within(data.size());
    std::string line;
    for (std::size_t i = 0; i < present.count(); ++i) {
        const std::size_t cell = present.offsetOf(i);
        kCellLine.print(line, record.read(cell, kFields[0].raw));
        logLine(Level::Warning, line);
        for (const Field& level : kFields.subspan(1, 5)) {  // measured RSSI to average RSRQ
            kLevelLine.print(line, level.shown.measure(record.read(cell + level.at, level.raw))->number);
            logLine(Level::Warning, line);
        }
    }
}

}  // namespace

void NeighborCellsList::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Neighbor Cells List");
    if (logCode != code::kLTENeighborCellsIdle) return reportUnknown(logCode);
    if (data.size() < IdleNeighborsRecord::kFrequency.size) return;
    const RecordEntries cells = IdleNeighborsRecord::cells(RecordView(data));
    if (logWants(Level::Warning)) reportCells(data, cells);
    showRows(list(), data, cells, kFields);
}

}  // namespace kelvo
