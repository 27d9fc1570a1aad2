#include "telephony/simulation/LTE/Air.h"

#include <algorithm>
#include <cmath>

namespace kelvo::simulation::lte {
namespace {

// Thermal noise in a resource block of 180 kHz with the 9 dB noise figure that 3GPP TR 36.942 gives a phone.
constexpr double kNoisePerBlock = -174 + 52.55 + 9;
constexpr int kSubcarriers = 12;  // of a resource block
// A cell is found above this SINR in dB, 2 dB more than TS 36.133, section 8.1.2.2, demands, and lost a little below.
constexpr double kFound = -8;
constexpr double kLost = -10;
constexpr Time kIdentify = std::chrono::milliseconds(800);  // TS 36.133: from finding to measuring
constexpr double kNewShare = 0.25;                          // of a reading in the average: filterCoefficient fc8
constexpr int kEchoes = 8;                                  // a wide carrier sees so many independent fades at once

}  // namespace

void Air::measure(Time now, const Carrier& carrier, std::size_t serving) {
    std::vector<double> mean(_cells.size());
    std::vector<double> faded(_cells.size());
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (!isOn(i, carrier)) continue;
        mean[i] = toMilliwatts(_drive.received(i));
        faded[i] = mean[i] * fading();
    }
    const double usual = sum(carrier, mean);
    const double heard = sum(carrier, faded);
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (!isOn(i, carrier)) continue;
        find(now, i, toDecibels(mean[i] / (usual - _cells[i].load * mean[i])), i == serving);
        if (_tracked[i].found) read(_tracked[i], faded[i], heard, carrier.resourceBlocks);
    }
}

// Everything that the antenna hears on the carrier, noise included, in mW.
double Air::sum(const Carrier& carrier, const std::vector<double>& power) const {
    double all = toMilliwatts(kNoisePerBlock) * carrier.resourceBlocks;
    for (std::size_t i = 0; i < _cells.size(); ++i) all += _cells[i].load * power[i];
    return all;
}

void Air::find(Time now, std::size_t cell, double sinr, bool isServing) {
    Tracked& tracked = _tracked[cell];
    if (sinr < kLost && !isServing) tracked = {};
    if ((sinr > kFound || isServing) && !tracked.found) tracked = {.found = now, .reading = {}};
}

void Air::read(Tracked& cell, double power, double all, int resourceBlocks) {
    const bool isFirst = cell.reading.rssi == 0;
    Reading& reading = cell.reading;
    reading.rsrp = std::clamp(toDecibels(power / (kSubcarriers * resourceBlocks)), -140.0, -44.0);
    reading.rsrq = std::clamp(toDecibels(power / (kSubcarriers * all)), -19.5, -3.0);  // blocks x RSRP / RSSI
    reading.rssi = toDecibels(all);
    const double share = isFirst ? 1 : kNewShare;
    reading.filteredRsrp = std::lerp(reading.filteredRsrp, reading.rsrp, share);
    reading.filteredRsrq = std::lerp(reading.filteredRsrq, reading.rsrq, share);
}

double Air::fading() {
    double sum = 0;
    for (int i = 0; i < kEchoes; ++i) sum += _random.exponential(1);
    return sum / kEchoes;
}

void Air::leave(const Carrier& carrier, std::size_t serving) {
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (isOn(i, carrier) && i != serving) _tracked[i] = {};
    }
}

bool Air::isMeasured(Time now, std::size_t cell) const {
    return _tracked[cell].found && now - *_tracked[cell].found >= kIdentify;
}

bool Air::isDetected(Time now, std::size_t cell) const { return _tracked[cell].found && !isMeasured(now, cell); }

}  // namespace kelvo::simulation::lte
