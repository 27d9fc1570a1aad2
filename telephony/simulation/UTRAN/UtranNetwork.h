#pragma once

#include <cstdint>
#include <vector>

#include "telephony/simulation/Town.h"

namespace kelvo::simulation {

/// One cell of a TD-SCDMA network (UTRA TDD, 1.28 Mcps), and the GSM cell at the same mast.
struct UtranCell {
    int uarfcn = 0;              ///< of both directions: 3GPP TS 25.102, section 5.4.3: five times the MHz
    int band = 0;                ///< TS 25.102, section 5.2: 1 for band a, 6 for band f
    int parameterId = 0;         ///< cell parameter, 0 to 127 (TS 25.223): names scrambling code and midamble too
    std::uint32_t identity = 0;  ///< controller (12 bits) and cell (16 bits)
    int locationArea = 0;
    int registrationArea = 0;  ///< URA
    int barredClasses = 0;     ///< access classes that may not use the cell now
    double load = 0.3;         ///< share of its power that it sends at any time

    int gsmChannel = 0;     ///< ARFCN, 1800 MHz band
    int gsmIdentity = 0;    ///< 14 bits
    int networkColour = 0;  ///< NCC
    int stationColour = 0;  ///< BCC
};

/// Names the cells that the sectors carry, by the same index, and tunes the sectors to the cells' carriers. Location
/// areas are slices of the town.
std::vector<UtranCell> nameUtranCells(std::vector<Sector>& sectors, Random& random);

}  // namespace kelvo::simulation
