#include "telephony/simulation/IFX/Air.h"

#include <algorithm>

namespace kelvo::simulation::ifx {
namespace {

constexpr double kReadingNoise = 0.8;  // dB that fading leaves in an average
constexpr double kGsmNoise = -113;     // dBm within 200 kHz, the receiver's own included
constexpr double kUmtsNoise = -100;    // dBm within 3.84 MHz
constexpr double kPilotShare = -10;    // dB of a sector's power
constexpr double kUmtsLoad = 0.6;      // part of its power that a sector sends

void readGsm(Air& air, const Drive& drive, const Network& network, Random& random) {
    const auto& cells = network.gsmCells;
    for (std::size_t i = 0; i < cells.size(); ++i) {
        double rest = toMilliwatts(kGsmNoise);
        for (std::size_t other = 0; other < cells.size(); ++other) {
            if (other != i && cells[other].arfcn == cells[i].arfcn) rest += toMilliwatts(drive.received(other));
        }
        const double reading = drive.received(i) + kReadingNoise * random.normal();
        air.rssi.push_back(std::clamp(reading, -110.0, -47.0));
        air.carrierToInterference.push_back(reading - toDecibels(rest));
    }
}

void readUmts(Air& air, const Drive& drive, const Network& network, Random& random) {
    double total = toMilliwatts(kUmtsNoise);
    for (std::size_t i = 0; i < network.umtsCells.size(); ++i) {
        if (network.umtsCells[i].built) total += kUmtsLoad * toMilliwatts(drive.received(i) + Network::kUmtsGain);
    }
    for (std::size_t i = 0; i < network.umtsCells.size(); ++i) {
        const double pilot = drive.received(i) + Network::kUmtsGain + kPilotShare + kReadingNoise * random.normal();
        const double rscp = network.umtsCells[i].built ? pilot : -120;
        air.rscp.push_back(std::clamp(rscp, -120.0, -25.0));
        air.ecN0.push_back(std::clamp(rscp - toDecibels(total), -24.0, 0.0));
    }
}

}  // namespace

Air listen(const Drive& drive, const Network& network, Random& random) {
    Air air;
    readGsm(air, drive, network, random);
    readUmts(air, drive, network, random);
    return air;
}

}  // namespace kelvo::simulation::ifx
