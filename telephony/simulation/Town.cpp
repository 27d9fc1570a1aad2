#include "telephony/simulation/Town.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <numeric>
#include <utility>

namespace kelvo::simulation {
namespace {

constexpr double kRowHeight = 0.8660254037844386;  // of a hexagonal grid, in distances between sites

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

int sliceOf(Point place, int slices, double turn) {
    return static_cast<int>((bearing({}, place) + turn) * slices / 360) % slices;
}

std::vector<std::size_t> byStrength(const std::vector<double>& levels) {
    std::vector<std::size_t> order(levels.size());
    std::iota(order.begin(), order.end(), std::size_t{0});
    std::ranges::stable_sort(order, std::greater(), [&levels](std::size_t sector) { return levels[sector]; });
    return order;
}

}  // namespace kelvo::simulation
