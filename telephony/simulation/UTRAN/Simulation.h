#pragma once

#include "telephony/simulation/FamilySimulation.h"
#include "telephony/simulation/UTRAN/Modem.h"

namespace kelvo::simulation::utran {

/// A TD-SCDMA modem on its drive.
class Simulation final : public FamilySimulation<Network, Air, Modem> {
public:
    explicit Simulation(std::uint64_t seed);

    Technology technology() const override { return Technology::UTRAN; }

private:
    void step() override;
    void reportServingCell();
    void reportMeasurements();
    void reportExtended();

    Reported<RrcState> _rrcState;
    Reported<std::pair<std::size_t, bool>> _servingCell;
    Reported<bool> _hadChannels;
    Reported<std::size_t> _cells;
    Reported<std::vector<std::string>> _contexts;
    Reported<int> _sim;
};

}  // namespace kelvo::simulation::utran
