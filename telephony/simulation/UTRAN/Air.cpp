#include "telephony/simulation/UTRAN/Air.h"

#include <cmath>

namespace kelvo::simulation::utran {
namespace {

constexpr double kNewShare = 0.5;  // of a reading in the filtered level: filter coefficient 2

// A cell is found above this ratio of its P-CCPCH, dB, to interference and noise, and lost a little below.
constexpr double kFound = -2;
constexpr double kLost = -4;
constexpr double kJointRange = 15;  // dB below the serving cell: detected jointly

// A dedicated channel.
constexpr double kNoise = -174 + 61.1 + 9;  // dBm in 1.28 MHz, with the phone's noise figure
constexpr double kSpreading = 12;           // dB: a factor of 16
constexpr double kChannelShare = -3;        // dB: the most that one connection gets, beside the P-CCPCH
constexpr double kCancelled = -12;          // dB left of a cell that is detected jointly

}  // namespace

Air::Air(const Network& network, const Journey& journey, Random random)
    : _cells(network.cells),
      _drive(network.sectors, journey, random.split()),
      _random(std::move(random)),
      _filtered(_cells.size()) {
    const std::size_t strongest = _drive.byStrength().front();
    _filtered[strongest] = _drive.received(strongest);
}

void Air::measure(std::size_t serving) {
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        const double reading = _drive.received(i) + kReadingDeviation * _random.normal();
        const double ratio = _drive.received(i) - interference(i);
        if (ratio < kLost && i != serving) _filtered[i].reset();
        if (_filtered[i]) {
            _filtered[i] = std::lerp(*_filtered[i], reading, kNewShare);
        } else if (ratio > kFound || i == serving) {
            _filtered[i] = reading;
        }
    }
}

// Noise and every other P-CCPCH on a cell's carrier, dBm.
double Air::interference(std::size_t cell) const {
    double all = toMilliwatts(kNoise);
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (i != cell && _cells[i].uarfcn == _cells[cell].uarfcn) all += toMilliwatts(_drive.received(i));
    }
    return toDecibels(all);
}

bool Air::isJointlyDetected(std::size_t cell, std::size_t serving) const {
    return _cells[cell].uarfcn == _cells[serving].uarfcn && level(cell) > level(serving) - kJointRange;
}

double Air::availableSir(std::size_t serving) const {
    double interference = toMilliwatts(kNoise);
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (i == serving || _cells[i].uarfcn != _cells[serving].uarfcn) continue;
        const bool isJoint = _filtered[i] && isJointlyDetected(i, serving);
        interference += _cells[i].load * toMilliwatts(_drive.received(i) + (isJoint ? kCancelled : 0));
    }
    return _drive.received(serving) + kChannelShare + kSpreading - toDecibels(interference);
}

}  // namespace kelvo::simulation::utran
