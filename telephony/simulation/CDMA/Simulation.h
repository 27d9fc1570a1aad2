#pragma once

#include "telephony/simulation/CDMA/Modem.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation::cdma {

/// A CDMA2000 modem on its drive. Its world is read between two calls of next().
class Simulation final : public simulation::Simulation {
public:
    explicit Simulation(std::uint64_t seed) : Simulation(Random(seed)) {}

    Technology technology() const override { return Technology::CDMA; }

    const Network& network() const { return _network; }
    const Drive& drive() const { return _drive; }
    const Modem& modem() const { return _modem; }

private:
    explicit Simulation(Random random);
    void step() override;
    void reportOneX();
    void reportEvdo();
    void reportPackets();

    Network _network;
    Drive _drive;
    PhoneUser _user;
    Modem _modem;

    // What the last records told.
    OneXState _toldOneX = OneXState::Traffic;
    std::vector<int> _toldOneXPilots;
    System _toldSystem{.type = -1};
    EvdoState _toldEvdo = EvdoState::Connected;
    SessionState _toldSession = SessionState::Open;
    std::vector<int> _toldEvdoPilots;
    std::uint64_t _toldForward = 0;
    std::uint64_t _toldReverse = 0;
};

}  // namespace kelvo::simulation::cdma
