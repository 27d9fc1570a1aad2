#include "telephony/simulation/LTE/Simulation.h"

#include "telephony/simulation/LTE/Records.h"

namespace kelvo::simulation::lte {

using namespace std::chrono_literals;

Simulation::Simulation(std::uint64_t seed) : RegisteredSimulation(seed, 4s) {}

void Simulation::reportServingCell() {
    const std::size_t cell = _modem.servingIndex();
    if (_antennas.isDue(now(), cell)) emit(antennasRecord(now(), _modem.serving()));
    if (_servingCell.isDue(now(), cell, 5s)) emit(servingCellRecord(now(), _modem.serving()));
}

void Simulation::reportMeasurements() {
    if (!_modem.hasMeasured()) return;
    if (_modem.isConnected()) return emit(connectedMeasurementRecord(now(), _modem));
    emit(servingMeasurementRecord(now(), _modem.serving(), _modem.reading(), _modem.idle()));
    if (!_modem.neighbors().empty()) emit(neighborMeasurementRecord(now(), _modem));
    emit(candidatesRecord(now(), _modem));
}

}  // namespace kelvo::simulation::lte
