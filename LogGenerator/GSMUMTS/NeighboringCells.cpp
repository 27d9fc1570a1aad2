#include "LogGenerator/GSMUMTS/NeighboringCells.h"

#include "LogGenerator/GSMUMTS/GSMReselectionRecord.h"
#include "LogGenerator/PhoneServices/CellInfo.h"
#include "LogGenerator/RowWriter.h"
#include "platform/system/Environment.h"
#include "platform/telephony/TelephonyConstants.h"

namespace kelvo {

namespace {

// clang-format off
constexpr CellField kNeighbor[] = {  // 32767 is no value
    { kPLCellMonitorARFCN, "ARFCN", "NeighboringCells: Failed to retrieve ARFCN\n"                                    },
    { kPLCellMonitorRSSI,  "RSSI",  "NeighboringCells: Failed to retrieve RSSI\n", whole(2, 0, dBm).unless(32767, "") },
};
// clang-format on

}  // namespace

void NeighboringCells::updateWithData(ByteView data, LogCode logCode) {
    logLine(Level::Warning, "NeighboringCells");
    switch (logCode) {
        case code::kGSMReselection: showMeasurements(data); break;
        case code::kGSMNeighborIdentities: keepIdentities(data); break;
        case code::kCellArray: showNeighbors(list(), data, kPLCellMonitorRadioAccessTechnologyGSM, kNeighbor); break;
        default: reportUnknown(logCode);
    }
}

void NeighboringCells::keepIdentities(ByteView data) {
    if (data.size() < 15) return;
    arfcnToBsic.clear();
    const RecordView record(data);
    const RecordEntries entries = RecordEntries(15, 4, record.count(14, u8)).within(data.size());
    for (std::size_t i = 0; i < entries.count(); ++i) {
        const std::size_t at = entries.offsetOf(i);
        arfcnToBsic[record.read(at, u16)] = record.read(at + 2, u8);
    }
}

void NeighboringCells::showMeasurements(ByteView data) {
    if (data.size() < GSMReselectionRecord::kMinimum) return;
    const RecordView record(data);
    const RecordEntries entries = GSMReselectionRecord::neighbors(record).within(data.size());
    RowWriter rows(list());
    for (std::size_t i = 0; i < entries.count(); ++i) {
        Dictionary::Rewrite cell = rows.next();
        showFields(cell, record, entries.offsetOf(i), GSMReselectionRecord::kNeighbor.fields);
        const auto bsic = arfcnToBsic.find(record.read(entries.offsetOf(i), u16));
        if (bsic != arfcnToBsic.end()) showValue(cell.next("BSIC"), bsic->second, decimal);
    }
}

}  // namespace kelvo
