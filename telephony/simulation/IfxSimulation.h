#pragma once

#include <optional>
#include <tuple>

#include "telephony/simulation/IFX/Modem.h"
#include "telephony/simulation/Simulation.h"

namespace kelvo::simulation {

/// A GSM and UMTS modem whose service sends its cell monitor ready made: one property list a message, no records.
class IfxSimulation final : public Simulation {
public:
    explicit IfxSimulation(std::uint64_t seed);

    Technology technology() const override { return Technology::IFX; }

    const Drive& drive() const { return _drive; }
    const ifx::Network& network() const { return _network; }
    const ifx::Modem& modem() const { return _modem; }

private:
    explicit IfxSimulation(Random random);
    void step() override;
    bool isNews();

    ifx::Network _network;
    Drive _drive;
    PhoneUser _user;
    ifx::Modem _modem;

    using News = std::tuple<ifx::RadioAccess, std::size_t, ifx::Registration, ifx::Connection>;
    std::optional<News> _told;  // by the last message
};

}  // namespace kelvo::simulation
