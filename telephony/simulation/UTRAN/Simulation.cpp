#include "telephony/simulation/UTRAN/Simulation.h"

#include "telephony/simulation/UTRAN/Records.h"

namespace kelvo::simulation::utran {
namespace {

using namespace std::chrono_literals;

constexpr int kRoutingArea = 1;

}  // namespace

Simulation::Simulation(std::uint64_t seed) : FamilySimulation(seed, 400ms) {}

void Simulation::step() {
    _user.moveTo(now());
    _air.moveTo(now());
    _modem.step(now(), _user);
    reportServingCell();
    reportMeasurements();
    reportExtended();
}

void Simulation::reportServingCell() {
    if (_rrcState.isDue(now(), _modem.rrcState(), 200ms)) emit(rrcStateRecord(now(), _modem.rrcState()));
    const std::pair cell{_modem.servingIndex(), _modem.isRegistered()};
    if (_servingCell.isDue(now(), cell, 1s)) emit(servingCellRecord(now(), _modem));
}

// Without a dedicated connection there are no channels to tell of, which is told once.
void Simulation::reportMeasurements() {
    if (_modem.hasMeasured()) {
        emit(cellsRecord(now(), _modem));
        emit(gsmCellsRecord(now(), _modem));
    }
    const bool hasChannels = !_modem.transportChannels().empty();
    const bool hasLost = _hadChannels.isDue(now(), hasChannels) && !hasChannels;
    if (hasLost || (hasChannels && _modem.hasMeasured())) emit(channelsRecord(now(), _modem));
}

void Simulation::reportExtended() {
    if (_cells.isDue(now(), _modem.servingIndex(), 20s)) emit(cellInformationRecord(now(), monitoredCells(_modem)));
    if (_contexts.isDue(now(), _modem.contexts(), 30s)) emit(pdpContextsRecord(now(), pdpContexts(_modem)));
    const int area = _modem.registeredArea();
    if (_sim.isDue(now(), area, 60s)) emit(simFilesRecord(now(), testNetworkSim(area, kRoutingArea)));
}

}  // namespace kelvo::simulation::utran
