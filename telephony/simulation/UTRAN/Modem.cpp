#include "telephony/simulation/UTRAN/Modem.h"

#include <algorithm>
#include <cmath>

namespace kelvo::simulation::utran {
namespace {

using namespace std::chrono_literals;

constexpr Time kPeriod = 960ms;  // between measurements
constexpr std::size_t kMostCells = 6;
constexpr std::size_t kMostGsmCells = 6;
constexpr std::size_t kIdentifiedGsmCells = 4;
constexpr double kListedRange = 1600;  // metres: cells of sites up to here are in the serving cell's neighbor list
constexpr double kGsmStronger = 9;     // dB: a GSM carrier beside the P-CCPCH at the same mast

// Reselection (3GPP TS 25.304, section 5.2.6) and event 1G (TS 25.331, for TDD).
constexpr double kRankHysteresis = 4;  // Qhyst1, dB
constexpr Time kReselection = 960ms;   // Treselection
constexpr double kHysteresis = 3;      // dB
constexpr Time kTimeToTrigger = 960ms;
constexpr Time kLeastDwell = 2s;
constexpr Time kAfterRegistration = 300ms;  // the network lets the connection go

// How long a state lasts when nothing is sent.
constexpr Time kInactivity = 1s;
constexpr Time kFach = 2s;
constexpr Time kCellPch = 3s;
constexpr Time kUraPch = 3s;

// A dedicated channel: power control holds the ratio at its target as long as the base station can (TS 25.224).
constexpr double kSpeechTarget = 7;  // dB
constexpr double kDataTarget = 10;
constexpr double kControlError = 0.8;  // dB, deviation
constexpr double kFewestErrors = 1e-5;

// The share of blocks in error over the signal-to-interference ratio: about 1 % at its target, half of them 3 dB below.
double blockErrors(double sir, double target) {
    const double share = 1 / (1 + std::exp(1.6 * (sir - target + 3)));
    return share < kFewestErrors ? 0 : share;
}

}  // namespace

Modem::Modem(const Network& network, Air& air, Random random)
    : _network(network),
      _air(air),
      _random(std::move(random)),
      _serving(_air.drive().byStrength().front()),
      _better(kReselection),
      _registeredArea(serving().locationArea) {}

void Modem::step(Time now, const PhoneUser& user) {
    _hasMeasured = false;
    _now = now;
    finishRegistration();
    followUser(user);
    if (now % kPeriod == Time(0)) measure();
}

// A call, and data that are to be sent, want a dedicated channel.
void Modem::followUser(const PhoneUser& user) {
    if (!user.isTalking() && user.demand() == 0) return rest();
    switch (_rrcState) {
        case RrcState::Disconnected: enter(RrcState::Connecting, fromSeconds(_random.between(0.3, 0.7))); break;
        case RrcState::Connecting:
            if (_now >= _until) enter(RrcState::CellDch, kInactivity);
            break;
        case RrcState::CellDch: _until = _now + kInactivity; break;
        case RrcState::CellFach: enter(RrcState::CellDch, kInactivity); break;
        case RrcState::CellPch:
        case RrcState::UraPch: enter(RrcState::CellFach, kFach); break;
    }
    serve(user.isTalking() ? Session::Speech : Session::Data);
}

// Nothing to send: after a while downwards, state by state.
void Modem::rest() {
    if (_now < _until || (_registersAt && canSignal())) return;
    switch (_rrcState) {
        case RrcState::Disconnected: return;
        case RrcState::Connecting: return enter(RrcState::CellFach, kAfterRegistration);
        case RrcState::CellDch: return _session == Session::Speech ? disconnect() : enter(RrcState::CellFach, kFach);
        case RrcState::CellFach: return _session == Session::Data ? enter(RrcState::CellPch, kCellPch) : disconnect();
        case RrcState::CellPch: return enter(RrcState::UraPch, kUraPch);
        case RrcState::UraPch: return disconnect();
    }
}

void Modem::enter(RrcState state, Time duration) {
    if ((state == RrcState::CellDch) != isDedicated()) {
        _better = HeldFor(isDedicated() ? kReselection : kTimeToTrigger);
    }
    _rrcState = state;
    _until = _now + duration;
    if (isDedicated()) return;
    _transportChannels.clear();
    _composites.clear();
}

void Modem::serve(Session session) {
    if (session == Session::Data && _session != Session::Data) {
        _contexts = {"internet"};
        if (_random.chance(0.3)) _contexts.push_back("mms");
    }
    _session = session;
}

void Modem::disconnect() {
    enter(RrcState::Disconnected, Time(0));
    if (_session == Session::Data && _random.chance(0.4)) _contexts.clear();
    _session = Session::Registration;
}

// A location update (TS 24.008, section 4.4.1) needs a connection that can carry it.
void Modem::registerInArea() {
    if (isRegistered()) return _registersAt.reset();
    _registersAt = _now + fromSeconds(_random.between(0.9, 1.6));
    if (_rrcState == RrcState::Disconnected) enter(RrcState::Connecting, fromSeconds(_random.between(0.3, 0.7)));
    if (_rrcState == RrcState::CellPch || _rrcState == RrcState::UraPch) enter(RrcState::CellFach, kFach);
}

void Modem::finishRegistration() {
    if (!_registersAt || _now < *_registersAt || !canSignal()) return;
    _registersAt.reset();
    _registeredArea = serving().locationArea;
    _until = std::max(_until, _now + kAfterRegistration);
}

void Modem::measure() {
    _air.measure(_serving);
    changeCell();
    listCells();
    listGsmCells();
    if (isDedicated()) readChannels();
    _hasMeasured = true;
}

void Modem::changeCell() {
    std::size_t best = _serving;
    for (const Measurement& known : _measurements) {  // listed at least once before
        if (_air.isFound(known.cell) && _air.level(known.cell) > _air.level(best)) best = known.cell;
    }
    const double hysteresis = isDedicated() ? kHysteresis : kRankHysteresis;
    const bool isBetter = _air.level(best) > _air.level(_serving) + hysteresis && _now - _camped > kLeastDwell;
    if (_better(isBetter, best, _now)) camp(best);
}

void Modem::camp(std::size_t cell) {
    _serving = cell;
    _camped = _now;
    _better.restart();
    registerInArea();
}

void Modem::listCells() {
    _measurements.clear();
    for (std::size_t i = 0; i < _network.cells.size(); ++i) {
        if (!_air.isFound(i)) continue;
        _measurements.push_back({i, _air.level(i), setOf(i), _air.isJointlyDetected(i, _serving)});
    }
    std::ranges::stable_sort(_measurements, [this](const Measurement& one, const Measurement& other) {
        if (one.cell == _serving || other.cell == _serving) return one.cell == _serving && other.cell != _serving;
        return one.rscp > other.rscp;
    });
    if (_measurements.size() > kMostCells) _measurements.resize(kMostCells);
}

Measurement::Set Modem::setOf(std::size_t cell) const {
    if (cell == _serving) return Measurement::Set::Active;
    const double metres = distance(_network.sectors[cell].site, _network.sectors[_serving].site);
    return metres < kListedRange ? Measurement::Set::Monitored : Measurement::Set::Detected;
}

void Modem::listGsmCells() {
    _gsmMeasurements.clear();
    for (const std::size_t cell : _air.drive().byStrength()) {
        if (_gsmMeasurements.size() == kMostGsmCells) break;
        const double rssi = _air.drive().received(cell) + kGsmStronger + Air::kReadingDeviation * _random.normal();
        const bool isIdentified = _gsmMeasurements.size() < kIdentifiedGsmCells;
        _gsmMeasurements.push_back({cell, static_cast<int>(std::lround(rssi)), isIdentified});
    }
}

// Speech takes one timeslot and a transport channel for each of its three classes of bits, data the last three
// timeslots; signalling has a channel of its own.
void Modem::readChannels() {
    const bool isSpeech = _session == Session::Speech;
    const double target = isSpeech ? kSpeechTarget : kDataTarget;
    CompositeChannel composite{.id = 1, .timeslots = isSpeech ? 1 : 3};
    double sum = 0;
    for (int i = 0; i < composite.timeslots; ++i) {
        const double sir = std::min(target, _air.availableSir(_serving)) + kControlError * _random.normal();
        composite.sir[composite.sir.size() - composite.timeslots + i] = sir;
        sum += sir;
    }
    _composites = {composite};
    _transportChannels.clear();
    for (const int id : isSpeech ? std::vector{1, 2, 3, 24} : std::vector{5, 24}) {
        const double sir = sum / composite.timeslots + kControlError * _random.normal();
        _transportChannels.push_back({id, blockErrors(sir, target)});
    }
}

}  // namespace kelvo::simulation::utran
