#include "telephony/simulation/LTE/Simulation.h"

#include "telephony/simulation/LTE/Records.h"

namespace kelvo::simulation::lte {

using namespace std::chrono_literals;

Simulation::Simulation(std::uint64_t seed, Generation generation)
    : RegisteredSimulation(seed, 4s), _wording(wordingOf(generation)) {}

void Simulation::reportServingCell() {
    const std::size_t cell = _modem.servingIndex();
    if (_antennas.isDue(now(), cell)) emit(_wording.antennas(now(), _modem.serving()));
    if (_servingCell.isDue(now(), cell, 5s)) emit(_wording.servingCell(now(), _modem.serving()));
}

void Simulation::reportMeasurements() {
    if (!_modem.hasMeasured()) return;
    if (_wording.everyModeMeasurement != nullptr) emit(_wording.everyModeMeasurement(now(), _modem));
    if (_modem.isConnected()) return emit(_wording.connectedMeasurement(now(), _modem));
    emit(_wording.servingMeasurement(now(), _modem.serving(), _modem.reading(), _modem.idle()));
    if (!_modem.neighbors().empty()) emit(_wording.neighborMeasurement(now(), _modem));
    emit(candidatesRecord(now(), _modem));
}

}  // namespace kelvo::simulation::lte
