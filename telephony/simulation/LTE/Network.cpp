#include "telephony/simulation/LTE/Network.h"

namespace kelvo::simulation::lte {
namespace {

constexpr int kInnerSites = 7;
constexpr double kWiderBand = 3;  // dB: twice the bandwidth takes twice the power to reach as far
constexpr int kFirstArea = 1041;
constexpr int kAreas = 6;
constexpr std::uint32_t kFirstBaseStation = 0x1A2B0;
constexpr int kFramesInAll = 1024;
constexpr int kSamplesInFrame = 307'200;
constexpr int kPriority = 5;  // of both carriers: cells of either are ranked against one another

// What lies below LTE at the same site; CDMA belongs to a neighboring network and reaches some sites only.
std::vector<Candidate> othersNear(int site, int sector) {
    const int number = 3 * site + sector;
    std::vector<Candidate> others = {
        {4, Candidate::Utran{Uarfcn(10'713), Psc((5 * number + 7) % (Psc::kMax + 1))}},
        {2, Candidate::Geran{Arfcn(512 + 3 * number), Bsic(8 * (site % 8) + sector), 1}},
    };
    if (site % 2 != 0) return others;
    others.push_back({1, Candidate::OneX{{0, CdmaChannel(384), PnOffset(4 * number)}}});
    others.push_back({3, Candidate::Hrpd{{1, CdmaChannel(425), PnOffset(4 * number)}}});
    return others;
}

}  // namespace

Network::Network(Random& random) : sectors(buildSectors({}, random)) {
    Cell site;
    for (std::size_t i = 0; i < sectors.size(); ++i) {
        Sector& sector = sectors[i];
        const int number = sector.siteNumber;
        const int part = static_cast<int>(i % 3);
        const bool isInner = number < kInnerSites;
        if (part == 0) {
            site.carrier = kCarriers[isInner ? 0 : 1];
            site.trackingArea = kFirstArea + sliceOf(sector.site, kAreas);
            site.antennas = isInner ? 4 : 2;
            site.frames = random.between(0, kFramesInAll - 1);
            site.samples = random.between(0, kSamplesInFrame - 1);
            site.frequencyError = random.between(0, 90);
        }
        sector.carrierMHz = site.carrier.carrierMHz;
        if (isInner) sector.power += kWiderBand;

        Cell& cell = cells.emplace_back(site);
        cell.pci = Pci(3 * ((37 * number + 11) % 168) + part);  // a site's three have the three primary sequences
        cell.identity = (kFirstBaseStation + number) << 8 | (part + 1);
        cell.load = random.between(0.15, 0.5);
        cell.priority = kPriority;
        cell.minimumLevel = isInner ? -124 : -128;
        if (part != 1) cell.maximumPower = 23;
        if (part != 2) cell.searchIntra = isInner ? 50 : 62;
        if (isInner) cell.searchOther = 36;
        cell.others = othersNear(number, part);
    }
}

}  // namespace kelvo::simulation::lte
