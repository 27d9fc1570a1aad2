#pragma once

#include "telephony/simulation/FamilySimulation.h"
#include "telephony/simulation/LTE/Modem.h"

namespace kelvo::simulation::lte {

/// An LTE modem on its drive.
class Simulation final : public FamilySimulation<Network, Air, Modem> {
public:
    explicit Simulation(std::uint64_t seed);

    Technology technology() const override { return Technology::LTE; }

private:
    void step() override;
    void reportMeasurements();
    void reportServingCell();
    void reportExtended();

    Reported<std::size_t> _antennas;
    Reported<std::size_t> _servingCell;
    Reported<std::size_t> _cells;
    Reported<bool> _contexts;
    Reported<int> _sim;
};

}  // namespace kelvo::simulation::lte
