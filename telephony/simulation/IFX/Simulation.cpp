#include "telephony/simulation/IFX/Simulation.h"

#include "telephony/simulation/IFX/Records.h"

namespace kelvo::simulation::ifx {
namespace {

using namespace std::chrono_literals;

constexpr Time kMeasurement = 480ms;  // a SACCH period of 3GPP TS 45.008
constexpr Time kPeriod = 7 * kMeasurement;

}  // namespace

Simulation::Simulation(std::uint64_t seed) : FamilySimulation(seed, 4s) {}

void Simulation::step() {
    if (!every(kMeasurement)) return;
    _user.moveTo(now());
    _air.measure(now());
    _modem.step(now(), _user);
    const Status& status = _modem.status();
    // Once more when a cell that was left has been measured: the phone may go back there.
    const bool isSettled = _settled(true, 2 * status.serving + (status.access == RadioAccess::Umts), now());
    const Content content{status.access, status.serving, isSettled, status.registration, status.connection};
    if (!_cellMonitor.isDue(now(), content, kPeriod)) return;
    emit(cellMonitorRecord(status, _network));
    _modem.markReported();
}

}  // namespace kelvo::simulation::ifx
