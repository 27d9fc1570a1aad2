#pragma once

#include <array>
#include <vector>

#include "telephony/simulation/CDMA/Reports.h"
#include "telephony/simulation/RadioNumbers.h"
#include "telephony/simulation/Town.h"

namespace kelvo::simulation::cdma {

/// A carrier of 3GPP2 C.S0057.
struct Carrier {
    int bandClass;
    CdmaChannel channel;
    double downlinkMHz;
};
inline constexpr Carrier kOneXCarrier{0, CdmaChannel(283), 878.49};   // 870 MHz and 30 kHz a channel
inline constexpr Carrier kEvdoCarrier{1, CdmaChannel(475), 1953.75};  // 1930 MHz and 50 kHz a channel

/// A registration zone, which is a packet zone and an EV-DO subnet too.
struct Zone {
    int sid;
    int nid;
    int packetZone;
    int colorCode;
    int protocolRevision;
    int roamingIndicator;
};
// clang-format off
inline constexpr std::array<Zone, 4> kZones{{  // as the drive comes through them
    // SID   NID packet colour P_REV roaming
    { 4110,   1,   11,    65,   6,    0 },  // home
    { 4110,   2,   12,    66,   6,    0 },
    { 4155,   1,   40,    71,   7,    1 },  // a partner's
    { 4162,   9,    3,   190,   9,   64 },  // with an indicator of the carrier's own
}};
// clang-format on

/// What a sector is called, on both carriers.
struct Cell {
    PnOffset pn;
    int baseId;
    std::size_t zone;  ///< in kZones
};

/// The network of a CDMA2000 operator: 1x and EV-DO on every sector.
struct Network {
    explicit Network(Random& random);

    std::vector<Sector> sectors;
    std::vector<Cell> cells;  ///< by the same index

    System systemOf(std::size_t sector) const;
};

}  // namespace kelvo::simulation::cdma
