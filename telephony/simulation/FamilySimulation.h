#pragma once

#include <cstdint>
#include <utility>

#include "telephony/simulation/Journey.h"
#include "telephony/simulation/PhoneUser.h"
#include "telephony/simulation/Reported.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation {

/// The rooms of one family, drawn from one seed in this order. They are read between two calls of next().
template <class Network, class Air, class Modem>
class FamilySimulation : public Simulation {
public:
    const Network& network() const { return _network; }
    const Air& air() const { return _air; }
    const PhoneUser& user() const { return _user; }
    const Modem& modem() const { return _modem; }

protected:
    /// The phone's user rests until `firstUse`; `road` draws where the phone drives.
    FamilySimulation(std::uint64_t seed, Time firstUse, Journey (*road)(Random&) = Journey::throughTown)
        : _random(seed),
          _network(_random),
          _air{_network, road(_random), _random.split()},  // braces: in this order
          _user(_random.split(), firstUse),
          _modem(_network, _air, _random.split()) {}

    Random _random;
    Network _network;
    Air _air;
    PhoneUser _user;
    Modem _modem;
};

}  // namespace kelvo::simulation
