#include "telephony/simulation/LTE/Modem.h"

#include <algorithm>

namespace kelvo::simulation::lte {
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

constexpr Time kAttach = 1200ms;            // the phone is switched on with the drive
constexpr Time kAfterRegistration = 200ms;  // the network lets the connection go

constexpr double kLeastSrxlev = -30;  // dB: what reports show
constexpr double kMostSrxlev = 97;

}  // namespace

Modem::Modem(const Network& network, Air& air, Random random)
    : _cells(network.cells),
      _air(air),
      _random(std::move(random)),
      _better(kReselection),
      _elsewhere(kRedirectionTime),
      _heldUntil(kAttach) {
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (meanLevel(i) > meanLevel(_serving)) _serving = i;
    }
    _registeredArea = serving().trackingArea;
}

void Modem::step(Time now, const PhoneUser& user) {
    _hasMeasured = false;
    _now = now;
    followUser(user);
    const Time period = _isConnected ? kConnectedPeriod : kDrxCycle;
    if (now % period != Time(0)) return;
    _hasMeasured = true;
    if (_isConnected) {
        measureConnected();
    } else {
        measureIdle();
    }
}

// Connected while the user does something, while it registers, and for a while after.
void Modem::followUser(const PhoneUser& user) {
    if (_registersAt && _now >= *_registersAt) {
        _registersAt.reset();
        _registeredArea = serving().trackingArea;
    }
    const bool isWanted = _now < _heldUntil || _registersAt || (!user.isResting() && _now >= _barredUntil);
    if (isWanted && !_isConnected) connect();
    if (!isWanted && _isConnected) release();
    _isOnCall = _isConnected && user.isTalking();
}

void Modem::connect() {
    _better = HeldFor(kTimeToTrigger);
    _isConnected = true;
}

void Modem::release() {
    _better = HeldFor(kReselection);
    _elsewhere.restart();
    _isConnected = _isOnCall = false;
    _idle.failedCycles = 0;
}

// A tracking area update (TS 23.401, section 5.3.3), which takes a connection for its while.
void Modem::registerInArea() {
    if (serving().trackingArea == _registeredArea) return _registersAt.reset();
    _registersAt = _now + fromSeconds(_random.between(0.3, 0.9));
    _heldUntil = std::max(_heldUntil, *_registersAt + kAfterRegistration);
    if (!_isConnected) connect();
}

void Modem::camp(std::size_t cell) {
    _serving = cell;
    _camped = _now;
    _better.restart();
    registerInArea();
}

void Modem::measureConnected() {
    _air.measure(_now, serving().carrier, _serving);
    measureInGaps();
    handOver();
    listNeighbors(serving().carrier);
    redirect();
}

// Where the serving cell is weak, the network leaves the phone gaps to measure other carriers in (TS 36.331, section
// 5.5.2.9).
void Modem::measureInGaps() {
    const double srxlev = reading().filteredRsrp - serving().minimumLevel;
    const bool isWeak = !serving().searchOther || srxlev <= *serving().searchOther;
    for (const Carrier& carrier : kCarriers) {
        if (isOnServingCarrier(carrier)) continue;
        if (isWeak) {
            _air.measure(_now, carrier, _serving);
        } else {
            _air.leave(carrier, _serving);
        }
    }
}

void Modem::handOver() {
    const auto best = bestMeasured([this](const Cell& cell) { return isOnServingCarrier(cell.carrier); });
    const bool isBetter = best && _air.reading(*best).filteredRsrp - kHysteresis > reading().filteredRsrp + kOffset;
    if (_better(isBetter, best.value_or(_serving), _now)) camp(*best);
}

// The connection does not reach to another carrier: the network ends it when the phone should go there, but no call.
void Modem::redirect() {
    const auto best = bestMeasured([this](const Cell& cell) { return !isOnServingCarrier(cell.carrier); });
    const bool isElsewhere = best && _air.reading(*best).filteredRsrp > reading().filteredRsrp + kRedirection;
    if (!_elsewhere(isElsewhere && !_isOnCall && !_registersAt, _serving, _now)) return;
    _barredUntil = _now + kAfterRedirection;
    release();
    _hasMeasured = false;  // what was measured is not what an idle phone reports
}

void Modem::measureIdle() {
    _air.measure(_now, serving().carrier, _serving);
    evaluateServing();
    lookAround();
    weighCandidates();
    reselect();
    ++_cycle;
}

