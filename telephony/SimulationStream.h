#pragma once

#include <memory>

#include "telephony/RecordStream.h"
#include "telephony/simulation/Generation.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo {

/// The log of a simulated modem, without end. The same technology and seed give the same drive at the same times, in
/// the layouts of the modem's generation.
class SimulationStream final : public RecordStream {
public:
    SimulationStream(Technology technology, std::uint64_t seed,
                     simulation::Generation generation = simulation::Generation::Of2010);

    Technology technology() const override { return _modem->technology(); }
    std::string description() const override;
    std::optional<CapturePacket> next() override;

private:
    const std::uint64_t _seed;
    const simulation::Generation _generation;
    const std::unique_ptr<simulation::Simulation> _modem;
    simulation::Simulation::Message _message;
};

}  // namespace kelvo
