#include "telephony/simulation/MakeSimulation.h"

namespace kelvo::simulation {

std::unique_ptr<Simulation> makeSimulation(Technology, std::uint64_t) { return nullptr; }

}  // namespace kelvo::simulation