void Modem::evaluateServing() {
    _idle.srxlev = std::clamp(reading().filteredRsrp - serving().minimumLevel, kLeastSrxlev, kMostSrxlev);
    _idle.failedCycles = _idle.srxlev > 0 ? 0 : _idle.failedCycles + 1;
    const auto isBelow = [this](const std::optional<int>& limit) { return !limit || _idle.srxlev <= *limit; };
    int rules = 0;
    if (isBelow(serving().searchIntra)) rules |= IdleState::SearchIntra;
    if (isBelow(serving().searchOther)) rules |= IdleState::SearchInter | IdleState::SearchOther;
    _idle.rulesChanged = rules != _idle.rules;
    _idle.rules = rules;
}

// Looks at the carriers that the rules ask for, and lists what there is on one of them, each in its turn.
void Modem::lookAround() {
    std::vector<Carrier> searched;
    for (const Carrier& carrier : kCarriers) {
        const bool isServing = isOnServingCarrier(carrier);
        if (_idle.rules & (isServing ? IdleState::SearchIntra : IdleState::SearchInter)) {
            if (!isServing) _air.measure(_now, carrier, _serving);
            searched.push_back(carrier);
        } else {
            _air.leave(carrier, _serving);
        }
    }
    if (searched.empty()) {
        _neighbors.clear();
    } else {
        listNeighbors(searched[_cycle % searched.size()]);
    }
}

void Modem::listNeighbors(const Carrier& carrier) {
    _neighbors.clear();
    _detected.clear();
    _neighborsCarrier = carrier;
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (i == _serving || _cells[i].carrier.downlink != carrier.downlink) continue;
        _neighborsMinimumLevel = _cells[i].minimumLevel;
        if (_air.isMeasured(_now, i)) _neighbors.push_back(neighbor(i));
        if (_air.isDetected(_now, i)) _detected.push_back(_cells[i].pci);
    }
    std::ranges::sort(_neighbors, std::greater(), [](const Neighbor& cell) { return cell.reading.filteredRsrp; });
}

Neighbor Modem::neighbor(std::size_t cell) const {
    const Cell& named = _cells[cell];
    const Reading& reading = _air.reading(cell);
    const double metres = distance(_air.drive().position(), _air.drive().sectors()[cell].site);
    return {.pci = named.pci,
            .reading = reading,
            .srxlev = std::clamp(reading.filteredRsrp - named.minimumLevel, kLeastSrxlev, kMostSrxlev),
            .frequencyError = named.frequencyError,
            .frames = named.frames,
            .samples = (named.samples + static_cast<int>(metres / kMetresPerSample)) % kSamplesInFrame};
}

void Modem::weighCandidates() {
    std::vector<Candidate> candidates;
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (i == _serving || !_air.isMeasured(_now, i) || !isFit(i)) continue;
        if (_air.reading(i).filteredRsrp < reading().filteredRsrp - kCandidateRange) continue;
        const Cell& cell = _cells[i];
        candidates.push_back({cell.priority, Candidate::Lte{cell.carrier.downlink, cell.pci}});
    }
    if (_idle.rules & IdleState::SearchOther) {
        candidates.insert(candidates.end(), serving().others.begin(), serving().others.end());
    }
    _candidate.reset();
    if (!candidates.empty()) _candidate = candidates[_cycle % candidates.size()];
}

void Modem::reselect() {
    const auto best = bestMeasured([](const Cell&) { return true; });
    const bool isBetter = best && isFit(*best) &&
                          _air.reading(*best).filteredRsrp > reading().filteredRsrp + kRankHysteresis &&
                          _now - _camped > kReselection;
    if (!_better(isBetter, best.value_or(_serving), _now)) return;
    camp(*best);
    listNeighbors(serving().carrier);
    _hasMeasured = false;  // what was measured is the last cell's
}

std::optional<std::size_t> Modem::bestMeasured(const std::function<bool(const Cell&)>& isWanted) const {
    std::optional<std::size_t> best;
    for (std::size_t i = 0; i < _cells.size(); ++i) {
        if (i == _serving || !isWanted(_cells[i]) || !_air.isMeasured(_now, i)) continue;
        if (!best || _air.reading(i).filteredRsrp > _air.reading(*best).filteredRsrp) best = i;
    }
    return best;
}

double Modem::meanLevel(std::size_t cell) const {
    return _air.drive().received(cell) - toDecibels(12.0 * _cells[cell].carrier.resourceBlocks);
}

int Modem::subframe() const {
    const auto milliseconds = std::chrono::duration_cast<std::chrono::milliseconds>(_now).count();
    return static_cast<int>((milliseconds + 10 * serving().frames) % kSubframes);
}

}  // namespace kelvo::simulation::lte
