#include "telephony/simulation/GSMUMTS/Network.h"

#include <algorithm>
#include <array>
#include <limits>

namespace kelvo::simulation::gsm {
namespace {

constexpr TownPlan kGsmPlan{.radius = 2700, .siteDistance = 750, .carrierMHz = 940, .power = 44};
constexpr TownPlan kUmtsPlan{.radius = kCentreRadius, .siteDistance = 500, .carrierMHz = 2112.4, .power = 30};

constexpr int kFirstBcch = 20;
constexpr int kBcchCount = 24;
constexpr int kFirstTraffic = 50;
constexpr int kTrafficGroups = 12;
constexpr int kHoppingCarriers = 4;
constexpr int kNetworkColour = 5;
constexpr int kRnc = 100;

/// Four districts, so that a round trip crosses their borders; the inner and the outer part of each is a routing area.
Area areaAt(Point place, int firstLac) {
    const int district = sliceOf(place, 4, 60);
    return {firstLac + district, distance({}, place) < 1500 ? 1 : 2};
}

/// Gives each sector a carrier of which the nearest other user is as far away as can be.
class CarrierPlan {
public:
    Arfcn choose(Point site) {
        const auto farthest = std::ranges::max_element(_users, {}, [&](const auto& users) { return gap(users, site); });
        _colour = static_cast<int>(farthest->size()) % 8;
        farthest->push_back(site);
        return Arfcn(kFirstBcch + static_cast<int>(farthest - _users.begin()));
    }
    /// Tells the last sector from the others on its carrier.
    int colour() const { return _colour; }

private:
    static double gap(const std::vector<Point>& users, Point site) {
        double nearest = std::numeric_limits<double>::max();
        for (const Point user : users) nearest = std::min(nearest, distance(user, site));
        return nearest;
    }

    std::array<std::vector<Point>, kBcchCount> _users;
    int _colour = 0;
};

GprsOptions drawGprsOptions(const Area& area, Random& random) {
    const bool hasPbcch = random.chance(0.2);
    return {
        .networkOperationMode = area.lac % 2,
        .networkControlOrder = random.between(0, 1),
        .hasPacketFlowContexts = random.chance(0.5),
        .priorityAccessThreshold = random.between(3, 6),
        .t3192 = random.between(0, 2),
        .drxTimerMax = random.between(1, 4),
        .longAccessBursts = random.chance(0.5),
        .hasPbcch = hasPbcch,
        .isSi13OnExtendedBcch = random.chance(0.3),
        .hasPacketSystemInformation = random.chance(0.5),
        .hasExtendedMeasurementOrder = random.chance(0.2),
        .psiCountLow = hasPbcch ? random.between(1, 4) : 0,
        .psiCountHigh = hasPbcch ? random.between(1, 4) : 0,
    };
}

GsmCell drawGsmCell(const Sector& sector, int index, Arfcn arfcn, int colour, Random& random) {
    GsmCell cell{.cellId = (sector.siteNumber + 1) * 10 + index % 3 + 1,
                 .arfcn = arfcn,
                 .bsic = Bsic(kNetworkColour * 8 + colour),
                 .area = areaAt(sector.site, 0x1101),
                 .reselectOffset = random.chance(0.25) ? 4.0 : 0.0,
                 .hoppingSequence = random.between(1, 63)};
    for (int i = 0; i < kHoppingCarriers; ++i) {
        cell.mobileAllocation.emplace_back(kFirstTraffic + index % kTrafficGroups + kTrafficGroups * i);
    }
    cell.gprs = drawGprsOptions(cell.area, random);
    return cell;
}

UmtsCell umtsCell(const Sector& sector, int index) {
    const Area area = areaAt(sector.site, 0x2101);
    return {.cellId = kRnc << 16 | ((sector.siteNumber + 1) * 10 + index % 3 + 1),
            .scramblingCode = Psc((index * 7 + 16) % (Psc::kMax + 1)),
            .area = area,
            .uraId = area.lac - 0x2100,
            .hasTwoCarriers = sector.siteNumber % 3 == 0};
}

}  // namespace

Network::Network(Random& random)
    : gsmSectors(buildSectors(kGsmPlan, random)), umtsSectors(buildSectors(kUmtsPlan, random)) {
    CarrierPlan carriers;
    for (Sector& sector : gsmSectors) {
        const Arfcn arfcn = carriers.choose(sector.site);
        sector.carrierMHz = 935 + 0.2 * arfcn;
        gsmCells.push_back(drawGsmCell(sector, static_cast<int>(gsmCells.size()), arfcn, carriers.colour(), random));
    }
    for (const Sector& sector : umtsSectors) umtsCells.push_back(umtsCell(sector, static_cast<int>(umtsCells.size())));
}

}  // namespace kelvo::simulation::gsm
