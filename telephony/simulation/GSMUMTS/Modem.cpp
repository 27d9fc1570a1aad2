#include "telephony/simulation/GSMUMTS/Modem.h"

#include <algorithm>
#include <functional>

namespace kelvo::simulation::gsm {
namespace {

using namespace std::chrono_literals;

constexpr Time kCellSelection = 200ms;
constexpr Time kOpening = 200ms;
constexpr Time kClosing = 200ms;
constexpr Time kFachTail = 4s;
constexpr Time kPchTail = 8s;
constexpr Time kInterRatChange = 300ms;

constexpr double kRxLevAccessMin = -104;  // dBm
constexpr double kCellReselectHysteresis = 4;
constexpr double kHandoverMargin = 3;
constexpr double kQhyst = 4;
constexpr double kQoffsetUmts = 2;
constexpr double kQoffsetGsm = 7;
constexpr double kQqualMin = -18;         // dB
constexpr double kSsearchRat = 4;         // dB: GSM is measured below -14 dB
constexpr double kBestHysteresis = 2;     // dB, event 1D
constexpr double kCompressedBelow = -13;  // dB, event 2D: in a connection GSM is measured in gaps
constexpr double kHandoverToGsm = -15;    // dB
constexpr double kGsmGoodEnough = -95;    // dBm
constexpr double kFddQmin = -12;          // dB, for reselection from GSM
constexpr double kHandoverToUmts = -10;   // dB
constexpr std::size_t kNeighbors = 6;

}  // namespace

void Modem::step(Time now, const PhoneUser& user, bool hasMeasured) {
    if (!_isCamped) {
        if (now < kCellSelection) return;
        _isCamped = true;
        _serving = _air.gsmByLevel().front();
        rank();
    }
    follow(user.activity());
    if (_change && now >= _change->until) complete(now, *_change);
    if (!_change) followLink(now);
    _registration.step(now, {area(), _rat, _link == Link::Open, _activity});
    if (!hasMeasured) return;
    rank();
    if (_change) return;
    const std::size_t before = _serving;
    if (_rat == Rat::GSM) {
        moveWithinGsm(now);
        leaveGsm(now);
    } else {
        moveWithinUmts(now);
        leaveUmts(now);
    }
    if (_serving != before) rank();
}

const Area& Modem::area() const {
    return _rat == Rat::GSM ? _network.gsmCells[_serving].area : _network.umtsCells[_serving].area;
}

RrState Modem::rrState() const {
    if (!_isCamped) return RrState::CellSelection;
    if (_change) return _change->state;
    if (_rat == Rat::UMTS) return RrState::Inactive;
    switch (_link) {
        case Link::Opening: return RrState::ConnectionPending;
        case Link::Open: return RrState::DataTransfer;
        case Link::Closing: return RrState::ConnectionRelease;
        default: return RrState::Idle;
    }
}

RrcState Modem::rrcState() const {
    if (!isOn(Rat::UMTS)) return RrcState::Disconnected;
    switch (_link) {
        case Link::Opening: return RrcState::Connecting;
        case Link::Open: return RrcState::CellDch;
        case Link::Fach: return RrcState::CellFach;
        case Link::UraPch: return RrcState::UraPch;
        default: return RrcState::Disconnected;
    }
}

void Modem::follow(Activity activity) {
    if (activity == _activity) return;
    if (_activity != Activity::Resting) _lastActivity = _activity;
    _activity = activity;
    restartTriggers();
}

void Modem::setLink(Time now, Link link) {
    if (link == Link::Open && _rat == Rat::UMTS) _activeSet.start(_serving);
    _link = link;
    _linkSince = now;
    restartTriggers();
}

/// A condition is looked at in some states only, and not with the same limits in each: what held before a change of
/// state says nothing of the time after it.
void Modem::restartTriggers() {
    for (HeldFor* trigger :
         {&_gsmReselection, &_gsmHandover, &_umtsReselection, &_bestChange, &_toUmts, &_toGsm, &_toGsmHandover}) {
        trigger->restart();
    }
}

void Modem::followLink(Time now) {
    const bool isWanted = _activity != Activity::Resting || _registration.wantsLink();
    const Time age = now - _linkSince;
    switch (_link) {
        case Link::None:
            if (isWanted) setLink(now, Link::Opening);
            break;
        case Link::Opening:
            if (age >= kOpening) setLink(now, Link::Open);
            break;
        case Link::Open:
            if (!isWanted)
                setLink(now, _rat == Rat::UMTS && _lastActivity == Activity::Browsing ? Link::Fach : Link::Closing);
            break;
        case Link::Closing:
            if (age >= kClosing) setLink(now, Link::None);
            break;
        case Link::Fach:
        case Link::UraPch:
            if (isWanted) {
                setLink(now, Link::Open);
            } else if (age >= (_link == Link::Fach ? kFachTail : kPchTail)) {
                setLink(now, _link == Link::Fach ? Link::UraPch : Link::None);
            }
            break;
    }
}

void Modem::complete(Time now, const Change& change) {
    const bool isHandover = change.state == RrState::W2gHandover || change.state == RrState::G2wHandover ||
                            change.state == RrState::W2gCellChangeOrder;
    const bool isNewRat = change.rat != _rat;
    _rat = change.rat;
    _serving = change.sector;
    if (isNewRat) setLink(now, isHandover ? Link::Open : Link::None);
    restartTriggers();
    _change.reset();
    rank();
}

bool Modem::isHysteresisApplied() const {
    return isOn(Rat::GSM) && (_link == Link::Open || _network.gsmCells[gsmByC2()].area.lac != area().lac);
}

std::size_t Modem::gsmByC2() const {
    const auto neighbors = gsmNeighbors();
    return *std::ranges::max_element(neighbors, {}, [this](std::size_t cell) { return c2(cell); });
}

std::vector<std::size_t> Modem::gsmNeighbors() const {
    std::vector<std::size_t> neighbors;
    if (!isMeasuringGsm()) return neighbors;
    for (const std::size_t sector : _air.gsmByLevel()) {
        const bool isOwnCarrier =
            _rat == Rat::GSM && _network.gsmCells[sector].arfcn == _network.gsmCells[_serving].arfcn;
        if (!isOwnCarrier && neighbors.size() < kNeighbors) neighbors.push_back(sector);
    }
    return neighbors;
}

std::vector<std::size_t> Modem::umtsNeighbors(std::size_t count) const {
    std::vector<std::size_t> neighbors;
    for (const std::size_t sector : _air.umtsByEcNo()) {
        const bool isOwn =
            _rat == Rat::UMTS && (_link == Link::Open ? _activeSet.contains(sector) : sector == _serving);
        if (!isOwn && _air.isFound(sector) && neighbors.size() < count) neighbors.push_back(sector);
    }
    return neighbors;
}

double Modem::c1(std::size_t gsmSector) const { return _air.gsmLevel(gsmSector) - kRxLevAccessMin; }

double Modem::c2(std::size_t gsmSector) const { return c1(gsmSector) + _network.gsmCells[gsmSector].reselectOffset; }

double Modem::umtsQuality() const { return _air.ecNo(_link == Link::Open ? _activeSet.best(_air) : _serving); }

void Modem::rank() {
    const bool isUmts = _rat == Rat::UMTS;
    const double measureBelow = _link == Link::Open ? kCompressedBelow : kQqualMin + kSsearchRat;
    _isMeasuringGsm = isUmts && umtsQuality() < measureBelow;

    _rankedUmts.clear();
    if (isUmts) _rankedUmts.push_back({_serving, _air.rscp(_serving) + kQhyst});
    for (const std::size_t sector : umtsNeighbors(isUmts ? 4 : 3)) {
        _rankedUmts.push_back({sector, _air.rscp(sector) - kQoffsetUmts});
    }
    _rankedGsm.clear();
    if (!isUmts) _rankedGsm.push_back({_serving, _air.gsmLevel(_serving) + kQhyst});
    for (const std::size_t sector : gsmNeighbors()) {
        _rankedGsm.push_back({sector, _air.gsmLevel(sector) - (isUmts ? kQoffsetGsm : 0)});
    }
    std::ranges::stable_sort(_rankedUmts, std::greater(), &Ranked::rank);
    std::ranges::stable_sort(_rankedGsm, std::greater(), &Ranked::rank);
}

void Modem::moveWithinGsm(Time now) {
    if (_activity == Activity::Talking) {
        const std::size_t best = gsmNeighbors().front();  // the network's decision, on its power budget
        const bool isBetter = _air.gsmLevel(best) > _air.gsmLevel(_serving) + kHandoverMargin;
        if (_link == Link::Open && _gsmHandover(isBetter, best, now)) _serving = best;
        return;
    }
    const std::size_t best = gsmByC2();
    const double margin = isHysteresisApplied() ? kCellReselectHysteresis : 0;
    if (_gsmReselection(c2(best) > c2(_serving) + margin, best, now)) {
        _change = {Rat::GSM, best, RrState::CellReselection, now + fromSeconds(_random.between(0.2, 0.4))};
    }
}

void Modem::leaveGsm(Time now) {
    const std::size_t best = _air.umtsByEcNo().front();
    const bool isFirstSearch = !_hasSearchedUmts && _registration.registered();
    const bool isHandover = _activity == Activity::Talking;
    const bool isGood = _air.ecNo(best) > (isHandover ? kHandoverToUmts : kFddQmin);
    const bool isTime = _toUmts(isGood, 0, now) || (isFirstSearch && _air.ecNo(best) > kQqualMin);
    if (isFirstSearch) _hasSearchedUmts = true;
    if (!isTime || _registration.wantsLink() || (isHandover && _link != Link::Open)) return;
    const RrState state = isHandover ? RrState::G2wHandover : RrState::G2wReselection;
    _change = {Rat::UMTS, best, state, now + kInterRatChange};
}

void Modem::moveWithinUmts(Time now) {
    if (_link == Link::Open) {
        const std::size_t best = _activeSet.best(_air);  // of those in use already: it stays in the set
        _activeSet.update(_air, now);
        const bool isBetter = _air.ecNo(best) > _air.ecNo(_serving) + kBestHysteresis;
        if (_bestChange(isBetter, best, now) || !_activeSet.contains(_serving)) _serving = best;
        return;
    }
    const std::size_t best = _rankedUmts.front().sector;
    if (_link != Link::Opening && _umtsReselection(best != _serving, best, now)) _serving = best;
}

void Modem::leaveUmts(Time now) {
    const auto neighbors = gsmNeighbors();
    if (neighbors.empty()) {
        _toGsm.restart();
        _toGsmHandover.restart();
        return;
    }
    const std::size_t best = neighbors.front();
    if (_link == Link::Open) {
        const bool isNeeded = umtsQuality() < kHandoverToGsm && _air.gsmLevel(best) > kGsmGoodEnough;
        const RrState state = _activity == Activity::Talking ? RrState::W2gHandover : RrState::W2gCellChangeOrder;
        if (_toGsmHandover(isNeeded, 0, now)) _change = {Rat::GSM, best, state, now + kInterRatChange};
        return;
    }
    const double own = _air.rscp(_serving) + kQhyst;
    if (_toGsm(_rankedGsm.front().rank > own && c1(best) > 0, 0, now)) {
        _change = {Rat::GSM, best, RrState::W2gReselection, now + kInterRatChange};
    }
}

}  // namespace kelvo::simulation::gsm
