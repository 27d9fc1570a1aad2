#include "telephony/simulation/CDMA/EvdoModem.h"

#include <algorithm>
#include <utility>

namespace kelvo::simulation::cdma {
namespace {

using namespace std::chrono_literals;

constexpr double kMostPower = 23;    // dBm
constexpr double kLeastPower = -50;  // dBm
constexpr double kBestPilot = 0.97;  // of all that is received: echoes of the own sector disturb too
constexpr std::size_t kFingers = 6;
constexpr double kStrongestPath = 20;                        // dB: what a finger can tell
constexpr double kFingerLock = -12;                          // dB; a weaker path has no finger
constexpr std::array<double, 3> kEchoes{-1.0, -7.5, -14.0};  // dB: the paths of a pilot

double carrierToInterference(double strength) {
    const double part = std::min(toMilliwatts(strength), kBestPilot);
    return toDecibels(part / (1 - part));
}

}  // namespace

EvdoModem::EvdoModem(const Network& network, const Reception& air, Random random)
    : _network(network), _air(air), _random(std::move(random)), _link(_random.split()) {}

void EvdoModem::measure(Time duration, double demand) {
    _status.rx0 = _air.rx0;
    _status.rx1 = _air.rx1;
    _status.tx = std::clamp(_air.openLoop, kLeastPower, kMostPower);
    readPilots();
    placeFingers();
    if (_status.state != EvdoState::Connected || _status.session != SessionState::Open) return;
    _link.receive(carrierToInterference(_air.pilots[_pilots.reference()]), demand, duration);
    _link.send(kMostPower - _status.tx, demand, duration);
}

void EvdoModem::step(Time now, bool available, bool browse) {
    if (!available) {
        begin(now, EvdoState::Inactive, 0ms);
        _pilots.clear();
    } else if (now >= _until) {
        advance(now, browse);
    }
    if (_status.state == EvdoState::Connected) _pilots.update(now, _air);
    const std::vector<std::size_t> before = std::exchange(_followed, _pilots.sectors());
    readPilots();
    if (_followed != before) placeFingers();
}

void EvdoModem::advance(Time now, bool browse) {
    switch (_status.state) {
        case EvdoState::Inactive: return begin(now, EvdoState::Acquisition, 400ms);
        case EvdoState::Acquisition: _pilots.follow(_air.strongest()); return begin(now, EvdoState::Sync, 200ms);
        case EvdoState::Sync: return begin(now, EvdoState::Idle, 100ms);
        case EvdoState::Idle: return idle(now, browse);
        case EvdoState::Access:
            if (_status.session != SessionState::Open) setUpAddress();
            return begin(now, EvdoState::Connected, 800ms);
        case EvdoState::Connected:
            _status.session = SessionState::Open;
            if (browse) return;
            _pilots.follow(_pilots.reference());
            return begin(now, EvdoState::Idle, 0ms);
    }
}

void EvdoModem::begin(Time now, EvdoState state, Time duration) {
    _status.state = state;
    _until = now + duration;
}

void EvdoModem::idle(Time now, bool browse) {
    _pilots.reselect(now, _air);
    const bool moved = static_cast<int>(_network.cells[_pilots.reference()].zone) != _sessionZone;
    if (moved || _status.session != SessionState::Open) _status.session = SessionState::AddressSetup;
    if (browse || _status.session != SessionState::Open) begin(now, EvdoState::Access, 400ms);
}

/// The subnet gives a new address; a session that is new to all is negotiated by the phone, one that moved in by the
/// network.
void EvdoModem::setUpAddress() {
    _status.session = _sessionZone < 0 ? SessionState::PhoneNegotiates : SessionState::NetworkNegotiates;
    const std::size_t zone = _network.cells[_pilots.reference()].zone;
    _sessionZone = static_cast<int>(zone);
    _status.colorCode = kZones[zone].colorCode;
    _status.uati = static_cast<std::uint32_t>(_random.between(0, 0xFFFFFF));
}

void EvdoModem::readPilots() {
    _status.active = _pilots.readings(_air, _network);
    _status.servingPn = _pilots.empty() ? std::nullopt : std::optional(_network.cells[_pilots.reference()].pn);
}

void EvdoModem::placeFingers() {
    _status.fingers.clear();
    for (const double echo : kEchoes) {
        for (const PilotReading& pilot : _status.active) {
            const double path = carrierToInterference(pilot.strength) + echo + rayleighFading(_random);
            if (path < kFingerLock) {
                _status.fingers.emplace_back();
            } else {
                _status.fingers.push_back({pilot.pn, std::min(path, kStrongestPath)});
            }
        }
    }
    if (_status.fingers.size() > kFingers) _status.fingers.resize(kFingers);
    while (!_status.fingers.empty() && !_status.fingers.back().pn) _status.fingers.pop_back();
}

}  // namespace kelvo::simulation::cdma
