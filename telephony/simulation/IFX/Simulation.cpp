#include "telephony/simulation/IFX/Simulation.h"

#include <utility>

#include "telephony/simulation/IFX/Records.h"

namespace kelvo::simulation::ifx {
namespace {

using namespace std::chrono_literals;

constexpr double kDriveRadius = 2000;       // metres
constexpr Time kMeasurement = 480ms;        // a SACCH period of 3GPP TS 45.008
constexpr Time kReport = 7 * kMeasurement;  // changes are told at once
constexpr Time kFirstReport = 3 * kMeasurement;

}  // namespace

Simulation::Simulation(Random random)
    : _network(random),
      _drive{_network.sectors, Journey::through(kDriveRadius, random), random.split()},  // braces: in this order
      _user(random.split()),
      _modem(_network, random.split()) {}

void Simulation::step() {
    if (!every(kMeasurement)) return;
    const PhoneUser::Activity activity = _user.at(now());
    _drive.moveTo(now());
    _modem.measure(now(), _drive, activity, _user.demand());
    if (!isNews() && !every(kReport, kFirstReport)) return;
    emit(cellMonitorRecord(_modem.status(), _network));
}

bool Simulation::isNews() {
    const Status& status = _modem.status();
    const News news{status.access, status.serving, status.registration, status.connection};
    return std::exchange(_told, news) != news;
}

}  // namespace kelvo::simulation::ifx
