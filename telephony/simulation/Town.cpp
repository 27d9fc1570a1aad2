#include "telephony/simulation/Town.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <numeric>
#include <utility>

namespace kelvo::simulation {
namespace {

constexpr double kRowHeight = 0.8660254037844386;  // of a hexagonal grid, in distances between sites
// Half of the shadow's variance is the site's: its sectors stand on one mast, and what shadows one shadows all.
const double kShared = std::sqrt(0.5);

std::vector<Point> buildSites(const TownPlan& plan, Random& random) {
    std::vector<Point> sites;
    const int reach = static_cast<int>(std::ceil(plan.radius / (plan.siteDistance * kRowHeight)));
    const double jitter = plan.siteDistance / 8;
    for (int row = -reach; row <= reach; ++row) {
        for (int column = -reach; column <= reach; ++column) {
            const double shift = row % 2 == 0 ? 0.0 : 0.5;
            const Point grid{(column + shift) * plan.siteDistance, row * plan.siteDistance * kRowHeight};
            const double east = grid.east + random.between(-jitter, jitter);
            const double north = grid.north + random.between(-jitter, jitter);
            if (distance({}, grid) <= plan.radius) sites.push_back({east, north});
        }
    }
    std::ranges::stable_sort(sites, {}, [](Point site) { return distance({}, site); });
    return sites;
}

}  // namespace

std::vector<Sector> buildSectors(const TownPlan& plan, Random& random) {
    std::vector<Sector> sectors;
    int number = 0;
    for (const Point site : buildSites(plan, random)) {
        const double turn = random.between(0.0, 120.0);
        for (int i = 0; i < 3; ++i) {
            const double power = plan.power + random.between(-1.5, 1.5);
            sectors.push_back({site, number, turn + 120 * i, power, plan.carrierMHz});
        }
        ++number;
    }
    return sectors;
}

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

std::vector<std::size_t> byStrength(const std::vector<double>& levels) {
    std::vector<std::size_t> order(levels.size());
    std::iota(order.begin(), order.end(), std::size_t{0});
    std::ranges::stable_sort(order, std::greater(), [&levels](std::size_t sector) { return levels[sector]; });
    return order;
}

bool HeldFor::operator()(bool condition, std::size_t subject, Time now) {
    if (!condition) {
        _running = false;
        return false;
    }
    if (!_running || subject != _subject) {
        _running = true;
        _subject = subject;
        _since = now;
    }
    return now - _since >= _hold;
}

std::optional<std::size_t> EachHeldFor::operator()(const std::vector<std::size_t>& subjects, Time now) {
    std::map<std::size_t, Time> since;
    std::optional<std::size_t> first;
    for (const std::size_t subject : subjects) {
        const auto before = _since.find(subject);
        since[subject] = before != _since.end() ? before->second : now;
        if (!first && now - since[subject] >= _hold) first = subject;
    }
    _since = std::move(since);
    return first;
}

}  // namespace kelvo::simulation
