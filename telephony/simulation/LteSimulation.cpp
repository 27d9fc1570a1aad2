#include "telephony/simulation/LteSimulation.h"

#include <algorithm>

#include "telephony/simulation/LTE/LteRecords.h"

namespace kelvo::simulation {
namespace {

using namespace std::chrono_literals;

constexpr Time kServingCellPeriod = 5s;
constexpr Time kCellsPeriod = 20s;
constexpr Time kContextsPeriod = 30s;
constexpr Time kSimPeriod = 60s;
constexpr std::size_t kMonitoredNeighbors = 2;
constexpr int kCountryCode = 1;  // ITU-T E.212: a test network, 001 01
constexpr int kNetworkCode = 1;

}  // namespace

void LteSimulation::step() {
    _modem.moveTo(now());
    reportServingCell();
    reportMeasurements();
    reportExtended();
}

void LteSimulation::reportServingCell() {
    if (_modem.hasChangedCell()) emit(lteAntennasRecord(now(), _modem.serving()));
    if (_modem.hasChangedCell() || every(kServingCellPeriod)) emit(lteServingCellRecord(now(), _modem.serving()));
}

void LteSimulation::reportMeasurements() {
    if (!_modem.hasMeasured()) return;
    if (_modem.isConnected()) return emit(lteConnectedMeasurementRecord(now(), _modem));
    emit(lteServingMeasurementRecord(now(), _modem.serving(), _modem.reading(), _modem.idle()));
    if (!_modem.neighbors().empty()) emit(lteNeighborMeasurementRecord(now(), _modem));
    emit(lteCandidatesRecord(now(), _modem));
}

void LteSimulation::reportExtended() {
    if (_modem.hasChangedCell() || every(kCellsPeriod, 1s)) emit(cellInformationRecord(now(), monitoredCells()));
    if (_modem.hasChangedContexts() || every(kContextsPeriod)) emit(pdpContextsRecord(now(), contexts()));
    if (_modem.hasRegistered() || every(kSimPeriod)) {
        emit(simFilesRecord(now(), testNetworkSim(_modem.registeredArea(), 1)));
    }
}

std::vector<MonitoredCell> LteSimulation::monitoredCells() const {
    const LteCell& serving = _modem.serving();
    std::vector<MonitoredCell> cells = {{.technology = MonitoredCell::Technology::LTE,
                                         .isServing = true,
                                         .mcc = kCountryCode,
                                         .mnc = kNetworkCode,
                                         .tac = serving.trackingArea,
                                         .cellId = static_cast<int>(serving.identity),
                                         .pid = serving.physicalId,
                                         .uarfcn = serving.carrier.downlink,
                                         .bandInfo = serving.carrier.band}};
    const std::size_t count = std::min(_modem.neighbors().size(), kMonitoredNeighbors);
    for (std::size_t i = 0; i < count; ++i) {
        cells.push_back({.technology = MonitoredCell::Technology::LTE,
                         .pid = _modem.neighbors()[i].physicalId,
                         .uarfcn = _modem.neighborsCarrier().downlink});
    }
    return cells;
}

std::vector<PdpContext> LteSimulation::contexts() const {
    std::vector<PdpContext> contexts = {
        {.id = 5, .apn = "internet", .type = "IPv4v6", .state = "Active", .address = "10.20.30.40", .qos = "QCI 9"},
        {.id = 6, .apn = "ims", .type = "IPv6", .state = "Active", .address = "2001:db8:1::2", .qos = "QCI 5"},
    };
    if (_modem.isOnCall()) contexts.push_back({.id = 7, .apn = "ims", .state = "Active", .qos = "QCI 1"});  // voice
    return contexts;
}

}  // namespace kelvo::simulation
