#include "telephony/simulation/UTRAN/Network.h"

namespace kelvo::simulation::utran {
namespace {

// Of the P-CCPCH: 33 dBm and 15 dB of antenna gain, less 10 dB that the car's body takes.
constexpr TownPlan kPlan = {.carrierMHz = 2010, .power = 38};
// The carriers of a site's three sectors; every fourth site stands in the other band.
constexpr int kBandA[] = {10'055, 10'063, 10'071};
constexpr int kBandF[] = {9405, 9413, 9421};
constexpr int kOtherBandSites = 4;
constexpr int kFirstArea = 2101;
constexpr int kAreas = 6;
constexpr std::uint32_t kController = 0x2A1;
constexpr int kParameterIds = CellParameterId::kMax + 1;
constexpr int kFirstGsmArfcn = 512;

}  // namespace

Network::Network(Random& random) : sectors(buildSectors(kPlan, random)) {
    for (std::size_t i = 0; i < sectors.size(); ++i) {
        Sector& sector = sectors[i];
        const int number = static_cast<int>(i);
        const int part = number % 3;
        const bool isBandF = sector.siteNumber % kOtherBandSites == kOtherBandSites - 1;
        const int slice = sliceOf(sector.site, kAreas);
        Cell& cell = cells.emplace_back();
        cell.uarfcn = Uarfcn(isBandF ? kBandF[part] : kBandA[part]);
        cell.band = isBandF ? 6 : 1;
        cell.parameterId = CellParameterId((37 * number + 11) % kParameterIds);
        cell.identity = kController << 16 | static_cast<std::uint32_t>(100 * (sector.siteNumber + 1) + part + 1);
        cell.locationArea = kFirstArea + slice;
        cell.registrationArea = 1 + slice;
        cell.barredClasses = random.chance(0.2) ? random.between(1, 3) : 0;
        cell.load = random.between(0.2, 0.6);
        cell.gsmArfcn = Arfcn(kFirstGsmArfcn + 4 * number);
        cell.gsmIdentity = 1000 + number;
        cell.ncc = 2;
        cell.bcc = sector.siteNumber % 8;
        sector.carrierMHz = cell.uarfcn / 5.0;
    }
}

}  // namespace kelvo::simulation::utran
