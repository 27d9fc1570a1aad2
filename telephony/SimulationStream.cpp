#include "telephony/SimulationStream.h"

#include <fmt/format.h>

#include "telephony/simulation/MakeSimulation.h"

namespace kelvo {

SimulationStream::SimulationStream(Technology technology, std::uint64_t seed)
    : _seed(seed), _modem(simulation::makeSimulation(technology, seed)) {}

std::string SimulationStream::description() const {
    return fmt::format("a simulated {} modem, seed {}", namesOf(technology()).name, _seed);
}

std::optional<CapturePacket> SimulationStream::next() {
    _message = _modem->next();
    return CapturePacket{simulation::kDriveStart + _message.time, _message.bytes};
}

}  // namespace kelvo
