#include "telephony/simulation/Drive.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace kelvo::simulation {
namespace {

// Half of the shadow's variance is the site's: its sectors stand on one mast, and what shadows one shadows all.
const double kShared = std::sqrt(0.5);

}  // namespace

Drive::Drive(std::vector<Sector> sectors, Journey journey, Random random)
    : _sectors(std::move(sectors)), _journey(std::move(journey)), _received(_sectors.size()) {
    int sites = 0;
    for (const Sector& sector : _sectors) {
        _shadows.emplace_back(random.split());
        sites = std::max(sites, sector.siteNumber + 1);
    }
    for (int i = 0; i < sites; ++i) _siteShadows.emplace_back(random.split());
    moveTo(Time(0));
}

void Drive::moveTo(Time time) {
    _position = _journey.at(time);
    _driven = _journey.driven(time);
    for (std::size_t i = 0; i < _sectors.size(); ++i) {
        const Sector& sector = _sectors[i];
        const double shadow = kShared * (_shadows[i].after(_driven) + _siteShadows[sector.siteNumber].after(_driven));
        const double off = bearing(sector.site, _position) - sector.direction;
        _received[i] =
            sector.power + sectorGain(off) - pathLoss(distance(sector.site, _position), sector.carrierMHz) + shadow;
    }
}

}  // namespace kelvo::simulation
