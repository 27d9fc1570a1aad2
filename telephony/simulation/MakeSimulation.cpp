#include "telephony/simulation/MakeSimulation.h"

#include "telephony/simulation/CDMA/Simulation.h"
#include "telephony/simulation/GSMUMTS/Simulation.h"
#include "telephony/simulation/IFX/Simulation.h"
#include "telephony/simulation/LTE/Simulation.h"
#include "telephony/simulation/UTRAN/Simulation.h"

namespace kelvo::simulation {

std::unique_ptr<Simulation> makeSimulation(Technology technology, std::uint64_t seed, Generation generation) {
    switch (technology) {
        case Technology::IFX: return std::make_unique<ifx::Simulation>(seed);
        case Technology::GSM: return std::make_unique<gsm::Simulation>(seed, generation);
        case Technology::CDMA: return std::make_unique<cdma::Simulation>(seed);
        case Technology::UTRAN: return std::make_unique<utran::Simulation>(seed);
        case Technology::LTE: break;
    }
    return std::make_unique<lte::Simulation>(seed, generation);
}

}  // namespace kelvo::simulation
