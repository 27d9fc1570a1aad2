#include "telephony/simulation/CDMA/OneXModem.h"

#include <algorithm>
#include <cmath>

namespace kelvo::simulation::cdma {
namespace {

using namespace std::chrono_literals;

constexpr Time kSlotCycle = 2560ms;  // SLOT_CYCLE_INDEX 1
constexpr Time kAwake = 480ms;       // of each cycle, for the paging slot and a look at the neighbors
constexpr Time kOverhead = 300ms;
constexpr Time kRegistration = 1200ms;
constexpr Time kAccess = 600ms;
constexpr double kMostPower = 24;  // dBm
constexpr double kLeastPower = -50;

/// Frames lost by what all active pilots together are received with, in dB: power control holds 1 % until it cannot.
double frameErrors(double strength) { return 0.01 + 0.6 / (1 + std::exp(strength + 13)); }

}  // namespace

OneXModem::OneXModem(const Network& network, const Reception& air, Random random)
    : _network(network), _air(air), _random(std::move(random)) {}

bool OneXModem::isIdle() const {
    return _status.state == OneXState::Sleep || (_status.state == OneXState::Paging && _task != Task::Access);
}

void OneXModem::measure() {
    _status.rx0 = _air.rx0;
    _status.rx1 = _air.rx1;
    _status.tx = std::clamp(_air.openLoop, kLeastPower, kMostPower);
    readPilots();
}

void OneXModem::step(Time now, bool talk) {
    if (_status.state == OneXState::Traffic) {
        if (talk) {
            _pilots.update(now, _air);
        } else {
            begin(now, OneXState::Initial, 100ms);
            _pilots.clear();
        }
    } else if (now >= _until) {
        if (isIdle() || _task == Task::Access) {
            finishTask();
            idle(now, talk);
        } else {
            powerUp(now);
        }
    }
    readPilots();
}

void OneXModem::receiveFrame() {
    double together = 0;
    for (const PilotReading& pilot : _status.active) together += toMilliwatts(pilot.strength);
    _status.frameErased = _random.chance(frameErrors(toDecibels(together)));
}

void OneXModem::begin(Time now, OneXState state, Time duration) {
    _status.state = state;
    _until = now + duration;
}

void OneXModem::begin(Time now, Task task, Time duration) {
    _task = task;
    begin(now, OneXState::Paging, duration);
}

void OneXModem::powerUp(Time now) {
    switch (_status.state) {
        case OneXState::Powerup: return begin(now, OneXState::Initial, 100ms);
        case OneXState::Initial: return begin(now, OneXState::Acquisition, 200ms);
        case OneXState::Acquisition: _pilots.follow(_air.strongest()); return begin(now, OneXState::Sync, 100ms);
        case OneXState::Sync: return begin(now, OneXState::Slew, 60ms);
        default: return begin(now, Task::Overhead, kOverhead);
    }
}

void OneXModem::finishTask() {
    switch (_task) {
        case Task::None: break;
        case Task::Overhead: _system = _network.systemOf(_pilots.reference()); break;
        case Task::Registration:
            _registeredZone = static_cast<int>(_network.cells[_pilots.reference()].zone);
            ++_registrations;
            break;
        case Task::Access: _status.state = OneXState::Traffic; break;
    }
    _task = Task::None;
}

void OneXModem::idle(Time now, bool talk) {
    if (_status.state == OneXState::Traffic) return;
    const Cell& cell = _network.cells[_pilots.reference()];
    if (static_cast<int>(cell.zone) != _registeredZone) return begin(now, Task::Registration, kRegistration);
    if (talk) return begin(now, Task::Access, kAccess);
    const bool awake = now % kSlotCycle < kAwake;
    _status.state = awake ? OneXState::Paging : OneXState::Sleep;
    if (awake && _pilots.reselect(now, _air)) begin(now, Task::Overhead, kOverhead);
}

void OneXModem::readPilots() {
    _status.active = _pilots.readings(_air, _network);
    _status.referencePn = _pilots.empty() ? PnOffset() : _network.cells[_pilots.reference()].pn;
}

}  // namespace kelvo::simulation::cdma
