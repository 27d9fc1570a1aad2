#include "telephony/phone/PhonePayloads.h"

#include <string_view>

#include "platform/telephony/TelephonyConstants.h"
#include "platform/values/Value.h"

namespace kelvo::phone {
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
    const auto dictionary = Dictionary::make();
    if (context.id) dictionary->set("Context ID", std::to_string(*context.id));
    for (const auto& [key, text] : kContextTexts) {
        if (!(context.*text).empty()) dictionary->set(key, context.*text);
    }
    return dictionary;
}

template <class Entry>
Value arrayOf(std::span<const Entry> entries) {
    const auto array = Array::make();
    for (const Entry& entry : entries) array->append(dictionaryOf(entry));
    return array;
}

}  // namespace

Value simFilesPayload(const SimFiles& files) {
    const auto dictionary = Dictionary::make();
    for (const auto& [key, text] : kSimFiles) {
        if (!(files.*text).empty()) dictionary->set(key, files.*text);
    }
    return dictionary;
}

Value cellInformationPayload(std::span<const MonitoredCell> cells) { return arrayOf(cells); }

Value pdpContextsPayload(std::span<const PdpContext> contexts) { return arrayOf(contexts); }

}  // namespace kelvo::phone
