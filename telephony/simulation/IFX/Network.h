#pragma once

#include <string_view>
#include <vector>

#include "telephony/simulation/Town.h"

namespace kelvo::simulation::ifx {

/// The network's code: a test network of ITU-T E.212.
inline constexpr std::string_view kMcc = "001";
inline constexpr std::string_view kMnc = "01";

/// A location and routing area of one of the two radio networks.
struct LocationArea {
    int lac = 0;
    int rac = 0;
    bool operator==(const LocationArea&) const = default;
};

/// A GSM 900 cell (3GPP TS 45.005).
struct GsmCell {
    int arfcn;  ///< of the BCCH carrier: 935 MHz and 200 kHz a channel
    int bsic;   ///< base station identity code, 0 to 63
    int cellId;
    LocationArea area;
};

/// A UMTS cell on the network's only carrier.
struct UmtsCell {
    static constexpr int kUarfcn = 10562;
    static constexpr double kMHz = 2112.4;  ///< a fifth of the channel's number

    bool built;  ///< the outer sites have none
    int scramblingCode;
    int cellId;  ///< the radio network controller's number in the upper 12 of 28 bits
    LocationArea area;
};

/// GSM on every site of the town, UMTS in its middle.
struct Network {
    static constexpr double kGsmMHz = 947;     ///< about: what the propagation is reckoned with
    static constexpr double kPower = 28;       ///< dBm: the antennas' gain less what houses and the car's roof take
    static constexpr double kUmtsGain = -7.3;  ///< dB that the higher carrier is received weaker

    std::vector<Sector> radio;
    std::vector<GsmCell> gsm;    ///< by the same index
    std::vector<UmtsCell> umts;  ///< by the same index
};

Network buildNetwork(Random& random);

}  // namespace kelvo::simulation::ifx
