#pragma once

#include <vector>

#include "telephony/simulation/Journey.h"

namespace kelvo::simulation {

/// One sector of a base station, as the air knows it. What a family calls it (a physical cell identity, a scrambling
/// code, a PN offset) is the family's own list, by the same index.
struct Sector {
    Point site;
    int siteNumber = 0;
    double direction = 0;  ///< of its antenna: degrees clockwise from north
    double power = 46;     ///< dBm, antenna and cable included
    double carrierMHz = 2100;
};

/// The operator of every network: the test network of ITU-T E.212, MCC 001 and MNC 01.
inline constexpr int kMcc = 1;
inline constexpr int kMnc = 1;

/// A location area of a network, and the routing area within it.
struct Area {
    int lac = 0;
    int rac = 0;
    bool operator==(const Area&) const = default;
};

/// How a network was built.
struct TownPlan {
    double radius = 2500;       ///< metres: sites up to here
    double siteDistance = 900;  ///< metres between neighboring sites
    double carrierMHz = 2100;
    double power = 58;  ///< dBm, antenna gain included
};

/// Three-sector base stations on a slightly irregular hexagonal grid, in order of their distance from the centre:
/// sectors 0 to 2 are the first site's.
std::vector<Sector> buildSectors(const TownPlan& plan, Random& random);

/// The town in as many equal slices, numbered clockwise from 0, which begins `turn` degrees before north: where a place
/// is.
int sliceOf(Point place, int slices, double turn = 0);

/// The indices of `levels`, the strongest first; of equals the first.
std::vector<std::size_t> byStrength(const std::vector<double>& levels);

}  // namespace kelvo::simulation
