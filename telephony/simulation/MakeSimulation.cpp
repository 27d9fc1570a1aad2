#include "telephony/simulation/MakeSimulation.h"

#include "telephony/simulation/CdmaSimulation.h"
#include "telephony/simulation/GsmSimulation.h"
#include "telephony/simulation/IfxSimulation.h"
#include "telephony/simulation/LteSimulation.h"
#include "telephony/simulation/UtranSimulation.h"

namespace kelvo::simulation {

std::unique_ptr<Simulation> makeSimulation(Technology technology, std::uint64_t seed) {
    switch (technology) {
        case Technology::IFX: return std::make_unique<IfxSimulation>(seed);
        case Technology::GSM: return std::make_unique<GsmSimulation>(seed);
        case Technology::CDMA: return std::make_unique<CdmaSimulation>(seed);
        case Technology::UTRAN: return std::make_unique<UtranSimulation>(seed);
        case Technology::LTE: break;
    }
    return std::make_unique<LteSimulation>(seed);
}

}  // namespace kelvo::simulation
