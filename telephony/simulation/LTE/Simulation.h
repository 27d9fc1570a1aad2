#pragma once

#include "telephony/simulation/LTE/Modem.h"
#include "telephony/simulation/LTE/NewerRecords.h"
#include "telephony/simulation/RegisteredSimulation.h"

namespace kelvo::simulation::lte {

/// An LTE modem on its drive, of the generation that the screens read or a newer one.
class Simulation final : public RegisteredSimulation<Network, Air, Modem> {
public:
    explicit Simulation(std::uint64_t seed, Generation generation = Generation::Of2010);

    Technology technology() const override { return Technology::LTE; }

private:
    void reportMeasurements() override;
    void reportServingCell() override;

    const Wording& _wording;
    Reported<std::size_t> _antennas;
    Reported<std::size_t> _servingCell;
};

}  // namespace kelvo::simulation::lte
