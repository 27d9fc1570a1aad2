#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <variant>
#include <vector>

#include "telephony/simulation/RadioNumbers.h"
#include "telephony/simulation/Town.h"

namespace kelvo::simulation::lte {

/// A carrier of the network: channel numbers as in 3GPP TS 36.101, section 5.7.3.
struct Carrier {
    Earfcn downlink;
    Earfcn uplink;
    int band;
    int resourceBlocks;
    double carrierMHz;  ///< of the downlink
};

/// The network's carriers.
// clang-format off
inline constexpr std::array kCarriers = {
    //              down             up  band  blocks     MHz
    Carrier{Earfcn(1300), Earfcn(19300),    3,    100, 1815.0},
    Carrier{Earfcn( 300), Earfcn(18300),    1,     50, 2140.0},
};
// clang-format on

/// A cell that a phone may go to; of another technology the network names it in its system information.
struct Candidate {
    struct Lte {
        Earfcn channel;
        Pci pci;
    };
    struct Utran {
        Uarfcn channel;
        Psc scramblingCode;
    };
    struct Geran {
        Arfcn channel;
        Bsic bsic;
        int band;
    };
    struct Cdma {
        int bandClass;
        CdmaChannel channel;
        PnOffset pilot;
    };
    struct OneX : Cdma {};
    struct Hrpd : Cdma {};

    int priority;                                      ///< of its carrier, 0 to 7, the higher the more wanted
    std::variant<Lte, Utran, Geran, OneX, Hrpd> cell;  ///< in the order in which records number them
};

/// One cell, and what its system information says.
struct Cell {
    Carrier carrier{};
    Pci pci;
    std::uint32_t identity = 0;  ///< base station (20 bits) and cell (8 bits)
    int trackingArea = 0;
    int antennas = 2;
    double load = 0.3;                ///< share of its power that it sends at any time
    int priority = 0;                 ///< of its carrier
    int minimumLevel = -124;          ///< Qrxlevmin, dBm
    std::optional<int> maximumPower;  ///< P-Max, dBm
    std::optional<int> searchIntra;   ///< S-IntraSearch, dB: others on its carrier are looked for up to this Srxlev
    std::optional<int> searchOther;   ///< S-NonIntraSearch, dB: the same for other carriers and technologies
    int frames = 0;                   ///< its frame count is ahead of the phone's by so many frames
    int samples = 0;                  ///< its frames begin so many samples (1/30.72 us) after the phone's
    int frequencyError = 0;           ///< Hz
    std::vector<Candidate> others;
};

/// The network of an LTE operator: 20 MHz in the middle of the town, 10 MHz on another band around it; tracking areas
/// are slices of the town.
struct Network {
    explicit Network(Random& random);

    std::vector<Sector> sectors;
    std::vector<Cell> cells;  ///< by the same index
};

}  // namespace kelvo::simulation::lte
