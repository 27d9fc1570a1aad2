#pragma once

#include "telephony/simulation/RegisteredSimulation.h"
#include "telephony/simulation/UTRAN/Modem.h"

namespace kelvo::simulation::utran {

/// A TD-SCDMA modem on its drive.
class Simulation final : public RegisteredSimulation<Network, Air, Modem> {
public:
    explicit Simulation(std::uint64_t seed);

    Technology technology() const override { return Technology::UTRAN; }

private:
    void reportServingCell() override;
    void reportMeasurements() override;

    Reported<RrcState> _rrcState;
    Reported<std::pair<std::size_t, bool>> _servingCell;
    Reported<bool> _hadChannels;
};

}  // namespace kelvo::simulation::utran
