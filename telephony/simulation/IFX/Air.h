#pragma once

#include <vector>

#include "telephony/simulation/Drive.h"
#include "telephony/simulation/IFX/Network.h"

namespace kelvo::simulation::ifx {

/// What the phone reads of all cells at one moment, by the sectors' index.
struct Air {
    std::vector<double> rssi;                   ///< GSM: dBm of the BCCH carrier as the phone averages it, -110 to -47
    std::vector<double> carrierToInterference;  ///< GSM: dB of the cell above others on its carrier and noise
    std::vector<double> rscp;  ///< UMTS: dBm of the common pilot, -120 to -25; -120 where there is no cell
    std::vector<double> ecN0;  ///< UMTS: dB of the pilot to all that is received, -24 to 0
};

Air listen(const Drive& drive, const Network& network, Random& random);

}  // namespace kelvo::simulation::ifx
