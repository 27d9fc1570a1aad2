#pragma once

#include "telephony/simulation/LTE/Modem.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation::lte {

/// An LTE modem on its drive. Its world is read between two calls of next().
class Simulation final : public simulation::Simulation {
public:
    explicit Simulation(std::uint64_t seed) : Simulation(Random(seed)) {}

    Technology technology() const override { return Technology::LTE; }

    const Network& network() const { return _network; }
    const Air& air() const { return _air; }
    const Modem& modem() const { return _modem; }

private:
    explicit Simulation(Random random);
    void step() override;
    void reportMeasurements();
    void reportServingCell();
    void reportExtended();

    Network _network;
    Air _air;
    Modem _modem;
};

}  // namespace kelvo::simulation::lte
