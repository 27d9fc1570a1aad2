#include "telephony/simulation/IFX/Modem.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <functional>
#include <numeric>

namespace kelvo::simulation::ifx {
namespace {

using namespace std::chrono_literals;

constexpr Time kSearch = 800ms;
constexpr Time kUpdate = 2500ms;
constexpr std::size_t kMostNeighbours = 6;
constexpr Time kMeasureNeighbour = 480ms;
constexpr Time kDecodeNeighbour = 1440ms;
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
constexpr double kHsShare = -3;       // dB of a cell's power that is left for data
constexpr double kMostHsRate = 3600;  // kbit/s

/// The strongest, `but` left out, in order.
std::vector<std::size_t> strongest(const std::vector<double>& readings, std::optional<std::size_t> but) {
    std::vector<std::size_t> order(readings.size());
    std::iota(order.begin(), order.end(), std::size_t{0});
    if (but) std::erase(order, *but);
    std::ranges::stable_sort(order, std::greater(), [&readings](std::size_t i) { return readings[i]; });
    order.resize(std::min(order.size(), kMostNeighbours));
    return order;
}

std::size_t best(const std::vector<double>& readings, std::optional<std::size_t> but = {}) {
    return strongest(readings, but).front();
}

double lost(double signalToRest, double needed) { return 0.002 + 0.5 / (1 + std::exp(signalToRest - needed)); }

}  // namespace

void Modem::measure(const Drive& drive, Time now, PhoneUser::Activity activity, double demand) {
    _air = listen(drive, _network, _random);
    choose(now);
    registerInArea(now);
    readServing();
    readGsmNeighbours(now);
    readUmtsNeighbours();
    connect(activity, demand);
}

LocationArea Modem::area() const {
    if (_status.access == RadioAccess::None) return {};
    return _status.access == RadioAccess::Gsm ? _network.gsm[_status.serving].area
                                              : _network.umts[_status.serving].area;
}

std::optional<std::size_t> Modem::servingOn(RadioAccess access) const {
    return _status.access == access ? std::optional(_status.serving) : std::nullopt;
}

void Modem::choose(Time now) {
    switch (_status.access) {
        case RadioAccess::None:
            if (now >= kSearch) move(RadioAccess::Gsm, best(_air.rssi), now);
            return;
        case RadioAccess::Gsm: return chooseFromGsm(now);
        case RadioAccess::Umts: return chooseFromUmts(now);
    }
}

void Modem::chooseFromGsm(Time now) {
    const bool idle = _status.connection == Connection::Idle;
    const std::size_t umts = best(_air.ecN0);
    const bool good = _air.ecN0[umts] > kUmtsGood && _air.rscp[umts] > kUmtsClose;
    if (_toUmts(idle && good, umts, now)) return move(RadioAccess::Umts, umts, now);

    const std::size_t other = best(_air.rssi, _status.serving);
    const double better = _air.rssi[other] - _air.rssi[_status.serving];
    const bool reselect = _gsmReselection(idle && better > gsmMargin(other, now), other, now);
    const bool handOver = _gsmHandover(!idle && better > kHandoverMargin, other, now);
    if (reselect || handOver) move(RadioAccess::Gsm, other, now);
}

void Modem::chooseFromUmts(Time now) {
    const std::size_t gsm = best(_air.rssi);
    const bool poor = _air.ecN0[_status.serving] < kUmtsPoor || _air.rscp[_status.serving] < kUmtsFar;
    const std::size_t other = best(_air.ecN0, _status.serving);
    const bool better = _air.ecN0[other] > _air.ecN0[_status.serving] + kUmtsHysteresis;
    if (_umtsChange(better, other, now)) return move(RadioAccess::Umts, other, now);
    if (_toGsm(poor, 0, now)) move(RadioAccess::Gsm, gsm, now);
}

double Modem::gsmMargin(std::size_t candidate, Time now) const {
    const double area = _network.gsm[candidate].area == _network.gsm[_status.serving].area ? 0 : kAreaHysteresis;
    return std::max(area, now - _movedAt < kRecently ? kRecentMargin : 0);
}

void Modem::move(RadioAccess access, std::size_t sector, Time now) {
    _status.access = access;
    _status.serving = sector;
    _movedAt = now;
    for (HeldFor* held : {&_gsmReselection, &_gsmHandover, &_umtsChange, &_toGsm, &_toUmts}) held->restart();
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
    _updatedAt = now + kUpdate;
}

void Modem::readServing() {
    _status.rssi = _air.rssi[_status.serving];
    _status.rscp = _air.rscp[_status.serving];
    _status.ecN0 = _air.ecN0[_status.serving];
}

void Modem::readGsmNeighbours(Time now) {
    _status.gsm.clear();
    if (_status.access == RadioAccess::None) return;
    std::map<std::size_t, Time> listed;
    for (const std::size_t sector : strongest(_air.rssi, servingOn(RadioAccess::Gsm))) {
        const auto before = _listed.find(sector);
        const Time since = before != _listed.end() ? before->second : now;
        listed[sector] = since;
        _status.gsm.push_back(
            {sector, _air.rssi[sector], now - since >= kMeasureNeighbour, now - since >= kDecodeNeighbour});
    }
    _listed = std::move(listed);
}

void Modem::readUmtsNeighbours() {
    _status.umts.clear();
    if (_status.access == RadioAccess::None) return;
    for (const std::size_t sector : strongest(_air.ecN0, servingOn(RadioAccess::Umts))) {
        if (_air.ecN0[sector] < kDetected) break;
        _status.umts.push_back({sector, _air.rscp[sector], _air.ecN0[sector]});
    }
}

void Modem::connect(PhoneUser::Activity activity, double demand) {
    const bool served = _status.registration == Registration::Registered || _status.connection == Connection::Call;
    _status.connection = Connection::Idle;
    if (!served || activity == PhoneUser::Activity::Resting) return;
    _status.connection = activity == PhoneUser::Activity::Talking ? Connection::Call : Connection::Packet;
    if (_status.access == RadioAccess::Gsm) {
        connectOnGsm(demand);
    } else {
        connectOnUmts(demand);
    }
}

void Modem::connectOnGsm(double demand) {
    const double ratio = _air.gsmToRest[_status.serving];
    // The base station wants -85 dBm.
    _status.tx = std::clamp(Network::kPower - _status.rssi - 85, 5.0, 33.0);
    const double rate = capacity(kSlotKHz, ratio);
    const auto scheme = std::ranges::upper_bound(kEgprsRates, rate) - kEgprsRates.begin();
    _status.codingScheme = static_cast<int>(std::max<std::ptrdiff_t>(scheme, 1));
    const bool call = _status.connection == Connection::Call;
    _status.errors = call ? lost(ratio, 6) : _random.between(0.02, 0.12);
    const double offered = kEgprsRates[static_cast<std::size_t>(_status.codingScheme - 1)] * kTimeSlots;
    _status.throughput = call ? 0 : offered * demand * (1 - _status.errors);
}

void Modem::connectOnUmts(double demand) {
    const double loss = Network::kPower - 10 - _status.rscp;  // of the common pilot, a tenth of the power
    _status.tx = std::clamp(loss - 108, -50.0, 24.0);
    const double ratio = _status.ecN0 + 10 + kHsShare;
    const bool call = _status.connection == Connection::Call;
    _status.errors = call ? lost(_status.ecN0, -17) : _random.between(0.05, 0.15);
    const double offered = std::min(capacity(3840, ratio), kMostHsRate);
    _status.throughput = call ? 0 : offered * demand * (1 - _status.errors);
}

}  // namespace kelvo::simulation::ifx
