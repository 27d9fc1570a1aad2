#pragma once

#include <vector>

#include "telephony/simulation/RadioNumbers.h"
#include "telephony/simulation/Town.h"

namespace kelvo::simulation::ifx {

/// A GSM 900 cell (3GPP TS 45.005).
struct GsmCell {
    Arfcn arfcn;  ///< of the BCCH carrier: 935 MHz and 200 kHz a channel
    Bsic bsic;
    int cellId;
    Area area;
};

/// A UMTS cell on the network's only carrier.
struct UmtsCell {
    static constexpr Uarfcn kUarfcn{10562};
    static constexpr double kMHz = 2112.4;  ///< a fifth of the channel's number

    bool built;  ///< the outer sites have none
    Psc scramblingCode;
    int cellId;  ///< the radio network controller's number in the upper 12 of 28 bits
    Area area;
};

/// The network of a GSM and UMTS operator: GSM on every site of the town, UMTS in its middle.
struct Network {
    static constexpr double kGsmMHz = 947;     ///< roughly: for the path loss
    static constexpr double kPower = 28;       ///< dBm: the antennas' gain less what houses and the car's roof take
    static constexpr double kUmtsGain = -7.3;  ///< dB that the higher carrier is received weaker

    explicit Network(Random& random);

    std::vector<Sector> sectors;
    std::vector<GsmCell> gsmCells;    ///< by the same index
    std::vector<UmtsCell> umtsCells;  ///< by the same index
};

}  // namespace kelvo::simulation::ifx
