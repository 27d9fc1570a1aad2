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
    // A cell that was left is measured when the next has held for one period: what the phone may go to has been told.
    const bool isSettled = _settled(true, 2 * status.serving + (status.access == RadioAccess::Umts), now());
    const Content content{status.access, status.serving, isSettled, status.registration, status.connection};
    if (_cellMonitor.isDue(now(), content, kPeriod)) emit(cellMonitorRecord(status, _network));
}

}  // namespace kelvo::simulation::ifx
