#pragma once

#include <vector>

#include "telephony/simulation/Drive.h"
#include "telephony/simulation/IFX/Network.h"

namespace kelvo::simulation::ifx {

/// What the phone's receiver has of all cells, by the sectors' index.
class Air {
public:
    /// `network` must outlive it.
    Air(const Network& network, const Journey& journey, Random random)
        : _network(network), _drive(network.sectors, journey, random.split()), _random(std::move(random)) {}

    /// Drives on to then and measures.
    void measure(Time now);
    const Drive& drive() const { return _drive; }

    /// GSM: dBm of the BCCH carrier as the phone averages it, -110 to -47.
    const std::vector<double>& rssi() const { return _rssi; }
    /// GSM: dB.
    const std::vector<double>& carrierToInterference() const { return _carrierToInterference; }
    /// UMTS: dBm of the common pilot, -120 to -25; -120 where there is no cell.
    const std::vector<double>& rscp() const { return _rscp; }
    /// UMTS: dB of the pilot to all that is received, -24 to 0.
    const std::vector<double>& ecN0() const { return _ecN0; }

private:
    void readGsm();
    void readUmts();

    const Network& _network;
    Drive _drive;
    Random _random;
    std::vector<double> _rssi;
    std::vector<double> _carrierToInterference;
    std::vector<double> _rscp;
    std::vector<double> _ecN0;
};

}  // namespace kelvo::simulation::ifx
