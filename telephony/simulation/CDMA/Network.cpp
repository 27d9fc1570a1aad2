#include "telephony/simulation/CDMA/Network.h"

namespace kelvo::simulation::cdma {
namespace {

// The antennas' gain less what houses and the car's roof take.
constexpr TownPlan kPlan{.carrierMHz = kOneXCarrier.downlinkMHz, .power = 34};
constexpr int kPilotIncrement = 4;
constexpr int kSectorShift = 168;  // PN offsets between the sectors of a site: a third of all
Cell identify(const Sector& sector, int index) {
    const int third = index % 3;
    return {PnOffset(kPilotIncrement * (sector.siteNumber + 1) + kSectorShift * third),
            16 * (sector.siteNumber + 1) + third + 1,
            static_cast<std::size_t>(sliceOf(sector.site, kZones.size(), 40))};
}

}  // namespace

Network::Network(Random& random) : sectors(buildSectors(kPlan, random)) {
    for (const Sector& sector : sectors) cells.push_back(identify(sector, static_cast<int>(cells.size())));
}

System Network::systemOf(std::size_t sector) const {
    const Zone& zone = kZones[cells[sector].zone];
    return {.type = System::kCdma,
            .sid = zone.sid,
            .nid = zone.nid,
            .packetZone = zone.packetZone,
            .baseId = cells[sector].baseId,
            .protocolRevision = zone.protocolRevision,
            .roamingIndicator = zone.roamingIndicator};
}

}  // namespace kelvo::simulation::cdma
