#include "telephony/simulation/IFX/Records.h"

#include <fmt/format.h>

#include <cmath>

#include "platform/encodings/PropertyList.h"

namespace kelvo::simulation::ifx {
namespace {

const std::string kMccText = fmt::format("{:03}", kMcc);
const std::string kMncText = fmt::format("{:02}", kMnc);

std::string number(long value) { return fmt::format("{}", value); }
std::string dBm(double value) { return fmt::format("{} dBm", std::lround(value)); }
std::string halfDecibels(double value) { return fmt::format("{:.1f} dB", std::round(value * 2) / 2); }

// 3GPP TS 45.008, section 6.4: a cell needs -104 dBm, and the phone has all the power it may use.
long pathLossCriterion(double rssi) { return std::lround(rssi) + 104; }

Value gsmServing(const Status& status, const GsmCell& cell) {
    return Dictionary::make({{"Technology", "GSM"},
                             {"MCC", kMccText},
                             {"MNC", kMncText},
                             {"LAC", number(cell.area.lac)},
                             {"CellId", number(cell.cellId)},
                             {"BandInfo", "GSM 900"},
                             {"ARFCN", number(cell.arfcn)},
                             {"BSIC", number(cell.bsic)},
                             {"RSSI", dBm(status.rssi)},
                             {"C1", number(pathLossCriterion(status.rssi))}});
}

Value umtsServing(const Status& status, const UmtsCell& cell) {
    return Dictionary::make({{"Technology", "UMTS"},
                             {"MCC", kMccText},
                             {"MNC", kMncText},
                             {"LAC", number(cell.area.lac)},
                             {"CellId", number(cell.cellId)},
                             {"BandInfo", "UMTS 2100"},
                             {"UARFCN", number(UmtsCell::kUarfcn)},
                             {"SCN", number(cell.scramblingCode)},
                             {"RSCP", dBm(status.rscp)},
                             {"ECN0", halfDecibels(status.ecN0)}});
}

Value serving(const Status& status, const Network& network) {
    switch (status.access) {
        case RadioAccess::Gsm: return gsmServing(status, network.gsmCells[status.serving]);
        case RadioAccess::Umts: return umtsServing(status, network.umtsCells[status.serving]);
        default: return "none";
    }
}

Value gsmNeighbor(const GsmNeighbor& neighbor, const GsmCell& cell) {
    const DictionaryRef entry = Dictionary::make({{"ARFCN", number(cell.arfcn)}});
    if (neighbor.identified) entry->set("BSIC", number(cell.bsic));
    if (neighbor.measured) entry->set("RSSI", dBm(neighbor.rssi));
    return entry;
}

Value umtsNeighbor(const UmtsNeighbor& neighbor, const UmtsCell& cell) {
    return Dictionary::make(
        {{"SCN", number(cell.scramblingCode)}, {"RSCP", dBm(neighbor.rscp)}, {"ECN0", halfDecibels(neighbor.ecN0)}});
}

Value neighbors(const Status& status, const Network& network) {
    // The header says how many follow.
    const ArrayRef gsm = Array::make({number(static_cast<long>(status.gsm.size()))});
    for (const GsmNeighbor& neighbor : status.gsm) {
        gsm->append(gsmNeighbor(neighbor, network.gsmCells[neighbor.sector]));
    }
    const ArrayRef umts = Array::make({number(static_cast<long>(status.umts.size()))});
    for (const UmtsNeighbor& neighbor : status.umts) {
        umts->append(umtsNeighbor(neighbor, network.umtsCells[neighbor.sector]));
    }
    return Dictionary::make({{"GSM", gsm}, {"UMTS", umts}});
}

Value registration(const Status& status) {
    const bool first = status.registered == Area{};
    const bool registered = status.registration == Registration::Registered;
    const DictionaryRef entry = Dictionary::make({{"State", registered ? "Registered" : "Updating"}});
    if (status.registration == Registration::Searching) entry->set("State", "Searching");
    if (first) return entry;
    entry->set("MCC", kMccText);
    entry->set("MNC", kMncText);
    entry->set("LAC", number(status.registered.lac));
    entry->set("RAC", number(status.registered.rac));
    return entry;
}

Value connection(const Status& status) {
    if (status.connection == Connection::Idle) return Dictionary::make({{"State", "Idle"}});
    const bool call = status.connection == Connection::Call;
    const bool gsm = status.access == RadioAccess::Gsm;
    const DictionaryRef entry = Dictionary::make({{"State", call ? "Call" : "Packet transfer"}});
    if (call) {
        entry->set("Channel", gsm ? "TCH/F" : "DCH");
    } else {
        entry->set("Channel", gsm ? fmt::format("EGPRS MCS-{}", status.codingScheme) : "HS-DSCH");
        entry->set("Throughput", fmt::format("{} kbit/s", std::lround(status.throughput)));
    }
    entry->set("Errors", fmt::format("{:.1f} %", status.errors * 100));
    entry->set("TxPower", dBm(status.tx));
    return entry;
}

}  // namespace

Bytes cellMonitorRecord(const Status& status, const Network& network) {
    const Value tree = Dictionary::make({{"Serving", Dictionary::make({{"Cell", serving(status, network)}})},
                                         {"Neighbours", neighbors(status, network)},
                                         {"Registration", registration(status)},
                                         {"Connection", connection(status)}});
    return writeXmlPropertyList(tree).value();
}

}  // namespace kelvo::simulation::ifx
