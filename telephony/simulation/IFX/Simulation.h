#pragma once

#include <optional>
#include <tuple>

#include "telephony/simulation/IFX/Modem.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation::ifx {

/// A GSM and UMTS modem on its drive, whose service sends its cell monitor ready made. Its world is read between two
/// calls of next().
class Simulation final : public simulation::Simulation {
public:
    explicit Simulation(std::uint64_t seed) : Simulation(Random(seed)) {}

    Technology technology() const override { return Technology::IFX; }

    const Network& network() const { return _network; }
    const Drive& drive() const { return _drive; }
    const Modem& modem() const { return _modem; }

private:
    explicit Simulation(Random random);
    void step() override;
    bool isNews();

    Network _network;
    Drive _drive;
    PhoneUser _user;
    Modem _modem;

    using News = std::tuple<RadioAccess, std::size_t, Registration, Connection>;
    std::optional<News> _told;  // by the last message
};

}  // namespace kelvo::simulation::ifx
