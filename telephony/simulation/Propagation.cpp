#include "telephony/simulation/Propagation.h"

#include <algorithm>
#include <cmath>

namespace kelvo::simulation {
namespace {

constexpr double kAboveRoofs = 15;  // metres
constexpr double kNearest = 35;     // metres
constexpr double kBeamWidth = 65;   // degrees between the points 3 dB down
constexpr double kFrontToBack = 20;
constexpr double kDeepestFade = -30;
constexpr double kAttenuation = 0.6;  // of what Shannon allows

}  // namespace

double pathLoss(double metres, double carrierMHz) {
    const double kilometres = std::max(metres, kNearest) / 1000;
    return 40 * (1 - 0.004 * kAboveRoofs) * std::log10(kilometres) - 18 * std::log10(kAboveRoofs) +
           21 * std::log10(carrierMHz) + 80;
}

double sectorGain(double degrees) {
    const double off = std::remainder(degrees, 360);
    return -std::min(12 * (off / kBeamWidth) * (off / kBeamWidth), kFrontToBack);
}

double Shadowing::after(double driven) {
    if (driven > _driven) {
        const double correlation = std::exp(-(driven - _driven) / kReach);
        _now = correlation * _now + kDeviation * std::sqrt(1 - correlation * correlation) * _random.normal();
        _driven = driven;
    }
    return _now;
}

double rayleighFading(Random& random) { return std::max(toDecibels(random.exponential(1)), kDeepestFade); }

double toMilliwatts(double dBm) { return std::pow(10, dBm / 10); }

double toDecibels(double ratio) { return 10 * std::log10(ratio); }

double linkCapacity(double bandwidth, double sinr) {
    return kAttenuation * bandwidth * std::log2(1 + toMilliwatts(sinr));
}

double neededSinr(double bandwidth, double capacity) {
    // Not exp2, whose last bit is another one on arm64.
    return toDecibels(std::pow(2, capacity / (kAttenuation * bandwidth)) - 1);
}

}  // namespace kelvo::simulation
