#include "telephony/modemmanager/ModemObjects.h"

#include <fmt/format.h>

#include <algorithm>

#include "telephony/modemmanager/AccessTechnology.h"
#include "telephony/modemmanager/CellReader.h"

namespace kelvo::modemmanager {
namespace {

using phone::MonitoredCell;
using phone::PdpContext;

constexpr qsizetype kMostCells = 32;  // so many lie in one message with room to spare
constexpr qsizetype kMostBearers = 32;
constexpr quint32 kAreaAndCell = 1;                           // MMModemLocationSource
enum PortType { Diagnostic = 4, Ignored = 9 };                // MMModemPortType
enum IpFamily { IPv4 = 1, IPv6 = 2, IPv4v6 = 4, NonIp = 8 };  // MMBearerIpFamily

constexpr const char* kConditions[] = {
    // MMModemState, from -1
    "failed",  "of unknown state", "initializing", "locked",        "disabled",   "being disabled", "being enabled",
    "enabled", "searching",        "registered",   "disconnecting", "connecting", "connected",
};
constexpr const char* kRegistrations[] = {
    // MMModem3gppRegistrationState
    "idle",
    "home",
    "searching",
    "denied",
    "unknown",
    "roaming",
    "home, for SMS only",
    "roaming, for SMS only",
    "emergency calls only",
    "home, without fallback for calls",
    "roaming, without fallback for calls",
    "restricted local operator services",
};

template <std::size_t N>
std::string nameIn(const char* const (&names)[N], std::optional<std::int64_t> index) {
    return index && *index >= 0 && *index < static_cast<std::int64_t>(N) ? names[*index] : "";
}

std::string joined(const QStringList& texts) {
    std::string all;
    for (const QString& text : texts) all += (all.empty() ? "" : ", ") + textOf(text);
    return all;
}

std::string typeOf(const QVariantMap& properties) {
    switch (numberOf(properties.value("ip-type")).value_or(0)) {
        case IPv4: return "IPv4";
        case IPv6: return "IPv6";
        case IPv4 | IPv6:
        case IPv4v6: return "IPv4v6";
        case NonIp: return "Non-IP";
        default: return {};
    }
}

std::string stateOf(const QVariantMap& bearer) {
    if (!bearer.contains("Connected")) return {};
    if (isTrue(bearer.value("Suspended"))) return "Suspended";
    return isTrue(bearer.value("Connected")) ? "Active" : "Inactive";
}

std::string addressesOf(const QVariantMap& bearer) {
    std::string addresses = textOf(mapOf(bearer.value("Ip4Config")).value("address"));
    const std::string second = textOf(mapOf(bearer.value("Ip6Config")).value("address"));
    if (!addresses.empty() && !second.empty()) addresses += ", ";
    return addresses + second;
}

// The bit rates that were negotiated, as far as they are told.
std::string qosOf(const QVariantMap& bearer) {
    const QVariantMap stats = mapOf(bearer.value("Stats"));
    std::string qos;
    for (const auto& [key, way] : {std::pair("downlink-speed", "down"), std::pair("uplink-speed", "up")}) {
        const auto rate = numberOf(stats.value(key));  // bit/s
        if (rate && *rate > 0) qos += fmt::format("{}{} kbps {}", qos.empty() ? "" : ", ", *rate / 1000, way);
    }
    return qos;
}

// The settings hold the user's name and password as well, which nobody here reads.
PdpContext contextOf(const QVariantMap& bearer) {
    const QVariantMap properties = mapOf(bearer.value("Properties"));
    PdpContext context{.id = std::nullopt,
                       .apn = textOf(properties.value("apn")),
                       .type = typeOf(properties),
                       .state = stateOf(bearer),
                       .address = addressesOf(bearer),
                       .qos = qosOf(bearer)};
    for (const QVariant& id : {bearer.value("ProfileId"), properties.value("profile-id")}) {
        const auto number = numberOf(id);
        if (!context.id && number && *number >= 0 && *number < 256) context.id = static_cast<int>(*number);
    }
    return context;
}

std::optional<std::vector<PdpContext>> contextsOf(const ModemObjects& known, const QString& modem) {
    if (!known.get(modem, kModem, "Bearers").isValid()) return std::nullopt;
    std::vector<PdpContext> contexts;
    for (const QString& path : bearersOf(known, modem)) {
        const QVariantMap bearer = known.objects.value(path).value(kBearer);
        if (!bearer.isEmpty()) contexts.push_back(contextOf(bearer));
    }
    return contexts;
}

std::vector<phone::DrivenPort> portsOf(const ModemObjects& known, const QString& modem) {
    std::vector<phone::DrivenPort> ports;
    for (const auto& [name, type] : namedNumbersOf(known.get(modem, kModem, "Ports"))) {
        if (type != Ignored) ports.push_back({.name = textOf(name), .isDiagnostic = type == Diagnostic});
    }
    return ports;
}

QVariantMap signalOf(const ModemObjects& known, const QString& modem, MonitoredCell::Technology technology) {
    switch (technology) {
        case MonitoredCell::Technology::GSM: return mapOf(known.get(modem, kSignal, "Gsm"));
        case MonitoredCell::Technology::UMTS: return mapOf(known.get(modem, kSignal, "Umts"));
        case MonitoredCell::Technology::LTE: return mapOf(known.get(modem, kSignal, "Lte"));
        case MonitoredCell::Technology::UTRAN2: break;
    }
    return {};
}

/// The cells that GetCellInfo tells; where none of them serves, the one that the registration tells of, first.
void readCells(phone::PhoneState& phone, const ModemObjects& known, const QString& modem, AccessTechnology access) {
    std::vector<MonitoredCell> cells;
    phone::LteLevels ofCell;
    for (const QVariantMap& told : known.cells.value_or(QList<QVariantMap>()).mid(0, kMostCells)) {
        const auto cell = cellOf(told);
        if (!cell) continue;
        if (cell->isServing && cell->technology == MonitoredCell::Technology::LTE && ofCell == phone::LteLevels{})
            ofCell = levelsOfCell(told);
        cells.push_back(*cell);
    }
    if (std::ranges::none_of(cells, &MonitoredCell::isServing) && access.cell()) {
        const std::string location = known.location ? textOf(known.location->value(kAreaAndCell)) : std::string();
        const std::string network = textOf(known.get(modem, kModem3gpp, "OperatorCode"));
        if (!network.empty() || !location.empty())
            cells.insert(cells.begin(), registeredCell(*access.cell(), network, location));
    }
    const auto serving = std::ranges::find_if(cells, &MonitoredCell::isServing);
    if (serving != cells.end()) setLevels(*serving, signalOf(known, modem, serving->technology));
    phone.lte = levelsOf(signalOf(known, modem, MonitoredCell::Technology::LTE), ofCell);
    if (known.cells || !cells.empty()) phone.cells = std::move(cells);
}

// TD-SCDMA has screens of its own; its access technology is named after UMTS.
std::optional<Technology> familyOf(const phone::PhoneState& phone, AccessTechnology access) {
    const auto isTdScdma = [](const MonitoredCell& cell) {
        return cell.isServing && cell.technology == MonitoredCell::Technology::UTRAN2;
    };
    if (access.cell() == MonitoredCell::Technology::UMTS && phone.cells && std::ranges::any_of(*phone.cells, isTdScdma))
        return Technology::UTRAN;
    return access.family();
}

}  // namespace

QVariant ModemObjects::get(const QString& path, const char* interface, const char* name) const {
    return objects.value(path).value(interface).value(name);
}

QString indexOf(const QString& modem) { return modem.section('/', -1); }

QStringList modemsOf(const ModemObjects& known) {
    QStringList modems;
    for (auto object = known.objects.begin(); object != known.objects.end(); ++object) {
        if (object.value().contains(kModem)) modems.append(object.key());
    }
    std::ranges::sort(modems, {}, [](const QString& modem) { return indexOf(modem).toInt(); });
    return modems;
}

QString simOf(const ModemObjects& known, const QString& modem) { return pathOf(known.get(modem, kModem, "Sim")); }

QStringList bearersOf(const ModemObjects& known, const QString& modem) {
    QStringList bearers = pathsOf(known.get(modem, kModem, "Bearers"));
    const QString initial = pathOf(known.get(modem, kModem3gpp, "InitialEpsBearer"));
    if (!initial.isEmpty() && !bearers.contains(initial)) bearers.prepend(initial);
    return bearers.mid(0, kMostBearers);
}

phone::PhoneState phoneOf(const ModemObjects& known, const QString& modem) {
    phone::PhoneState phone;
    if (modem.isEmpty()) return phone;
    const QString sim = simOf(known, modem);
    const auto bits = numberOf(known.get(modem, kModem, "AccessTechnologies")).value_or(0);
    const AccessTechnology access{static_cast<std::uint32_t>(bits)};
    const std::string maker = textOf(known.get(modem, kModem, "Manufacturer"));
    const std::string model = textOf(known.get(modem, kModem, "Model"));
    phone.modem = textOf(indexOf(modem));
    phone.model = maker + (maker.empty() || model.empty() ? "" : " ") + model;
    phone.equipment = textOf(known.get(modem, kModem, "EquipmentIdentifier"));
    const auto condition = numberOf(known.get(modem, kModem, "State"));
    phone.condition = nameIn(kConditions, condition ? std::optional(*condition + 1) : std::nullopt);
    phone.registration = nameIn(kRegistrations, numberOf(known.get(modem, kModem3gpp, "RegistrationState")));
    phone.network = textOf(known.get(modem, kModem3gpp, "OperatorName"));
    phone.simOperator = textOf(known.get(sim, kSim, "OperatorName"));
    phone.access = access.words();
    phone.ports = portsOf(known, modem);
    phone.sim.iccid = textOf(known.get(sim, kSim, "SimIdentifier"));
    phone.sim.msisdn = joined(textsOf(known.get(modem, kModem, "OwnNumbers")));
    readCells(phone, known, modem, access);
    phone.contexts = contextsOf(known, modem);
    phone.family = familyOf(phone, access);
    return phone;
}

}  // namespace kelvo::modemmanager
