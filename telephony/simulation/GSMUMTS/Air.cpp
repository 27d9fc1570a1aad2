#include "telephony/simulation/GSMUMTS/Air.h"

#include <algorithm>
#include <cmath>
#include <set>

namespace kelvo::simulation::gsm {
namespace {

constexpr double kNoise = -100;      // dBm in 3.84 MHz with a receiver's noise figure of 8 dB
constexpr double kNewWeight = 0.25;  // of a sample; one comes every 160 ms
constexpr double kGsmSpread = 2;     // dB: samples about the mean
constexpr double kUmtsSpread = 1.5;  // dB: less, as the carrier is wider than a fade
constexpr double kOwnCellLeft = 0.1;
constexpr double kDataShare = 0.4;

}  // namespace

Air::Air(const Network& network, const Journey& journey, Random random)
    : _network(network),
      _gsm(network.gsmSectors, journey, random.split()),
      _umts(network.umtsSectors, journey, random.split()),
      _random(random.split()),
      _gsmLevels(network.gsmCells.size()),
      _ecNo(network.umtsCells.size()) {}

void Air::measure(Time time) {
    _gsm.moveTo(time);
    _umts.moveTo(time);
    measureGsm();
    measureUmts();
    _isFirst = false;
}

void Air::measureGsm() {
    for (std::size_t i = 0; i < _gsmLevels.size(); ++i) {
        const double sample = _gsm.received(i) + kGsmSpread * _random.normal();
        _gsmLevels[i] = _isFirst ? sample : std::lerp(_gsmLevels[i], sample, kNewWeight);
    }
    _gsmByLevel = byStrength(_gsmLevels);
    std::set<int> heard;
    std::erase_if(_gsmByLevel,
                  [&](std::size_t sector) { return !heard.insert(_network.gsmCells[sector].arfcn).second; });
}

void Air::measureUmts() {
    double total = toMilliwatts(kNoise);
    for (const double received : _umts.received()) total += kLoad * toMilliwatts(received);
    _umtsRssi = toDecibels(total);
    for (std::size_t i = 0; i < _ecNo.size(); ++i) {
        const double sample = _umts.received(i) + kPilotShare - _umtsRssi + kUmtsSpread * _random.normal();
        _ecNo[i] = std::max(_isFirst ? sample : std::lerp(_ecNo[i], sample, kNewWeight), kEcNoFloor);
    }
    _umtsByEcNo = byStrength(_ecNo);
}

double Air::dataSinr(std::size_t sector) const {
    const double own = toMilliwatts(rscp(sector) - kPilotShare);
    const double others = std::max(toMilliwatts(_umtsRssi) - kLoad * own, toMilliwatts(kNoise));
    return toDecibels(kDataShare * own / (others + kOwnCellLeft * kLoad * own));
}

}  // namespace kelvo::simulation::gsm
