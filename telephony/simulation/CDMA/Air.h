#pragma once

#include <vector>

#include "telephony/simulation/CDMA/Network.h"
#include "telephony/simulation/Drive.h"

namespace kelvo::simulation::cdma {

/// What the receiver reads on one carrier.
struct Reception {
    std::vector<double> pilots;  ///< Ec/Io of each sector in dB
    double total = 0;            ///< dBm within the carrier, noise included
    double rx0 = 0;              ///< dBm, the same as the first antenna reads it
    double rx1 = 0;              ///< dBm, as the second does
    double openLoop = 0;         ///< dBm to send with: the less the more is received, with the closed loop's share

    std::size_t strongest() const;
};

/// How a carrier is filled.
struct Loading {
    double gain;           ///< dB that the carrier is received stronger than the one that the drive was built for
    double pilot;          ///< part of a sector's power that the pilot has
    double all;            ///< part that the sector sends at all
    double secondAntenna;  ///< dB that the second antenna receives more than the first
    double turnaround;     ///< dB: mean output power is this less the input (3GPP2 C.S0011)
};

/// What the phone's receiver has of the pilots, on both carriers.
class Air {
public:
    Air(const Network& network, const Journey& journey, Random random)
        : _drive(network.sectors, journey, random.split()), _random(std::move(random)) {}

    /// Drives on to then and measures.
    void measure(Time now);
    const Drive& drive() const { return _drive; }

    const Reception& oneX() const { return _oneX; }
    const Reception& evdo() const { return _evdo; }

private:
    Reception listen(const Loading& loading);

    Drive _drive;
    Random _random;
    Reception _oneX;
    Reception _evdo;
};

}  // namespace kelvo::simulation::cdma
