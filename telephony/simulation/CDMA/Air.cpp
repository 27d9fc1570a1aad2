#include "telephony/simulation/CDMA/Air.h"

#include <algorithm>

namespace kelvo::simulation::cdma {
namespace {

constexpr double kNoise = -105;  // dBm: thermal noise within 1.23 MHz and 8 dB of the receiver's own
constexpr double kSearchNoise = 0.5;
constexpr double kSearchFloor = -25;  // dB: weaker pilots read as this
constexpr double kWhole = -0.05;      // dB: no pilot is more than all that is received

}  // namespace

std::size_t Air::strongest() const {
    return static_cast<std::size_t>(std::ranges::max_element(pilots) - pilots.begin());
}

Air listen(const Drive& drive, const Loading& loading, Random& random) {
    double total = toMilliwatts(kNoise);
    for (const double received : drive.received()) total += loading.all * toMilliwatts(received + loading.gain);
    Air air{{}, toDecibels(total)};
    air.pilots.reserve(drive.received().size());
    for (const double received : drive.received()) {
        const double pilot = received + loading.gain + toDecibels(loading.pilot) - air.total;
        air.pilots.push_back(std::clamp(pilot + kSearchNoise * random.normal(), kSearchFloor, kWhole));
    }
    return air;
}

}  // namespace kelvo::simulation::cdma
