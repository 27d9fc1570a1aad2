#include "LogGenerator/GSMUMTS/NeighboringCells.h"

#include "LogGenerator/CellInfo.h"
#include "platform/Environment.h"
#include "platform/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
constexpr auto kCell = entry(14, {  // 0x5137
    { 0, u16, "ARFCN",    decimal  },
    { 2, u8,  "RSSI",     decimal  },
    { 3, u32, "C1 Value", asSigned },
});

constexpr CellField kNeighbor[] = {  // 32767 is no value
    { kPLCellMonitorARFCN, "ARFCN", "NeighboringCells: Failed to retrieve ARFCN\n"                                          },
    { kPLCellMonitorRSSI,  "RSSI",  "NeighboringCells: Failed to retrieve RSSI\n", whole(2, 0, "%d dBm").unless(32767, "") },
};
// clang-format on

}  // namespace

void NeighboringCells::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "NeighboringCells");
    switch (logCode) {
        case 0x5137: showMeasurements(data); break;
        case 0x51ff: keepIdentities(data); break;
        case 0xff0001: showCellArray(data); break;
        default: reportUnknown(logCode);
    }
}

void NeighboringCells::keepIdentities(ByteView data) {
    if (data.size() < 15) return;
    arfcnToBsic.clear();
    const RecordView record(data);
    const RecordEntries entries(15, 4, static_cast<std::size_t>(record.read(14, u8)));
    for (std::size_t i = 0; i < entries.count() && entries.offsetOf(i) < data.size(); ++i) {
        const std::size_t at = entries.offsetOf(i);
        arfcnToBsic[record.read(at, u16)] = record.read(at + 2, u8);
    }
}

void NeighboringCells::showMeasurements(ByteView data) {
    if (data.size() < 29) return;
    clearElementsInArray(list());
    const RecordView record(data);
    const RecordEntries entries(29, kCell.size, static_cast<std::size_t>(record.read(28, u8)));
    if (entries.count() == 0) return;
    std::vector<Value> cells = rowsOf(data, entries, kCell.fields);
    for (std::size_t i = 0; i < cells.size(); ++i) {
        const auto bsic = arfcnToBsic.find(record.read(entries.offsetOf(i), u16));
        if (bsic == arfcnToBsic.end()) continue;
        print(cells[i].dictionary()->slot("BSIC").text(), bsic->second, decimal);
    }
    replaceArray(list(), std::move(cells));
}

void NeighboringCells::showCellArray(ByteView data) {
    const Value payload = payloadPropertyList(data);
    clearElementsInArray(list());
    const ArrayRef cells = cellsOf(payload);
    if (cells) replaceArray(list(), neighborRows(*cells, kPLCellMonitorRadioAccessTechnologyGSM, kNeighbor));
}

}  // namespace kelvo
