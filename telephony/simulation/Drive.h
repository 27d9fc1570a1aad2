#pragma once

#include <vector>

#include "telephony/simulation/Propagation.h"
#include "telephony/simulation/Town.h"

namespace kelvo::simulation {

/// A phone that drives through a town: what it receives of each sector at each moment.
class Drive {
public:
    Drive(std::vector<Sector> sectors, Journey journey, Random random);

    /// Drives on to then; never back.
    void moveTo(Time time);

    Point position() const { return _position; }
    double driven() const { return _driven; }  ///< metres
    const std::vector<Sector>& sectors() const { return _sectors; }
    /// The local mean received of a sector, in dBm: without fast fading, which belongs to the readings.
    double received(std::size_t sector) const { return _received[sector]; }
    const std::vector<double>& received() const { return _received; }
    /// Every sector's index, the strongest first.
    std::vector<std::size_t> byStrength() const { return simulation::byStrength(_received); }

private:
    std::vector<Sector> _sectors;
    Journey _journey;
    std::vector<Shadowing> _shadows;  // of each sector; a part is the site's, which its sectors share
    std::vector<Shadowing> _siteShadows;
    std::vector<double> _received;
    Point _position;
    double _driven = 0;
};

}  // namespace kelvo::simulation
