#include "telephony/simulation/IfxSimulation.h"

#include <utility>

#include "platform/encodings/PropertyList.h"
#include "telephony/simulation/IFX/Tree.h"

namespace kelvo::simulation {
namespace {

using namespace std::chrono_literals;

constexpr double kDriveRadius = 2000;       // metres
constexpr Time kMeasurement = 480ms;        // a SACCH period of 3GPP TS 45.008
constexpr Time kReport = 7 * kMeasurement;  // changes are told at once
constexpr Time kFirstReport = 3 * kMeasurement;

}  // namespace

IfxSimulation::IfxSimulation(std::uint64_t seed) : IfxSimulation(Random(seed)) {}

IfxSimulation::IfxSimulation(Random random)
    : _network(ifx::buildNetwork(random)),
      _drive{_network.radio, Journey::through(kDriveRadius, random), random.split()},  // braces: in this order
      _user(random.split()),
      _modem(_network, random.split()) {}

void IfxSimulation::step() {
    if (!every(kMeasurement)) return;
    const PhoneUser::Activity activity = _user.at(now());
    _drive.moveTo(now());
    _modem.measure(_drive, now(), activity, _user.demand());
    if (!isNews() && !every(kReport, kFirstReport)) return;
    if (const auto tree = writeXmlPropertyList(ifx::monitorTree(_modem.status(), _network))) emit(*tree);
}

bool IfxSimulation::isNews() {
    const ifx::Status& status = _modem.status();
    const News news{status.access, status.serving, status.registration, status.connection};
    return std::exchange(_told, news) != news;
}

}  // namespace kelvo::simulation
