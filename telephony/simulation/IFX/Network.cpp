#include "telephony/simulation/IFX/Network.h"

namespace kelvo::simulation::ifx {
namespace {

constexpr TownPlan kPlan{.carrierMHz = Network::kGsmMHz, .power = Network::kPower};
constexpr int kReuse = 12;  // sites until a BCCH carrier comes again
constexpr int kColourOfNetwork = 2;
constexpr int kController = 101;
constexpr double kUmtsRadius = 1100;  // metres

/// The town's quarters; the drive goes clockwise and begins in the north.
int quarterOf(Point site) { return sliceOf(site, 4, 40); }

GsmCell gsmCell(const Sector& sector, int third) {
    const int quarter = quarterOf(sector.site);
    return {.arfcn = Arfcn(20 + 2 * (kReuse * third + sector.siteNumber % kReuse)),
            .bsic = Bsic(8 * kColourOfNetwork + sector.siteNumber / kReuse % 8),
            .cellId = 10 * (sector.siteNumber + 100) + third + 1,
            .area = {2101 + quarter, 1 + quarter}};
}

UmtsCell umtsCell(const Sector& sector, int third) {
    const int quarter = quarterOf(sector.site);
    return {.built = distance({}, sector.site) < kUmtsRadius,
            .scramblingCode = Psc(8 * sector.siteNumber + third),
            .cellId = kController << 16 | (10 * (sector.siteNumber + 3000) + third + 1),
            .area = {2151 + quarter, 21 + quarter}};
}

}  // namespace

Network::Network(Random& random) : sectors(buildSectors(kPlan, random)) {
    int third = 0;
    for (const Sector& sector : sectors) {
        gsmCells.push_back(gsmCell(sector, third));
        umtsCells.push_back(umtsCell(sector, third));
        third = (third + 1) % 3;
    }
}

}  // namespace kelvo::simulation::ifx
