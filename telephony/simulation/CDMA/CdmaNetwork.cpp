#include "telephony/simulation/CDMA/CdmaNetwork.h"

#include <algorithm>

namespace kelvo::simulation {
namespace {

// The antennas' gain less what houses and the car's roof take.
constexpr TownPlan kPlan{.carrierMHz = kOneXCarrier.downlinkMHz, .power = 34};
constexpr int kPilotIncrement = 4;
constexpr int kSectorShift = 168;  // PN offsets between the sectors of a site: a third of all
constexpr double kNoise = -105;    // dBm: thermal noise within 1.23 MHz and 8 dB of the receiver's own
constexpr double kSearchNoise = 0.5;
constexpr double kSearchFloor = -25;  // dB: weaker pilots read as this
constexpr double kWhole = -0.05;      // dB: no pilot is more than all that is received

// The drive goes clockwise and begins in the north.
std::size_t zoneOf(Point site) { return static_cast<std::size_t>((bearing({}, site) + 40) / 90) % kCdmaZones.size(); }

CdmaSector identify(const Sector& sector, int index) {
    const int third = index % 3;
    return {kPilotIncrement * (sector.siteNumber + 1) + kSectorShift * third, 16 * (sector.siteNumber + 1) + third + 1,
            zoneOf(sector.site)};
}

}  // namespace

CdmaNetwork buildCdmaNetwork(Random& random) {
    CdmaNetwork network{buildSectors(kPlan, random), {}};
    for (const Sector& sector : network.radio) {
        network.sectors.push_back(identify(sector, static_cast<int>(network.sectors.size())));
    }
    return network;
}

CdmaSystem CdmaNetwork::systemOf(std::size_t sector) const {
    const CdmaZone& zone = kCdmaZones[sectors[sector].zone];
    return {.type = CdmaSystem::kCdma,
            .sid = zone.sid,
            .nid = zone.nid,
            .packetZone = zone.packetZone,
            .baseId = sectors[sector].baseId,
            .protocolRevision = zone.protocolRevision,
            .roamingIndicator = zone.roamingIndicator};
}

std::size_t CdmaAir::strongest() const {
    return static_cast<std::size_t>(std::ranges::max_element(pilots) - pilots.begin());
}

CdmaAir listen(const Drive& drive, const CdmaLoading& loading, Random& random) {
    double total = toMilliwatts(kNoise);
    for (const double received : drive.received()) total += loading.all * toMilliwatts(received + loading.gain);
    CdmaAir air{{}, toDecibels(total)};
    air.pilots.reserve(drive.received().size());
    for (const double received : drive.received()) {
        const double pilot = received + loading.gain + toDecibels(loading.pilot) - air.total;
        air.pilots.push_back(std::clamp(pilot + kSearchNoise * random.normal(), kSearchFloor, kWhole));
    }
    return air;
}

}  // namespace kelvo::simulation
