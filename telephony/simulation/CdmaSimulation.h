#pragma once

#include "telephony/simulation/CDMA/EvdoModem.h"
#include "telephony/simulation/CDMA/OneXModem.h"
#include "telephony/simulation/PhoneUser.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation {

/// A hybrid CDMA2000 modem: 1x, on whose calls EV-DO leaves it the receiver, and EV-DO.
class CdmaSimulation final : public Simulation {
public:
    explicit CdmaSimulation(std::uint64_t seed);

    Technology technology() const override { return Technology::CDMA; }

    const Drive& drive() const { return _drive; }
    const CdmaNetwork& network() const { return _network; }
    const OneXModem& oneX() const { return _oneX; }
    const EvdoModem& evdo() const { return _evdo; }

private:
    explicit CdmaSimulation(Random random);
    void step() override;
    void reportOneX();
    void reportEvdo();
    void reportPackets();

    CdmaNetwork _network;
    Drive _drive;
    PhoneUser _user;
    OneXModem _oneX;
    EvdoModem _evdo;

    // What the last records told.
    OneXState _toldOneX = OneXState::Traffic;
    std::vector<int> _toldOneXPilots;
    CdmaSystem _toldSystem{.type = -1};
    EvdoState _toldEvdo = EvdoState::Connected;
    SessionState _toldSession = SessionState::Open;
    std::vector<int> _toldEvdoPilots;
    std::uint64_t _toldForward = 0;
    std::uint64_t _toldReverse = 0;
};

}  // namespace kelvo::simulation
