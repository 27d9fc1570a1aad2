#pragma once

#include <map>
#include <optional>
#include <vector>

#include "telephony/simulation/Journey.h"
#include "telephony/simulation/Propagation.h"

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

/// The indices of `levels`, the strongest first; of equals the first.
std::vector<std::size_t> byStrength(const std::vector<double>& levels);

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

/// Lets a condition through only when it has held for a while (the "time to trigger" of 3GPP TS 36.331, Treselection
/// of TS 36.304 and their like).
class HeldFor {
public:
    explicit HeldFor(Time hold) : _hold(hold) {}

    /// True when `condition`, which is about `subject`, has held for the time without a break or a change of subject.
    bool operator()(bool condition, std::size_t subject, Time now);
    void restart() { _running = false; }

private:
    Time _hold;
    Time _since{0};
    std::size_t _subject = 0;
    bool _running = false;
};

/// HeldFor for many subjects at a time, such as all cells that are better than the serving one: two that are better by
/// turns do not hold each other up.
class EachHeldFor {
public:
    explicit EachHeldFor(Time hold) : _hold(hold) {}

    /// `subjects` are those that the condition holds for now. The first of them for which it has held for the time
    /// without a break.
    std::optional<std::size_t> operator()(const std::vector<std::size_t>& subjects, Time now);
    void restart() { _since.clear(); }

private:
    Time _hold;
    std::map<std::size_t, Time> _since;
};

}  // namespace kelvo::simulation
