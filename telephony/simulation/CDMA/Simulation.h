#pragma once

#include <tuple>

#include "telephony/simulation/CDMA/Modem.h"
#include "telephony/simulation/FamilySimulation.h"

namespace kelvo::simulation::cdma {

/// A CDMA2000 modem on its drive.
class Simulation final : public FamilySimulation<Network, Air, Modem> {
public:
    explicit Simulation(std::uint64_t seed);

    Technology technology() const override { return Technology::CDMA; }

private:
    void step() override;
    void reportOneX();
    void reportEvdo();
    void reportPackets();

    using OneXContent = std::pair<OneXState, std::vector<int>>;
    using EvdoContent = std::tuple<EvdoState, SessionState, std::vector<int>>;
    Reported<OneXContent> _oneX;
    Reported<System> _system;
    Reported<EvdoContent> _evdo;
    Reported<EvdoContent> _evdoPilots;
    Reported<std::uint64_t> _forward;
    Reported<std::uint64_t> _reverse;
};

}  // namespace kelvo::simulation::cdma
