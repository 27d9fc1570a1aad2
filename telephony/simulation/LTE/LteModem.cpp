#include "telephony/simulation/LTE/LteModem.h"

#include <algorithm>

namespace kelvo::simulation {
namespace {

using namespace std::chrono_literals;

constexpr Time kConnectedPeriod = 100ms;
constexpr Time kDrxCycle = 320ms;
constexpr double kMetresPerSample = 299'792'458 / 30.72e6;
constexpr int kSamplesInFrame = 307'200;
constexpr int kSubframes = 10'240;

// Reselection (3GPP TS 36.304, section 5.2.4.6).
constexpr double kRankHysteresis = 4;  // Qhyst, dB
constexpr Time kReselection = 1s;      // Treselection, and the least time on a cell
constexpr double kCandidateRange = 6;  // dB below the serving cell

// Event A3 (TS 36.331, section 5.5.4.4).
constexpr double kOffset = 3;      // a3-Offset, dB
constexpr double kHysteresis = 1;  // dB
constexpr Time kTimeToTrigger = 320ms;

// Release with a redirection to another carrier (TS 36.331, section 5.3.8).
constexpr double kRedirection = 6;  // dB better than the serving cell
constexpr Time kRedirectionTime = 640ms;
constexpr Time kAfterRedirection = 5s;

constexpr double kDriveRadius = 2000;  // metres
constexpr Time kAttach = 1200ms;       // the phone is switched on with the drive
constexpr double kCallShare = 0.4;     // of the sessions

constexpr double kLeastSrxlev = -30;  // dB: what reports show
constexpr double kMostSrxlev = 97;

}  // namespace

LteModem::LteModem(std::uint64_t seed)
    : _random(seed),
      _sectors(buildSectors({}, _random)),
      _cells(nameLteCells(_sectors, _random)),
      _drive{_sectors, Journey::through(kDriveRadius, _random), _random.split()},  // braces: in this order
      _receiver(_cells, _random.split()),
      _better(kReselection),
      _elsewhere(kRedirectionTime) {
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (meanLevel(i) > meanLevel(_serving)) _serving = i;
    }
    _registeredArea = serving().trackingArea;
}

void LteModem::moveTo(Time now) {
    _hasMeasured = _hasRegistered = _hasChangedContexts = false;
    _hasChangedCell = now == Time(0);
    _now = now;
    _drive.moveTo(now);
    if (now == Time(0)) connect(kAttach);
    followActivity();
    const Time period = _isConnected ? kConnectedPeriod : kDrxCycle;
    if (now % period != Time(0)) return;
    _hasMeasured = true;
    if (_isConnected) {
        measureConnected();
    } else {
        measureIdle();
    }
}

void LteModem::followActivity() {
    if (_registersAt && _now >= *_registersAt) {
        _registersAt.reset();
        _registeredArea = serving().trackingArea;
        _hasRegistered = true;
    }
    if (!_isConnected && _now >= _nextSession && !_registersAt) {
        connect(_now + fromSeconds(_random.between(6.0, 18.0)));
        _isOnCall = _random.chance(kCallShare);
        _hasChangedContexts = _isOnCall;
    }
    if (_isConnected && _now >= _connectedUntil && !_registersAt) {
        release(_now + fromSeconds(_random.between(7.0, 18.0)));
    }
}

void LteModem::connect(Time until) {
    if (!_isConnected) _better = HeldFor(kTimeToTrigger);
    _isConnected = true;
    _connectedUntil = std::max(_connectedUntil, until);
}

void LteModem::release(Time next) {
    _better = HeldFor(kReselection);
    _elsewhere.restart();
    _hasChangedContexts = _isOnCall;
    _isConnected = _isOnCall = false;
    _nextSession = next;
    _idle.failedCycles = 0;
}

// A tracking area update (TS 23.401, section 5.3.3), which takes a connection for its while.
void LteModem::registerInArea() {
    if (serving().trackingArea == _registeredArea) return _registersAt.reset();
    _registersAt = _now + fromSeconds(_random.between(0.3, 0.9));
    connect(*_registersAt + 200ms);
}

void LteModem::camp(std::size_t cell) {
    _serving = cell;
    _camped = _now;
    _hasChangedCell = true;
    _better.restart();
    registerInArea();
}

void LteModem::measureConnected() {
    _receiver.measure(_drive, serving().carrier, _serving, _now);
    measureInGaps();
    handOver();
    listNeighbors(serving().carrier);
    redirect();
}

// Where the serving cell is weak, the network leaves the phone gaps to measure other carriers in (TS 36.331, section
// 5.5.2.9).
void LteModem::measureInGaps() {
    const double srxlev = reading().averageRsrp - serving().minimumLevel;
    const bool isWeak = !serving().searchOther || srxlev <= *serving().searchOther;
    for (const LteCarrier& carrier : kLteCarriers) {
        if (isOnServingCarrier(carrier)) continue;
        if (isWeak) {
            _receiver.measure(_drive, carrier, _serving, _now);
        } else {
            _receiver.leave(carrier, _serving);
        }
    }
}

void LteModem::handOver() {
    const auto best = bestMeasured([this](const LteCell& cell) { return isOnServingCarrier(cell.carrier); });
    const bool isBetter = best && _receiver.reading(*best).averageRsrp - kHysteresis > reading().averageRsrp + kOffset;
    if (_better(isBetter, best.value_or(_serving), _now)) camp(*best);
}

