#include "telephony/simulation/CDMA/Simulation.h"

#include <utility>
#include <vector>

#include "telephony/simulation/CDMA/Records.h"

namespace kelvo::simulation::cdma {
namespace {

using namespace std::chrono_literals;

constexpr double kDriveRadius = 2000;  // metres
constexpr Time kMeasurement = 100ms;

/// True when `value` is not what was told last; tells it.
template <class T>
bool isNews(T& told, const T& value) {
    return std::exchange(told, value) != value;
}

/// Who is in an active set, the one that is followed first.
std::vector<int> members(std::optional<PnOffset> followed, const std::vector<PilotReading>& active) {
    std::vector<int> members{followed ? int{*followed} : -1};
    for (const PilotReading& pilot : active) members.push_back(pilot.pn);
    return members;
}

}  // namespace

Simulation::Simulation(Random random)
    : _network(random),
      _drive{_network.sectors, Journey::through(kDriveRadius, random), random.split()},  // braces: in this order
      _user(random.split()),
      _modem(_network, std::move(random)) {}

void Simulation::step() {
    const PhoneUser::Activity activity = _user.at(now());
    if (every(kMeasurement)) {
        _drive.moveTo(now());
        _modem.measure(_drive, kMeasurement, _user.demand());
    }
    _modem.step(now(), activity);
    reportOneX();
    reportEvdo();
    reportPackets();
}

void Simulation::reportOneX() {
    const OneXStatus& status = _modem.oneX().status();
    const bool traffic = status.state == OneXState::Traffic;
    const bool moved = isNews(_toldOneXPilots, members(status.referencePn, status.active));
    const bool changed = isNews(_toldOneX, status.state) || moved;
    // An idle phone measures when it wakes, which is a change.
    if (changed || (traffic && every(500ms))) emit(oneXStatusRecord(now(), status));
    if (isNews(_toldSystem, _modem.oneX().system()) || every(30s)) emit(systemRecord(now(), _modem.oneX().system()));
    if (traffic) _modem.receiveFrame();
    if (traffic && every(100ms)) emit(trafficFrameRecord(now(), status.frameErased));  // the log has each fifth
}

void Simulation::reportEvdo() {
    const EvdoStatus& status = _modem.evdo().status();
    const bool connected = status.state == EvdoState::Connected;
    const bool moved = isNews(_toldEvdoPilots, members(status.servingPn, status.active));
    const bool negotiated = isNews(_toldSession, status.session);
    const bool changed = isNews(_toldEvdo, status.state) || moved || negotiated;
    if (changed || every(connected ? 1s : 2s, 200ms)) emit(evdoStatusRecord(now(), status));
    const bool on = status.state != EvdoState::Inactive;
    if (changed || (on && every(connected ? 500ms : 2s, 400ms))) emit(evdoPilotsRecord(now(), status.active));
    if (changed || (on && every(connected ? 500ms : 2s, 300ms))) emit(fingersRecord(now(), status.fingers));
}

/// The first two records make the first rate; after that a link at rest is told of seldom.
void Simulation::reportPackets() {
    const PacketCounters& counters = _modem.evdo().counters();
    const bool first = now() == 500ms || now() == 1500ms;
    const bool forward = every(2s, 500ms) && isNews(_toldForward, counters.forwardBits);
    if (first || forward || every(10s, 500ms)) emit(forwardPacketsRecord(now(), counters));
    const bool reverse = every(5s, 500ms) && isNews(_toldReverse, counters.reverseBits);
    if (first || reverse || every(30s, 500ms)) emit(reversePacketsRecord(now(), counters));
}

}  // namespace kelvo::simulation::cdma
