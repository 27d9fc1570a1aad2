#pragma once

#include "telephony/simulation/Simulation.h"
#include "telephony/simulation/UTRAN/Modem.h"

namespace kelvo::simulation::utran {

/// A TD-SCDMA modem on its drive. Its world is read between two calls of next().
class Simulation final : public simulation::Simulation {
public:
    explicit Simulation(std::uint64_t seed) : Simulation(Random(seed)) {}

    Technology technology() const override { return Technology::UTRAN; }

    const Network& network() const { return _network; }
    const Air& air() const { return _air; }
    const Modem& modem() const { return _modem; }

private:
    explicit Simulation(Random random);
    void step() override;
    void reportServingCell();
    void reportMeasurements();
    void reportExtended();

    Network _network;
    Air _air;
    Modem _modem;
    bool _hasShownChannels = false;
};

}  // namespace kelvo::simulation::utran
