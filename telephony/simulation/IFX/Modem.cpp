#include "telephony/simulation/IFX/Modem.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <functional>
#include <set>

namespace kelvo::simulation::ifx {
namespace {

using namespace std::chrono_literals;

constexpr Time kSearch = 800ms;
constexpr std::size_t kMostNeighbors = 6;
constexpr Time kMeasureNeighbor = 480ms;
constexpr Time kDecodeNeighbor = 1440ms;
constexpr double kDetected = -20;  // dB of Ec/N0

// GSM: 3GPP TS 45.008, sections 6.6.2 (reselection) and A.3.1 (handover by power budget).
constexpr double kAreaHysteresis = 6;  // CELL_RESELECT_HYSTERESIS
constexpr double kRecentMargin = 5;
constexpr Time kRecently = 15s;
constexpr double kHandoverMargin = 4;
// To UMTS, section 6.6.5: FDD_Qmin and FDD_RSCP_threshold. From it, TS 25.304, section 5.2.6: Ssearch,RAT.
constexpr double kUmtsGood = -11;   // dB of Ec/N0
constexpr double kUmtsClose = -98;  // dBm of RSCP
constexpr double kUmtsPoor = -14.5;
constexpr double kUmtsFar = -104;
// UMTS: Qhyst of TS 25.304, the hysteresis of event 1D of TS 25.331 when connected.
constexpr double kUmtsHysteresis = 3;

constexpr std::array kEgprsRates{8.8, 11.2, 14.8, 17.6, 22.4, 29.6, 44.8, 54.4, 59.2};  // kbit/s a time slot
constexpr double kTimeSlots = 4;
constexpr double kSlotKHz = 9;        // of a time slot, as far as its modulation goes
constexpr double kSchemeMargin = 3;   // dB: a scheme is taken with this much more than it needs
constexpr double kAimedErrors = 0.1;  // of the blocks
constexpr double kUmtsNeeded = -17;   // dB of Ec/N0
constexpr double kHsShare = -3;       // dB of a cell's power that is left for data
constexpr double kMostHsRate = 3600;  // kbit/s

const std::vector<std::size_t> kNone;

/// Those of the cells that meet a condition, in their order.
std::vector<std::size_t> those(std::vector<std::size_t> cells, const std::function<bool(std::size_t)>& condition) {
    std::erase_if(cells, std::not_fn(condition));
    return cells;
}

double lost(double sinr, double needed) { return 0.002 + 0.5 / (1 + std::exp(sinr - needed)); }

/// Blocks of data lost when first sent: those that the choice of a scheme puts up with, and what more the scheme loses.
double lostAtFirst(double sinr, double needed) { return kAimedErrors + (1 - kAimedErrors) * lost(sinr, needed); }

}  // namespace

void Modem::step(Time now, const PhoneUser& user) {
    choose(now);
    registerInArea(now);
    readServing();
    readGsmNeighbors(now);
    readUmtsNeighbors();
    connect(user);
}

void Modem::markReported() {
    _reported.clear();
    for (const UmtsNeighbor& neighbor : _status.umts) _reported.insert(neighbor.sector);
}

Area Modem::area() const {
    if (_status.access == RadioAccess::None) return {};
    return _status.access == RadioAccess::Gsm ? _network.gsmCells[_status.serving].area
                                              : _network.umtsCells[_status.serving].area;
}

/// Of the cells on one carrier no more than the strongest can be decoded, and on the serving cell's carrier no other.
std::vector<std::size_t> Modem::gsmByStrength() const {
    std::set<int> heard;
    if (_status.access == RadioAccess::Gsm) heard.insert(_network.gsmCells[_status.serving].arfcn);
    std::vector<std::size_t> order = byStrength(_air.rssi());
    std::erase_if(order, [&](std::size_t sector) { return !heard.insert(_network.gsmCells[sector].arfcn).second; });
    order.resize(std::min(order.size(), kMostNeighbors));
    return order;
}

std::vector<std::size_t> Modem::umtsByStrength() const {
    std::vector<std::size_t> order = byStrength(_air.ecN0());
    if (_status.access == RadioAccess::Umts) std::erase(order, _status.serving);
    order.resize(std::min(order.size(), kMostNeighbors));
    return order;
}

void Modem::choose(Time now) {
    switch (_status.access) {
        case RadioAccess::None:
            if (now >= kSearch) move(RadioAccess::Gsm, gsmByStrength().front(), now);
            return;
        case RadioAccess::Gsm: return chooseFromGsm(now);
        case RadioAccess::Umts: return chooseFromUmts(now);
    }
}

void Modem::chooseFromGsm(Time now) {
    const bool idle = _status.connection == Connection::Idle;
    const auto good = [this](std::size_t cell) {
        return _air.ecN0()[cell] > kUmtsGood && _air.rscp()[cell] > kUmtsClose;
    };
    const auto better = [this](std::size_t cell) { return _air.rssi()[cell] - _air.rssi()[_status.serving]; };
    const auto reselected = [&](std::size_t cell) { return better(cell) > gsmMargin(cell, now); };
    const auto handedOver = [&](std::size_t cell) { return better(cell) > kHandoverMargin; };
    const auto umts = _toUmts(idle ? those(umtsByStrength(), good) : kNone, now);
    const auto reselection = _gsmReselection(idle ? those(gsmByStrength(), reselected) : kNone, now);
    const auto handover = _gsmHandover(idle ? kNone : those(gsmByStrength(), handedOver), now);
    if (umts) return move(RadioAccess::Umts, *umts, now);
    if (const auto other = idle ? reselection : handover) move(RadioAccess::Gsm, *other, now);
}

void Modem::chooseFromUmts(Time now) {
    const double own = _air.ecN0()[_status.serving];
    const auto better = [&](std::size_t cell) { return _air.ecN0()[cell] > own + kUmtsHysteresis; };
    const bool poor = own < kUmtsPoor || _air.rscp()[_status.serving] < kUmtsFar;
    const auto other = _umtsChange(those(umtsByStrength(), better), now);
    const bool leaves = _toGsm(poor, 0, now);
    if (other && _reported.contains(*other)) return move(RadioAccess::Umts, *other, now);
    const auto known = std::ranges::find_if(_status.gsm, &GsmNeighbor::identified);  // the strongest of them
    if (leaves && known != _status.gsm.end()) move(RadioAccess::Gsm, known->sector, now);
}

double Modem::gsmMargin(std::size_t candidate, Time now) const {
    const double area =
        _network.gsmCells[candidate].area == _network.gsmCells[_status.serving].area ? 0 : kAreaHysteresis;
    return std::max(area, now - _movedAt < kRecently ? kRecentMargin : 0);
}

void Modem::move(RadioAccess access, std::size_t sector, Time now) {
    _status.access = access;
    _status.serving = sector;
    _movedAt = now;
    for (EachHeldFor* held : {&_gsmReselection, &_gsmHandover, &_umtsChange, &_toUmts}) held->restart();
    _toGsm.restart();
}

/// An update of the area takes a while, and waits for the end of a call.
void Modem::registerInArea(Time now) {
    if (_status.access == RadioAccess::None) return;
    if (_status.registration == Registration::Updating && now >= _updatedAt) {
        _status.registration = Registration::Registered;
        _status.registered = area();
    }
    const bool elsewhere = _status.registered != area();
    if (!elsewhere || _status.connection == Connection::Call || _status.registration == Registration::Updating) return;
    _status.registration = Registration::Updating;
    _updatedAt = now + fromSeconds(_random.between(2.0, 3.0));
}

void Modem::readServing() {
    _status.rssi = _air.rssi()[_status.serving];
    _status.carrierToInterference = _air.carrierToInterference()[_status.serving];
    _status.rscp = _air.rscp()[_status.serving];
    _status.ecN0 = _air.ecN0()[_status.serving];
}

void Modem::readGsmNeighbors(Time now) {
    _status.gsm.clear();
    if (_status.access == RadioAccess::None) return;
    std::map<std::size_t, Time> listed;
    for (const std::size_t sector : gsmByStrength()) {
        const auto before = _listed.find(sector);
        const Time since = before != _listed.end() ? before->second : now;
        listed[sector] = since;
        _status.gsm.push_back(
            {sector, _air.rssi()[sector], now - since >= kMeasureNeighbor, now - since >= kDecodeNeighbor});
    }
    _listed = std::move(listed);
}

void Modem::readUmtsNeighbors() {
    _status.umts.clear();
    if (_status.access == RadioAccess::None) return;
    for (const std::size_t sector : umtsByStrength()) {
        if (_air.ecN0()[sector] < kDetected) break;
        _status.umts.push_back({sector, _air.rscp()[sector], _air.ecN0()[sector]});
    }
}

void Modem::connect(const PhoneUser& user) {
    const bool served = _status.registration == Registration::Registered || _status.connection == Connection::Call;
    _status.connection = Connection::Idle;
    if (!served || user.isResting()) return;
    _status.connection = user.isTalking() ? Connection::Call : Connection::Packet;
    if (_status.access == RadioAccess::Gsm) {
        connectOnGsm(user.demand());
    } else {
        connectOnUmts(user.demand());
    }
}

void Modem::connectOnGsm(double demand) {
    const double ratio = _status.carrierToInterference;
    // The base station wants -85 dBm.
    _status.tx = std::clamp(Network::kPower - _status.rssi - 85, 5.0, 33.0);
    const double rate = linkCapacity(kSlotKHz, ratio);
    const auto scheme = std::ranges::upper_bound(kEgprsRates, rate) - kEgprsRates.begin();
    _status.codingScheme = static_cast<int>(std::max<std::ptrdiff_t>(scheme, 1));
    const double offered = kEgprsRates[static_cast<std::size_t>(_status.codingScheme - 1)];
    const bool call = _status.connection == Connection::Call;
    _status.errors = call ? lost(ratio, 6) : lostAtFirst(ratio, neededSinr(kSlotKHz, offered) - kSchemeMargin);
    _status.throughput = call ? 0 : offered * kTimeSlots * demand * (1 - _status.errors);
}

void Modem::connectOnUmts(double demand) {
    const double pathLoss = Network::kPower - 10 - _status.rscp;  // of the common pilot, a tenth of the power
    _status.tx = std::clamp(pathLoss - 108, -50.0, 24.0);
    const double sinr = _status.ecN0 + 10 + kHsShare;
    const bool call = _status.connection == Connection::Call;
    _status.errors = call ? lost(_status.ecN0, kUmtsNeeded) : lostAtFirst(_status.ecN0, kUmtsNeeded);
    const double offered = std::min(linkCapacity(3840, sinr), kMostHsRate);
    _status.throughput = call ? 0 : offered * demand * (1 - _status.errors);
}

}  // namespace kelvo::simulation::ifx
