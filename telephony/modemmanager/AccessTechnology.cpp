#include "telephony/modemmanager/AccessTechnology.h"

namespace kelvo::modemmanager {
namespace {

enum class Kind { None, Gsm, Umts, Cdma, Lte };

struct Named {
    int bit;
    const char* name;
    Kind kind;
};

// clang-format off
constexpr Named kTechnologies[] = {  // MMModemAccessTechnology
    {  1, "GSM",         Kind::Gsm  },
    {  2, "GSM compact", Kind::Gsm  },
    {  3, "GPRS",        Kind::Gsm  },
    {  4, "EDGE",        Kind::Gsm  },
    {  5, "UMTS",        Kind::Umts },
    {  6, "HSDPA",       Kind::Umts },
    {  7, "HSUPA",       Kind::Umts },
    {  8, "HSPA",        Kind::Umts },
    {  9, "HSPA+",       Kind::Umts },
    { 10, "1x",          Kind::Cdma },
    { 11, "EV-DO 0",     Kind::Cdma },
    { 12, "EV-DO A",     Kind::Cdma },
    { 13, "EV-DO B",     Kind::Cdma },
    { 14, "LTE",         Kind::Lte  },
    { 15, "5G",          Kind::None },
    { 16, "LTE-M",       Kind::Lte  },
    { 17, "NB-IoT",      Kind::Lte  },
};
// clang-format on

bool has(std::uint32_t bits, const Named& technology) { return (bits >> technology.bit & 1) != 0; }

// The latest generation counts: LTE with 5G beside it is LTE.
Kind kindOf(std::uint32_t bits) {
    Kind latest = Kind::None;
    for (const Named& technology : kTechnologies) {
        if (has(bits, technology)) latest = std::max(latest, technology.kind);
    }
    return latest;
}

}  // namespace

std::string AccessTechnology::words() const {
    std::string words;
    for (const Named& technology : kTechnologies) {
        if (has(bits, technology)) words += (words.empty() ? "" : ", ") + std::string(technology.name);
    }
    return words;
}

std::optional<Technology> AccessTechnology::family() const {
    switch (kindOf(bits)) {
        case Kind::Gsm:
        case Kind::Umts: return Technology::GSM;
        case Kind::Cdma: return Technology::CDMA;
        case Kind::Lte: return Technology::LTE;
        case Kind::None: break;
    }
    return std::nullopt;
}

std::optional<phone::MonitoredCell::Technology> AccessTechnology::cell() const {
    switch (kindOf(bits)) {
        case Kind::Gsm: return phone::MonitoredCell::Technology::GSM;
        case Kind::Umts: return phone::MonitoredCell::Technology::UMTS;
        case Kind::Lte: return phone::MonitoredCell::Technology::LTE;
        case Kind::Cdma:
        case Kind::None: break;
    }
    return std::nullopt;
}

}  // namespace kelvo::modemmanager
