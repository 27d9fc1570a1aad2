#include "telephony/simulation/GSMUMTS/Reports.h"

#include <algorithm>
#include <cmath>

namespace kelvo::simulation::gsm {
namespace {

constexpr double kBandwidth = 3.84e6;       // Hz
constexpr double kFastestCarrier = 14.4e6;  // bit/s, category 10
constexpr double kFirstBlockErrors = 0.1;   // what the choice of block size aims at
constexpr double kSecondCarrierLoss = -1;   // dB
constexpr int kProcesses = 6;
constexpr Time kSubFrame = std::chrono::milliseconds(2);
constexpr Time kRadioFrame = std::chrono::milliseconds(10);
constexpr int kSpeechChannel = 1;
constexpr int kSignallingChannel = 24;
constexpr int kSlots = 3;

GsmNeighbor gsmNeighbor(const World& world, std::size_t sector) {
    const GsmCell& cell = world.network.gsmCells[sector];
    return {cell.arfcn, cell.bsic, world.air.gsmLevel(sector), world.modem.c1(sector)};
}

MonitoredCell monitoredGsmCell(const World& world, std::size_t sector) {
    return {.technology = MonitoredCell::Technology::GSM,
            .arfcn = world.network.gsmCells[sector].arfcn,
            .rssi = static_cast<int>(std::lround(world.air.gsmLevel(sector) / 2))};
}

MonitoredCell monitoredUmtsCell(const World& world, std::size_t sector) {
    const Air& air = world.air;
    const bool isFound = air.isFound(sector);
    return {.technology = MonitoredCell::Technology::UMTS,
            .uarfcn = kDownlinkUarfcn,
            .scn = world.network.umtsCells[sector].scramblingCode,
            .rscp = isFound ? static_cast<int>(std::lround(air.rscp(sector))) : MonitoredCell::kNoValue,
            .ecn0 = isFound ? static_cast<int>(std::lround(air.ecNo(sector))) : MonitoredCell::kNoValue};
}

MonitoredCell servingCell(const World& world) {
    const std::size_t sector = world.modem.serving();
    const bool isGsm = world.modem.rat() == Rat::GSM;
    MonitoredCell cell = isGsm ? monitoredGsmCell(world, sector) : monitoredUmtsCell(world, sector);
    cell.isServing = true;
    cell.mcc = kMcc;
    cell.mnc = kMnc;
    cell.lac = world.modem.area().lac;
    cell.cellId = isGsm ? world.network.gsmCells[sector].cellId : world.network.umtsCells[sector].cellId;
    return cell;
}

/// The network tells of a site's other sectors, found or not; here of the first that is not.
std::optional<std::size_t> missedSibling(const World& world) {
    if (!world.modem.isOn(Rat::UMTS)) return {};
    const std::size_t first = world.modem.serving() / 3 * 3;
    for (std::size_t sector = first; sector < first + 3; ++sector) {
        if (sector != world.modem.serving() && !world.air.isFound(sector)) return sector;
    }
    return {};
}

int countErrors(int blocks, double rate, Random& random) {
    int errors = 0;
    for (int i = 0; i < blocks; ++i) errors += random.chance(rate);
    return errors;
}

/// All links of the soft handover together.
double combinedEcNo(const World& world) {
    double sum = 0;
    for (const std::size_t sector : world.modem.activeSet().members()) sum += toMilliwatts(world.air.ecNo(sector));
    return toDecibels(sum);
}

std::vector<HarqProcess> harqProcesses(int subFrames, double sinr, double errorRate, Random& random) {
    const double share = random.between(0.3, 0.9);  // others are served in the rest
    const double blockBits = dataRate(sinr) * seconds(kSubFrame);
    std::vector<HarqProcess> processes;
    for (int i = 0; i < kProcesses; ++i) {
        const int blocks = static_cast<int>(subFrames * share / kProcesses) + random.between(0, 2);
        const int errors = countErrors(blocks, errorRate, random);
        processes.push_back({i, static_cast<std::uint32_t>((blocks - errors) * blockBits), blocks, errors});
    }
    return processes;
}

}  // namespace

double blockErrorRate(double ecNo) { return 1 / (1 + std::exp((ecNo + 16) / 1.2)); }

double dataRate(double sinr) { return std::min(linkCapacity(kBandwidth, sinr), kFastestCarrier); }

GsmMeasurement gsmMeasurement(const World& world) {
    const Modem& modem = world.modem;
    const std::size_t serving = modem.serving();
    GsmMeasurement measurement{.level = world.air.gsmLevel(serving),
                               .c1 = modem.c1(serving),
                               .c2 = modem.c2(serving),
                               .isHysteresisApplied = modem.isHysteresisApplied()};
    for (const std::size_t sector : modem.gsmNeighbors()) {
        measurement.neighbors.push_back(gsmNeighbor(world, sector));
    }
    return measurement;
}

RrStatus rrStatus(const World& world) {
    const Modem& modem = world.modem;
    return {modem.rrState(), static_cast<int>(modem.link()), modem.isCamped() ? 1 : 0,
            modem.activity() == Activity::Browsing};
}

ServingNetwork servingNetwork(const World& world) {
    const Modem& modem = world.modem;
    const bool isGsm = modem.rat() == Rat::GSM;
    return {modem.area(), modem.registration().mobility().service,
            isGsm ? world.network.gsmCells[modem.serving()].gprs.networkOperationMode : 0};
}

std::vector<Plmn> equivalentPlmns(const World& world) {
    const auto& registered = world.modem.registration().registered();
    if (!registered || registered->lac % 2 == 0) return {};  // a partner serves every other district
    return {{kMcc, 2}};
}

std::vector<SearchedCell> searchedCells(const World& world) {
    const Modem& modem = world.modem;
    std::vector<SearchedCell> cells;
    const auto add = [&](std::size_t sector, CellSet set) {
        cells.push_back({sector, world.network.umtsCells[sector].scramblingCode, set, world.air.ecNo(sector)});
    };
    const std::size_t serving = modem.serving();
    if (modem.link() == Link::Open) {
        for (const std::size_t sector : modem.activeSet().members()) add(sector, CellSet::Active);
    } else {
        add(serving, CellSet::Active);
    }
    const int site = world.network.umtsSectors[serving].siteNumber;
    for (const std::size_t sector : modem.umtsNeighbors(2)) {
        const bool isTold = world.network.umtsSectors[sector].siteNumber <= site + 6;  // far sites are not in its list
        add(sector, isTold ? CellSet::Monitored : CellSet::Detected);
    }
    if (world.network.umtsCells[serving].hasTwoCarriers) add(serving, CellSet::VirtualActive);
    return cells;
}

std::vector<RankedUmtsCell> rankedUmtsCells(const World& world) {
    std::vector<RankedUmtsCell> cells;
    for (const auto& [sector, rank] : world.modem.rankedUmts()) {
        cells.push_back(
            {world.network.umtsCells[sector].scramblingCode, world.air.rscp(sector), world.air.ecNo(sector), rank});
    }
    return cells;
}

std::vector<RankedGsmCell> rankedGsmCells(const World& world) {
    std::vector<RankedGsmCell> cells;
    for (const auto& [sector, rank] : world.modem.rankedGsm()) {
        const GsmCell& cell = world.network.gsmCells[sector];
        cells.push_back({cell.arfcn, cell.bsic, world.air.gsmLevel(sector), rank});
    }
    return cells;
}

std::vector<MonitoredCell> monitoredCells(const World& world) {
    const bool isGsm = world.modem.rat() == Rat::GSM;
    std::vector<MonitoredCell> cells{servingCell(world)};
    auto neighbors = world.modem.gsmNeighbors();
    neighbors.resize(std::min(neighbors.size(), std::size_t{isGsm ? 2U : 1U}));
    for (const std::size_t sector : neighbors) cells.push_back(monitoredGsmCell(world, sector));
    for (const std::size_t sector : world.modem.umtsNeighbors(isGsm ? 1 : 2)) {
        cells.push_back(monitoredUmtsCell(world, sector));
    }
    if (const auto missed = missedSibling(world)) cells.push_back(monitoredUmtsCell(world, *missed));
    return cells;
}

std::vector<PdpContext> pdpContexts(const World& world, int sessions) {
    if (!world.modem.registration().registered()) return {};
    if (world.modem.activity() != Activity::Browsing) return {{.apn = "internet", .type = "IPv4", .state = "Inactive"}};
    std::vector<PdpContext> contexts{{.apn = "internet",
                                      .type = "IPv4",
                                      .state = "Active",
                                      .address = "10.64.0." + std::to_string(sessions % 250 + 2),
                                      .qos = "Interactive"}};
    if (sessions % 2 == 0) {
        contexts.push_back({6, "mms", "IPv4", "Active", "10.65.0." + std::to_string(sessions % 250 + 2), "Background"});
    }
    return contexts;
}

std::vector<std::optional<double>> transmitPower(const World& world, Random& random) {
    constexpr double kPilot = 23;         // dBm
    constexpr double kWantedBelow = 118;  // dB: sent at 0 dBm, a call just arrives over this path
    constexpr double kDataMore = 6;       // dB
    constexpr double kGap = 0.5;          // of the records tell of one, while GSM is measured in compressed mode
    const double mean = kPilot - world.air.rscp(world.modem.serving()) - kWantedBelow +
                        (world.modem.activity() == Activity::Browsing ? kDataMore : 0);
    std::vector<std::optional<double>> slots;
    for (int i = 0; i < kSlots; ++i) {
        const double fading = std::max(rayleighFading(random), -10.0);
        slots.emplace_back(std::clamp(mean - fading, -50.0, 24.0));
    }
    if (world.modem.isMeasuringGsm() && random.chance(kGap)) slots[random.between(0, kSlots - 1)].reset();
    return slots;
}

BlockErrors blockErrors(const World& world, Time window, Random& random) {
    const int frames = static_cast<int>(window / kRadioFrame);
    const double rate = blockErrorRate(combinedEcNo(world));
    BlockErrors errors{.windowSize = frames};
    const auto add = [&](int id, int blocks) {
        errors.channels.push_back({id, blocks, countErrors(blocks, rate, random)});
    };
    if (world.modem.activity() == Activity::Talking) add(kSpeechChannel, frames / 2);  // a speech frame lasts 20 ms
    add(kSignallingChannel, frames / 4);                                               // a signalling block 40 ms
    return errors;
}

HsdpaReport hsdpaReport(const World& world, Time window, Random& random) {
    const std::size_t serving = world.modem.serving();
    const double sinr = world.air.dataSinr(serving);
    const double errorRate = kFirstBlockErrors + (1 - kFirstBlockErrors) * blockErrorRate(world.air.ecNo(serving));
    HsdpaReport report{.subFrames = static_cast<int>(window / kSubFrame),
                       .hasTwoCarriers = world.network.umtsCells[serving].hasTwoCarriers};
    report.primary = harqProcesses(report.subFrames, sinr, errorRate, random);
    if (report.hasTwoCarriers) {
        report.secondary = harqProcesses(report.subFrames, sinr + kSecondCarrierLoss, errorRate, random);
    }
    return report;
}

}  // namespace kelvo::simulation::gsm
