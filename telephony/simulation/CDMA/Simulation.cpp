#include "telephony/simulation/CDMA/Simulation.h"

#include "telephony/simulation/CDMA/Records.h"

namespace kelvo::simulation::cdma {
namespace {

using namespace std::chrono_literals;

constexpr Time kNever = Time::max();

/// Who is in an active set, the one that is followed first.
std::vector<int> members(std::optional<PnOffset> followed, const std::vector<PilotReading>& active) {
    std::vector<int> members{followed ? int{*followed} : -1};
    for (const PilotReading& pilot : active) members.push_back(pilot.pn);
    return members;
}

}  // namespace

Simulation::Simulation(std::uint64_t seed) : FamilySimulation(seed, 4s) {}

void Simulation::step() {
    const bool isMeasurement = every(Modem::kMeasurement);
    _user.moveTo(now());
    if (isMeasurement) _air.measure(now());
    _modem.step(now(), _user, isMeasurement);
    reportOneX();
    reportEvdo();
    reportPackets();
}

void Simulation::reportOneX() {
    const OneXStatus& status = _modem.oneX().status();
    const bool isTraffic = status.state == OneXState::Traffic;
    // An idle phone measures when it wakes, which is a change.
    const OneXContent content{status.state, members(status.referencePn, status.active)};
    if (_oneX.isDue(now(), content, isTraffic ? 500ms : kNever)) emit(oneXStatusRecord(now(), status));
    if (_system.isDue(now(), _modem.oneX().system(), 30s)) emit(systemRecord(now(), _modem.oneX().system()));
    if (!isTraffic) return;
    _modem.receiveFrame();
    if (every(100ms)) emit(trafficFrameRecord(now(), status.frameErased));  // the log has each fifth
}

void Simulation::reportEvdo() {
    const EvdoStatus& status = _modem.evdo().status();
    const bool isConnected = status.state == EvdoState::Connected;
    const EvdoContent content{status.state, status.session, members(status.servingPn, status.active)};
    if (_evdo.isDue(now(), content, isConnected ? 1s : 2s)) emit(evdoStatusRecord(now(), status));
    const Time period = status.state == EvdoState::Inactive ? kNever : isConnected ? 500ms : 2s;
    if (!_evdoPilots.isDue(now(), content, period)) return;
    emit(evdoPilotsRecord(now(), status.active));
    emit(fingersRecord(now(), status.fingers));
}

/// The first two records make the first rate; after that a link at rest is reported seldom.
void Simulation::reportPackets() {
    const PacketCounters& counters = _modem.evdo().counters();
    const bool isFirst = now() == 500ms || now() == 1500ms;
    const bool isForward = every(2s, 500ms) && _forward.isDue(now(), counters.forwardBits, 10s);
    if (isFirst || isForward) emit(forwardPacketsRecord(now(), counters));
    const bool isReverse = every(5s, 500ms) && _reverse.isDue(now(), counters.reverseBits, 30s);
    if (isFirst || isReverse) emit(reversePacketsRecord(now(), counters));
}

}  // namespace kelvo::simulation::cdma
