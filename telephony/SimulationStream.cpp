#include "telephony/SimulationStream.h"

#include <fmt/format.h>

#include "telephony/simulation/MakeSimulation.h"

namespace kelvo {

using simulation::Generation;

SimulationStream::SimulationStream(Technology technology, std::uint64_t seed, Generation generation)
    : _seed(seed), _generation(generation), _modem(simulation::makeSimulation(technology, seed, generation)) {}

std::string SimulationStream::description() const {
    const std::string year =
        _generation == Generation::Of2010 ? std::string() : fmt::format(" of {}", simulation::yearOf(_generation));
    return fmt::format("a simulated {} modem{}, seed {}", namesOf(technology()).name, year, _seed);
}

std::optional<CapturePacket> SimulationStream::next() {
    _message = _modem->next();
    return CapturePacket{simulation::kDriveStart + _message.time, _message.bytes};
}

}  // namespace kelvo
