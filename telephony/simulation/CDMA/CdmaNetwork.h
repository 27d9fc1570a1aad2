#pragma once

#include <array>
#include <vector>

#include "telephony/simulation/CDMA/CdmaWorld.h"
#include "telephony/simulation/Drive.h"
#include "telephony/simulation/Town.h"

namespace kelvo::simulation {

/// A carrier of 3GPP2 C.S0057.
struct CdmaCarrier {
    int bandClass;
    int channel;
    double downlinkMHz;
};
inline constexpr CdmaCarrier kOneXCarrier{0, 283, 878.49};   // 870 MHz and 30 kHz a channel
inline constexpr CdmaCarrier kEvdoCarrier{1, 475, 1953.75};  // 1930 MHz and 50 kHz a channel

/// A registration zone, which is a packet zone and an EV-DO subnet too.
struct CdmaZone {
    int sid;
    int nid;
    int packetZone;
    int colorCode;
    int protocolRevision;
    int roamingIndicator;
};
// clang-format off
inline constexpr std::array<CdmaZone, 4> kCdmaZones{{  // as the drive comes through them
    // SID   NID packet colour P_REV roaming
    { 4110,   1,   11,    65,   6,    0 },  // home
    { 4110,   2,   12,    66,   6,    0 },
    { 4155,   1,   40,    71,   7,    1 },  // a partner's
    { 4162,   9,    3,   190,   9,   64 },  // with an indicator of the carrier's own
}};
// clang-format on

/// A sector's identity, for both carriers.
struct CdmaSector {
    int pn;
    int baseId;
    std::size_t zone;  ///< in kCdmaZones
};

struct CdmaNetwork {
    std::vector<Sector> radio;
    std::vector<CdmaSector> sectors;  ///< by the same index

    CdmaSystem systemOf(std::size_t sector) const;
};

CdmaNetwork buildCdmaNetwork(Random& random);

/// What a receiver reads on one carrier.
struct CdmaAir {
    std::vector<double> pilots;  ///< Ec/Io of each sector in dB
    double total = 0;            ///< dBm within the carrier, noise included

    std::size_t strongest() const;
};

/// How a carrier is filled.
struct CdmaLoading {
    double gain;   ///< dB that the carrier is received stronger than the one that the drive was built for
    double pilot;  ///< part of a sector's power that the pilot has
    double all;    ///< part that the sector sends at all
};

CdmaAir listen(const Drive& drive, const CdmaLoading& loading, Random& random);

}  // namespace kelvo::simulation