// The connection does not reach to another carrier: the network ends it when the phone should go there, but no call.
void LteModem::redirect() {
    const auto best = bestMeasured([this](const LteCell& cell) { return !isOnServingCarrier(cell.carrier); });
    const bool isElsewhere = best && _receiver.reading(*best).averageRsrp > reading().averageRsrp + kRedirection;
    if (!_elsewhere(isElsewhere && !_isOnCall && !_registersAt, _serving, _now)) return;
    release(_now + kAfterRedirection);
    _hasMeasured = false;  // what was measured is no idle phone's
}

void LteModem::measureIdle() {
    _receiver.measure(_drive, serving().carrier, _serving, _now);
    evaluateServing();
    lookAround();
    weighCandidates();
    reselect();
    ++_cycle;
}

void LteModem::evaluateServing() {
    _idle.srxlev = std::clamp(reading().averageRsrp - serving().minimumLevel, kLeastSrxlev, kMostSrxlev);
    _idle.failedCycles = _idle.srxlev > 0 ? 0 : _idle.failedCycles + 1;
    const auto isBelow = [this](const std::optional<int>& limit) { return !limit || _idle.srxlev <= *limit; };
    int rules = 0;
    if (isBelow(serving().searchIntra)) rules |= LteIdleState::SearchIntra;
    if (isBelow(serving().searchOther)) rules |= LteIdleState::SearchInter | LteIdleState::SearchOther;
    _idle.rulesChanged = rules != _idle.rules;
    _idle.rules = rules;
}

// Looks at the carriers that the rules ask for, and lists what there is on one of them, each in its turn.
void LteModem::lookAround() {
    std::vector<LteCarrier> searched;
    for (const LteCarrier& carrier : kLteCarriers) {
        const bool isServing = isOnServingCarrier(carrier);
        if (_idle.rules & (isServing ? LteIdleState::SearchIntra : LteIdleState::SearchInter)) {
            if (!isServing) _receiver.measure(_drive, carrier, _serving, _now);
            searched.push_back(carrier);
        } else {
            _receiver.leave(carrier, _serving);
        }
    }
    if (searched.empty()) {
        _neighbors.clear();
    } else {
        listNeighbors(searched[_cycle % searched.size()]);
    }
}

void LteModem::listNeighbors(const LteCarrier& carrier) {
    _neighbors.clear();
    _detected.clear();
    _neighborsCarrier = carrier;
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (i == _serving || _cells[i].carrier.downlink != carrier.downlink) continue;
        _neighborsMinimumLevel = _cells[i].minimumLevel;
        if (_receiver.isMeasured(i, _now)) _neighbors.push_back(neighbor(i));
        if (_receiver.isDetected(i, _now)) _detected.push_back(_cells[i].physicalId);
    }
    std::ranges::sort(_neighbors, std::greater(), [](const LteNeighbor& cell) { return cell.reading.averageRsrp; });
}

LteNeighbor LteModem::neighbor(std::size_t cell) const {
    const LteCell& named = _cells[cell];
    const LteReading& reading = _receiver.reading(cell);
    const double metres = distance(_drive.position(), _drive.sectors()[cell].site);
    return {.physicalId = named.physicalId,
            .reading = reading,
            .srxlev = std::clamp(reading.averageRsrp - named.minimumLevel, kLeastSrxlev, kMostSrxlev),
            .frequencyError = named.frequencyError,
            .frames = named.frames,
            .samples = (named.samples + static_cast<int>(metres / kMetresPerSample)) % kSamplesInFrame};
}

void LteModem::weighCandidates() {
    std::vector<LteCandidate> candidates;
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (i == _serving || !_receiver.isMeasured(i, _now) || !isFit(i)) continue;
        if (_receiver.reading(i).averageRsrp < reading().averageRsrp - kCandidateRange) continue;
        const LteCell& cell = _cells[i];
        candidates.push_back({.priority = cell.priority, .channel = cell.carrier.downlink, .code = cell.physicalId});
    }
    if (_idle.rules & LteIdleState::SearchOther) {
        candidates.insert(candidates.end(), serving().others.begin(), serving().others.end());
    }
    _candidate.reset();
    if (!candidates.empty()) _candidate = candidates[_cycle % candidates.size()];
}

void LteModem::reselect() {
    const auto best = bestMeasured([](const LteCell&) { return true; });
    const bool isBetter = best && isFit(*best) &&
                          _receiver.reading(*best).averageRsrp > reading().averageRsrp + kRankHysteresis &&
                          _now - _camped > kReselection;
    if (!_better(isBetter, best.value_or(_serving), _now)) return;
    camp(*best);
    listNeighbors(serving().carrier);
    _hasMeasured = false;  // what was measured is the last cell's
}

std::optional<std::size_t> LteModem::bestMeasured(const std::function<bool(const LteCell&)>& isWanted) const {
    std::optional<std::size_t> best;
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (i == _serving || !isWanted(_cells[i]) || !_receiver.isMeasured(i, _now)) continue;
        if (!best || _receiver.reading(i).averageRsrp > _receiver.reading(*best).averageRsrp) best = i;
    }
    return best;
}

double LteModem::meanLevel(std::size_t cell) const {
    return _drive.received(cell) - toDecibels(12.0 * _cells[cell].carrier.resourceBlocks);
}

int LteModem::subframe() const {
    const auto milliseconds = std::chrono::duration_cast<std::chrono::milliseconds>(_now).count();
    return static_cast<int>((milliseconds + 10 * serving().frames) % kSubframes);
}

}  // namespace kelvo::simulation
