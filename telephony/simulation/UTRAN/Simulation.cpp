#include "telephony/simulation/UTRAN/Simulation.h"

#include "telephony/simulation/UTRAN/Records.h"

namespace kelvo::simulation::utran {

using namespace std::chrono_literals;

Simulation::Simulation(std::uint64_t seed) : RegisteredSimulation(seed, 400ms) {}

void Simulation::reportServingCell() {
    if (_rrcState.isDue(now(), _modem.rrcState(), 200ms)) emit(rrcStateRecord(now(), _modem.rrcState()));
    const std::pair cell{_modem.servingIndex(), _modem.isRegistered()};
    if (_servingCell.isDue(now(), cell, 1s)) emit(servingCellRecord(now(), _modem));
}

// Without a dedicated connection there are no channels, which is reported once.
void Simulation::reportMeasurements() {
    if (_modem.hasMeasured()) {
        emit(cellsRecord(now(), _modem));
        emit(gsmCellsRecord(now(), _modem));
    }
    const bool hasChannels = !_modem.transportChannels().empty();
    const bool hasLost = _hadChannels.isDue(now(), hasChannels) && !hasChannels;
    if (hasLost || (hasChannels && _modem.hasMeasured())) emit(channelsRecord(now(), _modem));
}

}  // namespace kelvo::simulation::utran
