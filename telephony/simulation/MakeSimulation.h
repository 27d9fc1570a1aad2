#pragma once

#include <cstdint>
#include <memory>

#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation {

/// The simulated modem of a family.
std::unique_ptr<Simulation> makeSimulation(Technology technology, std::uint64_t seed);

}  // namespace kelvo::simulation
