#pragma once

#include <tuple>

#include "telephony/simulation/FamilySimulation.h"
#include "telephony/simulation/IFX/Modem.h"

namespace kelvo::simulation::ifx {

/// A modem with a cell monitor on its drive: its service sends its cell monitor ready made.
class Simulation final : public FamilySimulation<Network, Air, Modem> {
public:
    explicit Simulation(std::uint64_t seed);

    Technology technology() const override { return Technology::IFX; }

private:
    void step() override;

    using Content = std::tuple<RadioAccess, std::size_t, bool, Registration, Connection>;
    Reported<Content> _cellMonitor;
    HeldFor _settled{std::chrono::milliseconds(480)};
};

}  // namespace kelvo::simulation::ifx
