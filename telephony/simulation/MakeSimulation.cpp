#include "telephony/simulation/MakeSimulation.h"

#include "telephony/simulation/LteSimulation.h"

namespace kelvo::simulation {

std::unique_ptr<Simulation> makeSimulation(Technology, std::uint64_t seed) {
    return std::make_unique<LteSimulation>(seed);
}

}  // namespace kelvo::simulation
