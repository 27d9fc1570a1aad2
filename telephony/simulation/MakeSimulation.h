#pragma once

#include <cstdint>
#include <memory>

#include "telephony/simulation/Generation.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation {

/// The simulated modem of a family; a family without generations takes no notice of one.
std::unique_ptr<Simulation> makeSimulation(Technology technology, std::uint64_t seed,
                                           Generation generation = Generation::Of2010);

}  // namespace kelvo::simulation
