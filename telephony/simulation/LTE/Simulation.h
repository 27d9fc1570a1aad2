#pragma once

#include "telephony/simulation/FamilySimulation.h"
#include "telephony/simulation/LTE/Modem.h"
#include "telephony/simulation/LTE/NewerRecords.h"

namespace kelvo::simulation::lte {

/// An LTE modem on its drive, of the generation that the screens read or a newer one.
class Simulation final : public FamilySimulation<Network, Air, Modem> {
public:
    explicit Simulation(std::uint64_t seed, Generation generation = Generation::Of2010);

    Technology technology() const override { return Technology::LTE; }

private:
    void step() override;
    void reportMeasurements();
    void reportServingCell();
    void reportExtended();

    const Wording& _wording;
    Reported<std::size_t> _antennas;
    Reported<std::size_t> _servingCell;
    Reported<std::size_t> _cells;
    Reported<bool> _contexts;
    Reported<int> _sim;
};

}  // namespace kelvo::simulation::lte
