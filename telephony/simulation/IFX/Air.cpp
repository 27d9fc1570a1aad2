#include "telephony/simulation/IFX/Air.h"

#include <algorithm>

namespace kelvo::simulation::ifx {
namespace {

constexpr double kReadingNoise = 0.8;  // dB that fading leaves in an average
constexpr double kGsmNoise = -113;     // dBm within 200 kHz, the receiver's own included
constexpr double kUmtsNoise = -100;    // dBm within 3.84 MHz
constexpr double kPilotShare = -10;    // dB of a sector's power
constexpr double kUmtsLoad = 0.6;      // part of its power that a sector sends

}  // namespace

void Air::measure(Time now) {
    _drive.moveTo(now);
    readGsm();
    readUmts();
}

void Air::readGsm() {
    _rssi.clear();
    _carrierToInterference.clear();
    const auto& cells = _network.gsmCells;
    for (std::size_t i = 0; i < cells.size(); ++i) {
        double interference = toMilliwatts(kGsmNoise);
        for (std::size_t other = 0; other < cells.size(); ++other) {
            if (other != i && cells[other].arfcn == cells[i].arfcn)
                interference += toMilliwatts(_drive.received(other));
        }
        const double reading = _drive.received(i) + kReadingNoise * _random.normal();
        _rssi.push_back(std::clamp(reading, -110.0, -47.0));
        _carrierToInterference.push_back(reading - toDecibels(interference));
    }
}

void Air::readUmts() {
    _rscp.clear();
    _ecN0.clear();
    const auto& cells = _network.umtsCells;
    double total = toMilliwatts(kUmtsNoise);
    for (std::size_t i = 0; i < cells.size(); ++i) {
        if (cells[i].built) total += kUmtsLoad * toMilliwatts(_drive.received(i) + Network::kUmtsGain);
    }
    for (std::size_t i = 0; i < cells.size(); ++i) {
        const double pilot = _drive.received(i) + Network::kUmtsGain + kPilotShare + kReadingNoise * _random.normal();
        const double rscp = cells[i].built ? pilot : -120;
        _rscp.push_back(std::clamp(rscp, -120.0, -25.0));
        _ecN0.push_back(std::clamp(rscp - toDecibels(total), -24.0, 0.0));
    }
}

}  // namespace kelvo::simulation::ifx
