#include "telephony/simulation/LTE/Simulation.h"

#include <utility>

#include "telephony/simulation/LTE/Records.h"

namespace kelvo::simulation::lte {
namespace {

using namespace std::chrono_literals;

constexpr Time kServingCellPeriod = 5s;
constexpr Time kCellsPeriod = 20s;
constexpr Time kContextsPeriod = 30s;
constexpr Time kSimPeriod = 60s;
constexpr double kDriveRadius = 2000;  // metres
constexpr int kRoutingArea = 1;

}  // namespace

Simulation::Simulation(Random random)
    : _network(random),
      _air{_network, Journey::through(kDriveRadius, random), random},  // braces: the draws have an order
      _modem(_network, _air, std::move(random)) {}

void Simulation::step() {
    _air.moveTo(now());
    _modem.step(now());
    reportServingCell();
    reportMeasurements();
    reportExtended();
}

void Simulation::reportServingCell() {
    if (_modem.hasChangedCell()) emit(antennasRecord(now(), _modem.serving()));
    if (_modem.hasChangedCell() || every(kServingCellPeriod)) emit(servingCellRecord(now(), _modem.serving()));
}

void Simulation::reportMeasurements() {
    if (!_modem.hasMeasured()) return;
    if (_modem.isConnected()) return emit(connectedMeasurementRecord(now(), _modem));
    emit(servingMeasurementRecord(now(), _modem.serving(), _modem.reading(), _modem.idle()));
    if (!_modem.neighbors().empty()) emit(neighborMeasurementRecord(now(), _modem));
    emit(candidatesRecord(now(), _modem));
}

void Simulation::reportExtended() {
    if (_modem.hasChangedCell() || every(kCellsPeriod, 1s)) emit(cellInformationRecord(now(), monitoredCells(_modem)));
    if (_modem.hasChangedContexts() || every(kContextsPeriod)) emit(pdpContextsRecord(now(), pdpContexts(_modem)));
    if (_modem.hasRegistered() || every(kSimPeriod)) {
        emit(simFilesRecord(now(), testNetworkSim(_modem.registeredArea(), kRoutingArea)));
    }
}

}  // namespace kelvo::simulation::lte
