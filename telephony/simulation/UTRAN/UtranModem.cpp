#include "telephony/simulation/UTRAN/UtranModem.h"

#include <algorithm>
#include <cmath>

namespace kelvo::simulation {
namespace {

using namespace std::chrono_literals;

// Of the P-CCPCH: 33 dBm and 15 dB of antenna gain, less 10 dB that the car's body takes.
constexpr TownPlan kPlan = {.carrierMHz = 2010, .power = 38};
constexpr double kDriveRadius = 2000;      // metres
constexpr Time kPeriod = 960ms;            // between measurements
constexpr double kNewShare = 0.5;          // of a reading in the filtered level: filter coefficient 2
constexpr double kReadingDeviation = 1.5;  // dB: what is left of the fading in one reading

// A cell is found above this ratio of its P-CCPCH, dB, to all others on its carrier, and lost a little below.
constexpr double kFound = -2;
constexpr double kLost = -4;
constexpr std::size_t kMostCells = 6;
constexpr std::size_t kMostGsmCells = 6;
constexpr std::size_t kIdentifiedGsmCells = 4;
constexpr double kListedRange = 1600;  // metres: cells of sites up to here are in the serving cell's neighbor list
constexpr double kJointRange = 15;     // dB below the serving cell: detected jointly
constexpr double kGsmStronger = 9;     // dB: a GSM carrier beside the P-CCPCH at the same mast

// Reselection (3GPP TS 25.304, section 5.2.6) and event 1G (TS 25.331, for TDD).
constexpr double kRankHysteresis = 4;  // Qhyst1, dB
constexpr Time kReselection = 960ms;   // Treselection
constexpr double kHysteresis = 3;      // dB
constexpr Time kTimeToTrigger = 960ms;
constexpr Time kLeastOnCell = 2s;
constexpr Time kAfterRegistration = 300ms;  // the network lets the connection go

// A dedicated channel: power control holds the ratio at its target as long as the base station can (TS 25.224).
constexpr double kNoise = -174 + 61.1 + 9;  // dBm in 1.28 MHz, with the phone's noise figure
constexpr double kSpreading = 12;           // dB: a factor of 16
constexpr double kChannelShare = -3;        // dB: the most that one connection gets, beside the P-CCPCH
constexpr double kCancelled = -12;          // dB left of a cell that is detected jointly
constexpr double kSpeechTarget = 7;         // dB
constexpr double kDataTarget = 10;
constexpr double kControlError = 0.8;  // dB, deviation
constexpr double kFewestErrors = 1e-5;

// The share of blocks in error over the signal-to-interference ratio: about 1 % at its target, half of them 3 dB below.
double blockErrors(double sir, double target) {
    const double share = 1 / (1 + std::exp(1.6 * (sir - target + 3)));
    return share < kFewestErrors ? 0 : share;
}

}  // namespace

UtranModem::UtranModem(std::uint64_t seed)
    : _random(seed),
      _sectors(buildSectors(kPlan, _random)),
      _cells(nameUtranCells(_sectors, _random)),
      _drive{_sectors, Journey::through(kDriveRadius, _random), _random.split()},  // braces: in this order
      _filtered(_cells.size()),
      _better(kReselection) {
    _serving = _drive.byStrength().front();
    _registeredArea = serving().locationArea;
    _filtered[_serving] = _drive.received(_serving);
}

void UtranModem::moveTo(Time now) {
    _hasMeasured = _hasChangedMode = _hasRegistered = _hasChangedContexts = false;
    _hasChangedCell = now == Time(0);
    _now = now;
    _drive.moveTo(now);
    finishRegistration();
    followConnection();
    if (now % kPeriod == Time(0)) measure();
}

void UtranModem::followConnection() {
    if (_now < _until || (_registersAt && canSignal())) return;
    switch (_mode) {
        case UtranMode::Disconnected: return begin(_random.chance(0.3) && _now > 2s ? Session::Speech : Session::Data);
        case UtranMode::Connecting:
            if (_session == Session::Registration) return enter(UtranMode::CellFach, 0.3);
            return enter(UtranMode::CellDch, _random.between(5.0, 14.0));
        case UtranMode::CellDch:
            if (_session == Session::Speech) return disconnect();
            return enter(UtranMode::CellFach, 3);  // nothing sent for a while, and so on downwards
        case UtranMode::CellFach:
            if (_session == Session::Registration) return disconnect();
            if (_random.chance(0.3)) return enter(UtranMode::CellDch, _random.between(3.0, 8.0));
            return enter(UtranMode::CellPch, 3);
        case UtranMode::CellPch: return enter(UtranMode::UraPch, _random.between(2.0, 6.0));
        case UtranMode::UraPch: return disconnect();
    }
}

void UtranModem::enter(UtranMode mode, double seconds) {
    if ((mode == UtranMode::CellDch) != isDedicated()) {
        _better = HeldFor(isDedicated() ? kReselection : kTimeToTrigger);
    }
    _hasChangedMode = true;
    _mode = mode;
    _until = _now + fromSeconds(seconds);
    if (!isDedicated()) {
        _transportChannels.clear();
        _composites.clear();
    }
}

void UtranModem::begin(Session session) {
    _session = session;
    enter(UtranMode::Connecting, _random.between(0.3, 0.7));
    if (session != Session::Data) return;
    const std::vector<const char*> before = _contexts;
    _contexts = {"internet"};
    if (_random.chance(0.3)) _contexts.push_back("mms");
    _hasChangedContexts = _contexts != before;
}

void UtranModem::disconnect() {
    enter(UtranMode::Disconnected, _random.between(6.0, 14.0));
    if (_session != Session::Data || !_random.chance(0.4)) return;
    _contexts.clear();
    _hasChangedContexts = true;
}

// A location update (TS 24.008, section 4.4.1) needs a connection that can carry it.
void UtranModem::registerInArea() {
    if (isRegistered()) return _registersAt.reset();
    _registersAt = _now + fromSeconds(_random.between(0.9, 1.6));
    if (_mode == UtranMode::Disconnected) begin(Session::Registration);
    if (_mode == UtranMode::CellPch || _mode == UtranMode::UraPch) enter(UtranMode::CellFach, 1);
}

void UtranModem::finishRegistration() {
    if (!_registersAt || _now < *_registersAt || !canSignal()) return;
    _registersAt.reset();
    _registeredArea = serving().locationArea;
    _hasRegistered = true;
    _until = std::max(_until, _now + kAfterRegistration);
}

void UtranModem::measure() {
    readCells();
    changeCell();
    listCells();
    listGsmCells();
    if (isDedicated()) readChannels();
    _hasMeasured = true;
}

void UtranModem::readCells() {
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        const double reading = _drive.received(i) + kReadingDeviation * _random.normal();
        const double ratio = _drive.received(i) - interference(i);
        if (ratio < kLost && i != _serving) _filtered[i].reset();
        if (_filtered[i]) {
            _filtered[i] = std::lerp(*_filtered[i], reading, kNewShare);
        } else if (ratio > kFound || i == _serving) {
            _filtered[i] = reading;
        }
    }
}

