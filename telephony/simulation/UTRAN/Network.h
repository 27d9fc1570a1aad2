#pragma once

#include <cstdint>
#include <vector>

#include "telephony/simulation/RadioNumbers.h"
#include "telephony/simulation/Town.h"

namespace kelvo::simulation::utran {

/// One cell of a TD-SCDMA network (UTRA TDD, 1.28 Mcps), and the GSM cell at the same mast.
struct Cell {
    Uarfcn uarfcn;                ///< of both directions: 3GPP TS 25.102, section 5.4.3: five times the MHz
    int band = 0;                 ///< TS 25.102, section 5.2: 1 for band a, 6 for band f
    CellParameterId parameterId;  ///< names scrambling code and midamble too
    std::uint32_t identity = 0;   ///< controller (12 bits) and cell (16 bits)
    int locationArea = 0;
    int registrationArea = 0;  ///< URA
    int barredClasses = 0;     ///< access classes that may not use the cell now
    double load = 0.3;         ///< share of its power that it sends at any time

    Arfcn gsmArfcn;       ///< 1800 MHz band
    int gsmIdentity = 0;  ///< 14 bits
    int ncc = 0;          ///< NCC
    int bcc = 0;          ///< BCC
};

/// The network of a TD-SCDMA operator; location areas are slices of the town.
struct Network {
    explicit Network(Random& random);

    std::vector<Sector> sectors;
    std::vector<Cell> cells;  ///< by the same index
};

}  // namespace kelvo::simulation::utran
