#pragma once

#include <vector>

#include "telephony/simulation/Drive.h"
#include "telephony/simulation/Random.h"

namespace kelvo::simulation::cdma {

/// What a receiver reads on one carrier.
struct Air {
    std::vector<double> pilots;  ///< Ec/Io of each sector in dB
    double total = 0;            ///< dBm within the carrier, noise included

    std::size_t strongest() const;
};

/// How a carrier is filled.
struct Loading {
    double gain;   ///< dB that the carrier is received stronger than the one that the drive was built for
    double pilot;  ///< part of a sector's power that the pilot has
    double all;    ///< part that the sector sends at all
};

Air listen(const Drive& drive, const Loading& loading, Random& random);

}  // namespace kelvo::simulation::cdma
