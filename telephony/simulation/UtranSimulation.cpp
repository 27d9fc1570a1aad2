#include "telephony/simulation/UtranSimulation.h"

#include <algorithm>

#include "telephony/simulation/UTRAN/UtranRecords.h"

namespace kelvo::simulation {
namespace {

using namespace std::chrono_literals;

constexpr Time kModePeriod = 200ms;
constexpr Time kServingCellPeriod = 1s;
constexpr Time kCellsPeriod = 20s;
constexpr Time kContextsPeriod = 30s;
constexpr Time kSimPeriod = 60s;
constexpr std::size_t kMonitoredNeighbors = 2;
constexpr int kCountryCode = 1;  // ITU-T E.212: a test network, 001 01
constexpr int kNetworkCode = 1;
constexpr int kRoutingArea = 1;

}  // namespace

void UtranSimulation::step() {
    _modem.moveTo(now());
    if (_modem.hasChangedMode() || every(kModePeriod)) emit(utranModeRecord(now(), _modem.mode()));
    reportServingCell();
    reportMeasurements();
    reportExtended();
}

void UtranSimulation::reportServingCell() {
    const bool hasChanged = _modem.hasChangedCell() || _modem.hasRegistered();
    if (hasChanged || every(kServingCellPeriod)) emit(utranServingCellRecord(now(), _modem));
}

// Without a dedicated connection there are no channels to tell of, which is told once.
void UtranSimulation::reportMeasurements() {
    if (_modem.hasMeasured()) {
        emit(utranCellsRecord(now(), _modem));
        emit(utranGsmCellsRecord(now(), _modem));
    }
    const bool hasChannels = !_modem.transportChannels().empty();
    if (hasChannels ? _modem.hasMeasured() : _hasShownChannels) emit(utranChannelsRecord(now(), _modem));
    _hasShownChannels = hasChannels;
}

void UtranSimulation::reportExtended() {
    if (_modem.hasChangedCell() || every(kCellsPeriod)) emit(cellInformationRecord(now(), monitoredCells()));
    if (_modem.hasChangedContexts() || every(kContextsPeriod)) emit(pdpContextsRecord(now(), contexts()));
    if (_modem.hasRegistered() || every(kSimPeriod)) {
        emit(simFilesRecord(now(), testNetworkSim(_modem.registeredArea(), kRoutingArea)));
    }
}

std::vector<MonitoredCell> UtranSimulation::monitoredCells() const {
    using enum MonitoredCell::Technology;
    const UtranCell& serving = _modem.serving();
    std::vector<MonitoredCell> cells = {{.technology = UTRAN2,
                                         .isServing = true,
                                         .mcc = kCountryCode,
                                         .mnc = kNetworkCode,
                                         .lac = serving.locationArea,
                                         .cellId = static_cast<int>(serving.identity),
                                         .uarfcn = serving.uarfcn,
                                         .scn = serving.parameterId,
                                         .bandInfo = serving.band}};
    for (const UtranMeasurement& measured : _modem.measurements()) {
        if (cells.size() > kMonitoredNeighbors) break;
        const UtranCell& cell = _modem.cells()[measured.cell];
        if (measured.cell == _modem.servingIndex()) continue;
        cells.push_back({.technology = UTRAN2,
                         .uarfcn = cell.uarfcn,
                         .scn = cell.parameterId,
                         .rscp = static_cast<int>(measured.rscp)});
    }
    return cells;
}

std::vector<PdpContext> UtranSimulation::contexts() const {
    std::vector<PdpContext> contexts;
    for (const char* apn : _modem.contexts()) {
        const bool isFirst = contexts.empty();
        contexts.push_back({.id = isFirst ? 5 : 6,
                            .apn = apn,
                            .type = "IPv4",
                            .state = "Active",
                            .address = isFirst ? "10.20.30.40" : "10.20.30.41",
                            .qos = "Interactive"});
    }
    return contexts;
}

}  // namespace kelvo::simulation
