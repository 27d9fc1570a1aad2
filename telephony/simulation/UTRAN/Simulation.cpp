#include "telephony/simulation/UTRAN/Simulation.h"

#include <utility>

#include "telephony/simulation/UTRAN/Records.h"

namespace kelvo::simulation::utran {
namespace {

using namespace std::chrono_literals;

constexpr Time kStatePeriod = 200ms;
constexpr Time kServingCellPeriod = 1s;
constexpr Time kCellsPeriod = 20s;
constexpr Time kContextsPeriod = 30s;
constexpr Time kSimPeriod = 60s;
constexpr double kDriveRadius = 2000;  // metres
constexpr int kRoutingArea = 1;

}  // namespace

Simulation::Simulation(Random random)
    : _network(random),
      _air{_network, Journey::through(kDriveRadius, random), random.split()},  // braces: the draws have an order
      _modem(_network, _air, std::move(random)) {}

void Simulation::step() {
    _air.moveTo(now());
    _modem.step(now());
    if (_modem.hasChangedState() || every(kStatePeriod)) emit(rrcStateRecord(now(), _modem.rrcState()));
    reportServingCell();
    reportMeasurements();
    reportExtended();
}

void Simulation::reportServingCell() {
    const bool hasChanged = _modem.hasChangedCell() || _modem.hasRegistered();
    if (hasChanged || every(kServingCellPeriod)) emit(servingCellRecord(now(), _modem));
}

// Without a dedicated connection there are no channels to tell of, which is told once.
void Simulation::reportMeasurements() {
    if (_modem.hasMeasured()) {
        emit(cellsRecord(now(), _modem));
        emit(gsmCellsRecord(now(), _modem));
    }
    const bool hasChannels = !_modem.transportChannels().empty();
    if (hasChannels ? _modem.hasMeasured() : _hasShownChannels) emit(channelsRecord(now(), _modem));
    _hasShownChannels = hasChannels;
}

void Simulation::reportExtended() {
    if (_modem.hasChangedCell() || every(kCellsPeriod)) emit(cellInformationRecord(now(), monitoredCells(_modem)));
    if (_modem.hasChangedContexts() || every(kContextsPeriod)) emit(pdpContextsRecord(now(), pdpContexts(_modem)));
    if (_modem.hasRegistered() || every(kSimPeriod)) {
        emit(simFilesRecord(now(), testNetworkSim(_modem.registeredArea(), kRoutingArea)));
    }
}

}  // namespace kelvo::simulation::utran
