#pragma once

#include "telephony/simulation/LTE/Modem.h"
#include "telephony/simulation/RegisteredSimulation.h"

namespace kelvo::simulation::lte {

/// An LTE modem on its drive.
class Simulation final : public RegisteredSimulation<Network, Air, Modem> {
public:
    explicit Simulation(std::uint64_t seed);

    Technology technology() const override { return Technology::LTE; }

private:
    void reportMeasurements() override;
    void reportServingCell() override;

    Reported<std::size_t> _antennas;
    Reported<std::size_t> _servingCell;
};

}  // namespace kelvo::simulation::lte
