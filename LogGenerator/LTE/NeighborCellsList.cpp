#include "LogGenerator/LTE/NeighborCellsList.h"

#include "platform/system/Environment.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kCell = entry(20, {
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
        kCellLine.print(line, record.read(cell, kCell.fields[0].raw));
        logLine(Level::Warning, line);
        for (const Field& level : std::span(kCell.fields).subspan(1, 5)) {  // RSSI to average RSRQ
            kLevelLine.print(line, level.shown.measure(record.read(cell + level.at, level.raw))->number);
            logLine(Level::Warning, line);
        }
    }
}

}  // namespace

void NeighborCellsList::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "Neighbor Cells List");
    if (logCode != 0xB180) return reportUnknown(logCode);
    if (data.size() < 21) return;
    const auto count = static_cast<std::size_t>(RecordView(data).read(19, u16.bits(6, 10)) + 1);
    const RecordEntries cells(21, kCell.size, count);
    if (logWants(Level::Warning)) reportCells(data, cells);
    showRows(list(), data, cells, kCell.fields);
}

}  // namespace kelvo
