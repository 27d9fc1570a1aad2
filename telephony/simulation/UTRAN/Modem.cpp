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
constexpr Time kLeastOnCell = 2s;
constexpr Time kAfterRegistration = 300ms;  // the network lets the connection go

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

void Modem::step(Time now) {
    _hasMeasured = _hasChangedState = _hasRegistered = _hasChangedContexts = false;
    _hasChangedCell = now == Time(0);
    _now = now;
    finishRegistration();
    followConnection();
    if (now % kPeriod == Time(0)) measure();
}

void Modem::followConnection() {
    if (_now < _until || (_registersAt && canSignal())) return;
    switch (_rrcState) {
        case RrcState::Disconnected: return begin(_random.chance(0.3) && _now > 2s ? Session::Speech : Session::Data);
        case RrcState::Connecting:
            if (_session == Session::Registration) return enter(RrcState::CellFach, 0.3);
            return enter(RrcState::CellDch, _random.between(5.0, 14.0));
        case RrcState::CellDch:
            if (_session == Session::Speech) return disconnect();
            return enter(RrcState::CellFach, 3);  // nothing sent for a while, and so on downwards
        case RrcState::CellFach:
            if (_session == Session::Registration) return disconnect();
            if (_random.chance(0.3)) return enter(RrcState::CellDch, _random.between(3.0, 8.0));
            return enter(RrcState::CellPch, 3);
        case RrcState::CellPch: return enter(RrcState::UraPch, _random.between(2.0, 6.0));
        case RrcState::UraPch: return disconnect();
    }
}

void Modem::enter(RrcState state, double seconds) {
    if ((state == RrcState::CellDch) != isDedicated()) {
        _better = HeldFor(isDedicated() ? kReselection : kTimeToTrigger);
    }
    _hasChangedState = true;
    _rrcState = state;
    _until = _now + fromSeconds(seconds);
    if (!isDedicated()) {
        _transportChannels.clear();
        _composites.clear();
    }
}

void Modem::begin(Session session) {
    _session = session;
    enter(RrcState::Connecting, _random.between(0.3, 0.7));
    if (session != Session::Data) return;
    const std::vector<const char*> before = _contexts;
    _contexts = {"internet"};
    if (_random.chance(0.3)) _contexts.push_back("mms");
    _hasChangedContexts = _contexts != before;
}

void Modem::disconnect() {
    enter(RrcState::Disconnected, _random.between(6.0, 14.0));
    if (_session != Session::Data || !_random.chance(0.4)) return;
    _contexts.clear();
    _hasChangedContexts = true;
}

// A location update (TS 24.008, section 4.4.1) needs a connection that can carry it.
void Modem::registerInArea() {
    if (isRegistered()) return _registersAt.reset();
    _registersAt = _now + fromSeconds(_random.between(0.9, 1.6));
    if (_rrcState == RrcState::Disconnected) begin(Session::Registration);
    if (_rrcState == RrcState::CellPch || _rrcState == RrcState::UraPch) enter(RrcState::CellFach, 1);
}

void Modem::finishRegistration() {
    if (!_registersAt || _now < *_registersAt || !canSignal()) return;
    _registersAt.reset();
    _registeredArea = serving().locationArea;
    _hasRegistered = true;
    _until = std::max(_until, _now + kAfterRegistration);
}

void Modem::measure() {
    _air.measure(_serving, _random);
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
    const bool isBetter = _air.level(best) > _air.level(_serving) + hysteresis && _now - _camped > kLeastOnCell;
    if (_better(isBetter, best, _now)) camp(best);
}

void Modem::camp(std::size_t cell) {
    _serving = cell;
    _camped = _now;
    _hasChangedCell = true;
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
