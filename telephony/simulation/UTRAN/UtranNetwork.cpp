#include "telephony/simulation/UTRAN/UtranNetwork.h"

namespace kelvo::simulation {
namespace {

// The carriers of a site's three sectors; every fourth site stands in the other band.
constexpr int kBandA[] = {10'055, 10'063, 10'071};
constexpr int kBandF[] = {9405, 9413, 9421};
constexpr int kOtherBandSites = 4;
constexpr int kFirstArea = 2101;
constexpr double kAreaDegrees = 60;
constexpr std::uint32_t kController = 0x2A1;
constexpr int kParameterIds = 128;
constexpr int kFirstGsmChannel = 512;

}  // namespace

std::vector<UtranCell> nameUtranCells(std::vector<Sector>& sectors, Random& random) {
    std::vector<UtranCell> cells;
    for (std::size_t i = 0; i < sectors.size(); ++i) {
        Sector& sector = sectors[i];
        const int number = static_cast<int>(i);
        const int part = number % 3;
        const bool isBandF = sector.siteNumber % kOtherBandSites == kOtherBandSites - 1;
        const int slice = static_cast<int>(bearing({}, sector.site) / kAreaDegrees);
        UtranCell& cell = cells.emplace_back();
        cell.uarfcn = isBandF ? kBandF[part] : kBandA[part];
        cell.band = isBandF ? 6 : 1;
        cell.parameterId = (37 * number + 11) % kParameterIds;
        cell.identity = kController << 16 | static_cast<std::uint32_t>(100 * (sector.siteNumber + 1) + part + 1);
        cell.locationArea = kFirstArea + slice;
        cell.registrationArea = 1 + slice;
        cell.barredClasses = random.chance(0.2) ? random.between(1, 3) : 0;
        cell.load = random.between(0.2, 0.6);
        cell.gsmChannel = kFirstGsmChannel + 4 * number;
        cell.gsmIdentity = 1000 + number;
        cell.networkColour = 2;
        cell.stationColour = sector.siteNumber % 8;
        sector.carrierMHz = cell.uarfcn / 5.0;
    }
    return cells;
}

}  // namespace kelvo::simulation
