#include "telephony/simulation/CDMA/Air.h"

#include <algorithm>

namespace kelvo::simulation::cdma {
namespace {

constexpr double kNoise = -105;        // dBm: thermal noise within 1.23 MHz and 8 dB of the receiver's own
constexpr double kReadingNoise = 0.4;  // dB
constexpr double kSearchNoise = 0.5;
constexpr double kSearchFloor = -25;  // dB: weaker pilots read as this
constexpr double kWhole = -0.05;      // dB: no pilot is more than all that is received

constexpr Loading kOneXLoading{.gain = 0, .pilot = 0.2, .all = 0.65, .secondAntenna = -1.5, .turnaround = -73};
// Pilot bursts go out with all of a sector's power. The carrier lies higher than the one that the drive was built for.
const Loading kEvdoLoading{.gain = pathLoss(1000, kOneXCarrier.downlinkMHz) - pathLoss(1000, kEvdoCarrier.downlinkMHz),
                           .pilot = 1,
                           .all = 1,
                           .secondAntenna = -2.5,
                           .turnaround = -76};

}  // namespace

std::size_t Reception::strongest() const {
    return static_cast<std::size_t>(std::ranges::max_element(pilots) - pilots.begin());
}

void Air::measure(Time now) {
    _drive.moveTo(now);
    _oneX = listen(kOneXLoading);
    _evdo = listen(kEvdoLoading);
}

Reception Air::listen(const Loading& loading) {
    double total = toMilliwatts(kNoise);
    for (const double received : _drive.received()) total += loading.all * toMilliwatts(received + loading.gain);
    Reception air;
    air.total = toDecibels(total);
    air.rx0 = air.total + kReadingNoise * _random.normal();
    air.rx1 = air.total + loading.secondAntenna + kReadingNoise * _random.normal();
    air.openLoop = loading.turnaround - air.rx0 + kReadingNoise * 2 * _random.normal();
    air.pilots.reserve(_drive.received().size());
    for (const double received : _drive.received()) {
        const double pilot = received + loading.gain + toDecibels(loading.pilot) - air.total;
        air.pilots.push_back(std::clamp(pilot + kSearchNoise * _random.normal(), kSearchFloor, kWhole));
    }
    return air;
}

}  // namespace kelvo::simulation::cdma