// Noise and every other P-CCPCH on a cell's carrier, dBm.
double UtranModem::interference(std::size_t cell) const {
    double all = toMilliwatts(kNoise);
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (i != cell && _cells[i].uarfcn == _cells[cell].uarfcn) all += toMilliwatts(_drive.received(i));
    }
    return toDecibels(all);
}

void UtranModem::changeCell() {
    std::size_t best = _serving;
    for (const UtranMeasurement& known : _measurements) {  // listed at least once before
        if (_filtered[known.cell] && level(known.cell) > level(best)) best = known.cell;
    }
    const double hysteresis = isDedicated() ? kHysteresis : kRankHysteresis;
    const bool isBetter = level(best) > level(_serving) + hysteresis && _now - _camped > kLeastOnCell;
    if (_better(isBetter, best, _now)) camp(best);
}

void UtranModem::camp(std::size_t cell) {
    _serving = cell;
    _camped = _now;
    _hasChangedCell = true;
    _better.restart();
    registerInArea();
}

double UtranModem::level(std::size_t cell) const { return *_filtered[cell]; }

void UtranModem::listCells() {
    _measurements.clear();
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (_filtered[i]) _measurements.push_back({i, level(i), setOf(i), isCancelled(i)});
    }
    std::ranges::stable_sort(_measurements, [this](const UtranMeasurement& one, const UtranMeasurement& other) {
        if (one.cell == _serving || other.cell == _serving) return one.cell == _serving && other.cell != _serving;
        return one.rscp > other.rscp;
    });
    if (_measurements.size() > kMostCells) _measurements.resize(kMostCells);
}

UtranMeasurement::Set UtranModem::setOf(std::size_t cell) const {
    if (cell == _serving) return UtranMeasurement::Set::Active;
    const double metres = distance(_sectors[cell].site, _sectors[_serving].site);
    return metres < kListedRange ? UtranMeasurement::Set::Monitored : UtranMeasurement::Set::Detected;
}

bool UtranModem::isCancelled(std::size_t cell) const {
    return _cells[cell].uarfcn == serving().uarfcn && level(cell) > level(_serving) - kJointRange;
}

void UtranModem::listGsmCells() {
    _gsmMeasurements.clear();
    for (const std::size_t cell : _drive.byStrength()) {
        if (_gsmMeasurements.size() == kMostGsmCells) break;
        const double rssi = _drive.received(cell) + kGsmStronger + kReadingDeviation * _random.normal();
        const bool isIdentified = _gsmMeasurements.size() < kIdentifiedGsmCells;
        _gsmMeasurements.push_back({cell, static_cast<int>(std::lround(rssi)), isIdentified});
    }
}

// Speech takes one timeslot and a transport channel for each of its three classes of bits, data the last three
// timeslots; signalling has a channel of its own.
void UtranModem::readChannels() {
    const bool isSpeech = _session == Session::Speech;
    const double target = isSpeech ? kSpeechTarget : kDataTarget;
    UtranComposite composite{.id = 1, .timeslots = isSpeech ? 1 : 3};
    double sum = 0;
    for (int i = 0; i < composite.timeslots; ++i) {
        const double sir = std::min(target, availableSir()) + kControlError * _random.normal();
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

// What the base station can give at most, against everything else on the carrier; dB.
double UtranModem::availableSir() const {
    double interference = toMilliwatts(kNoise);
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (i == _serving || _cells[i].uarfcn != serving().uarfcn) continue;
        const bool isJoint = _filtered[i] && isCancelled(i);
        interference += _cells[i].load * toMilliwatts(_drive.received(i) + (isJoint ? kCancelled : 0));
    }
    return _drive.received(_serving) + kChannelShare + kSpreading - toDecibels(interference);
}

}  // namespace kelvo::simulation
