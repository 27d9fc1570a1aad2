#include "telephony/simulation/ExtendedRecords.h"

#include <cstdio>
#include <string_view>

#include "platform/telephony/TelephonyConstants.h"
#include "telephony/simulation/RecordWriter.h"

namespace kelvo::simulation {
namespace {

struct SimFile {
    std::string_view key;
    std::string SimFiles::*text;
};
struct CellValue {
    std::string_view key;
    std::optional<int> MonitoredCell::*number;
};
struct ContextText {
    std::string_view key;
    std::string PdpContext::*text;
};

// clang-format off
constexpr SimFile kSimFiles[] = {
    { "kSimFile_ICCID",    &SimFiles::iccid    },
    { "kSimFile_MSISDN",   &SimFiles::msisdn   },
    { "kSimFile_MBDN",     &SimFiles::mbdn     },
    { "kSimFile_HPPLMN",   &SimFiles::hpplmn   },
    { "kSimFile_LOCI",     &SimFiles::loci     },
    { "kSimFile_PSLOCI",   &SimFiles::psloci   },
    { "kSimFile_ACC",      &SimFiles::acc      },
    { "kSimFile_AD",       &SimFiles::ad       },
    { "kSimFile_FPLMN",    &SimFiles::fplmn    },
    { "kSimFile_AHPLMN",   &SimFiles::ahplmn   },
    { "kSimFile_RATMODE",  &SimFiles::ratMode  },
    { "kSimFile_PNN",      &SimFiles::pnn      },
    { "kSimFile_OPL",      &SimFiles::opl      },
    { "kSimFile_OPLMNAcT", &SimFiles::oplmnAct },
};

constexpr CellValue kCellValues[] = {
    { kPLCellMonitorMCC,      &MonitoredCell::mcc      },
    { kPLCellMonitorMNC,      &MonitoredCell::mnc      },
    { kPLCellMonitorLAC,      &MonitoredCell::lac      },
    { kPLCellMonitorTAC,      &MonitoredCell::tac      },
    { kPLCellMonitorCellId,   &MonitoredCell::cellId   },
    { kPLCellMonitorPID,      &MonitoredCell::pid      },
    { kPLCellMonitorARFCN,    &MonitoredCell::arfcn    },
    { kPLCellMonitorUARFCN,   &MonitoredCell::uarfcn   },
    { kPLCellMonitorSCN,      &MonitoredCell::scn      },
    { kPLCellMonitorBandInfo, &MonitoredCell::bandInfo },
    { kPLCellMonitorRSSI,     &MonitoredCell::rssi     },
    { kPLCellMonitorRSCP,     &MonitoredCell::rscp     },
    { kPLCellMonitorECN0,     &MonitoredCell::ecn0     },
};

constexpr ContextText kContextTexts[] = {
    { "APN",                &PdpContext::apn     },
    { "PDP Type",           &PdpContext::type    },
    { "State",              &PdpContext::state   },
    { "PDP Address",        &PdpContext::address },
    { "Quality of Service", &PdpContext::qos     },
};
// clang-format on

std::string_view nameOf(MonitoredCell::Technology technology) {
    switch (technology) {
        case MonitoredCell::Technology::GSM: return kPLCellMonitorRadioAccessTechnologyGSM;
        case MonitoredCell::Technology::UMTS: return kPLCellMonitorRadioAccessTechnologyUMTS;
        case MonitoredCell::Technology::UTRAN2: return kPLCellMonitorRadioAccessTechnologyUTRAN2;
        case MonitoredCell::Technology::LTE: break;
    }
    return kPLCellMonitorRadioAccessTechnologyLTE;
}

Value dictionaryOf(const MonitoredCell& cell) {
    const auto dictionary = Dictionary::make({
        {kPLCellMonitorCellRadioAccessTechnology, nameOf(cell.technology)},
        {kPLCellMonitorCellType, cell.isServing ? kPLCellMonitorCellTypeServing : kPLCellMonitorCellTypeNeighbor},
    });
    for (const auto& [key, number] : kCellValues) {
        if (cell.*number) dictionary->set(key, *(cell.*number));
    }
    return dictionary;
}

Value dictionaryOf(const PdpContext& context) {
    const auto dictionary = Dictionary::make({{"Context ID", std::to_string(context.id)}});
    for (const auto& [key, text] : kContextTexts) {
        if (!(context.*text).empty()) dictionary->set(key, context.*text);
    }
    return dictionary;
}

template <class Entry>
Bytes arrayRecord(Time time, std::uint32_t code, std::span<const Entry> entries) {
    const auto array = Array::make();
    for (const Entry& entry : entries) array->append(dictionaryOf(entry));
    return propertyListRecord(time, code, array);
}

std::string hexadecimal(int value, int digits) {
    char text[12];
    std::snprintf(text, sizeof text, "%0*X", digits, static_cast<unsigned>(value));
    return text;
}

enum class UpdateStatus { Updated = 0, NotUpdated = 1 };  // 3GPP TS 31.102, 4.2.17 and 4.2.23

SimFiles simFiles(int locationAreaCode, int routingAreaCode, UpdateStatus updateStatus) {
    const std::string plmn = "00F110";  // 001 01, digits swapped and filled as in 3GPP TS 24.008, 10.5.1.3
    const std::string area = plmn + hexadecimal(locationAreaCode, 4);
    const std::string status = hexadecimal(static_cast<int>(updateStatus), 2);
    return {
        .iccid = "8900101000000123456",
        .msisdn = "+0015550123",
        .mbdn = "+0015550100",
        .hpplmn = "05",
        .loci = "3A9C41D7" + area + "FF" + status,  // TMSI, area, a byte without meaning
        .psloci = "C41B7E02A95D13" + area + hexadecimal(routingAreaCode, 2) + status,
        .acc = "0008",
        .ad = "00000102",  // normal operation; MNC of 2 digits
        .fplmn = "00F120FFFFFFFFFFFFFFFFFF",
        .ahplmn = plmn,
        .ratMode = "00",
        .pnn = "Test Network",
        .opl = plmn + "0000FFFE01",  // every area: the first name
        .oplmnAct = plmn + "C080",   // UTRAN, E-UTRAN and GSM
    };
}

}  // namespace

SimFiles testNetworkSim(int locationAreaCode, int routingAreaCode) {
    return simFiles(locationAreaCode, routingAreaCode, UpdateStatus::Updated);
}

SimFiles testNetworkSim() {
    return simFiles(0xfffe, 0xff, UpdateStatus::NotUpdated);  // both "deleted": 3GPP TS 23.003, 4.1 and 4.2
}

Bytes simFilesRecord(Time time, const SimFiles& files) {
    const auto dictionary = Dictionary::make();
    for (const auto& [key, text] : kSimFiles) {
        if (!(files.*text).empty()) dictionary->set(key, files.*text);
    }
    return propertyListRecord(time, 0xff0000, dictionary);
}

Bytes cellInformationRecord(Time time, std::span<const MonitoredCell> cells) {
    return arrayRecord(time, 0xff0001, cells);
}

Bytes pdpContextsRecord(Time time, std::span<const PdpContext> contexts) {
    return arrayRecord(time, 0xff0002, contexts);
}

}  // namespace kelvo::simulation
