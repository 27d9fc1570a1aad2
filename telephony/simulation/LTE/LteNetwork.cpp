#include "telephony/simulation/LTE/LteNetwork.h"

namespace kelvo::simulation {

namespace {

constexpr int kInnerSites = 7;
constexpr double kWiderBand = 3;  // dB: twice the bandwidth takes twice the power to reach as far
constexpr int kFirstArea = 1041;
constexpr double kAreaDegrees = 60;
constexpr std::uint32_t kFirstBaseStation = 0x1A2B0;
constexpr int kFramesInAll = 1024;
constexpr int kSamplesInFrame = 307'200;
constexpr int kLtePriority = 5;  // of both carriers: cells of either are ranked against one another

int areaOf(const Sector& sector) { return kFirstArea + static_cast<int>(bearing({}, sector.site) / kAreaDegrees); }

// What lies below LTE at the same site; CDMA belongs to a neighboring network and reaches some sites only.
std::vector<LteCandidate> othersNear(int site, int sector) {
    using enum LteCandidate::Kind;
    std::vector<LteCandidate> others = {
        {.kind = Utran, .priority = 4, .channel = 10'713, .code = (5 * (3 * site + sector) + 7) % 512},
        {.kind = Geran,
         .priority = 2,
         .channel = 512 + 9 * site + 3 * sector,
         .code = 8 * (site % 8) + sector,
         .band = 1},
    };
    if (site % 2 != 0) return others;
    others.push_back({.kind = Cdma1x, .priority = 1, .channel = 384, .code = 4 * (3 * site + sector), .band = 0});
    others.push_back({.kind = Hrpd, .priority = 3, .channel = 425, .code = 4 * (3 * site + sector), .band = 1});
    return others;
}

}  // namespace

std::vector<LteCell> nameLteCells(std::vector<Sector>& sectors, Random& random) {
    std::vector<LteCell> cells;
    LteCell site;
    for (std::size_t i = 0; i < sectors.size(); ++i) {
        Sector& sector = sectors[i];
        const int number = sector.siteNumber;
        const int part = static_cast<int>(i % 3);
        const bool isInner = number < kInnerSites;
        if (part == 0) {
            site.carrier = kLteCarriers[isInner ? 0 : 1];
            site.trackingArea = areaOf(sector);
            site.antennas = isInner ? 4 : 2;
            site.frames = random.between(0, kFramesInAll - 1);
            site.samples = random.between(0, kSamplesInFrame - 1);
            site.frequencyError = random.between(0, 90);
        }
        sector.carrierMHz = site.carrier.carrierMHz;
        if (isInner) sector.power += kWiderBand;

        LteCell& cell = cells.emplace_back(site);
        cell.physicalId = 3 * ((37 * number + 11) % 168) + part;  // a site's three have the three primary sequences
        cell.identity = (kFirstBaseStation + number) << 8 | (part + 1);
        cell.load = random.between(0.15, 0.5);
        cell.priority = kLtePriority;
        cell.minimumLevel = isInner ? -124 : -128;
        if (part != 1) cell.maximumPower = 23;
        if (part != 2) cell.searchIntra = isInner ? 50 : 62;
        if (isInner) cell.searchOther = 36;
        cell.others = othersNear(number, part);
    }
    return cells;
}

}  // namespace kelvo::simulation
