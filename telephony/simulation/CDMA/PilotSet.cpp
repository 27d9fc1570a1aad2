#include "telephony/simulation/CDMA/PilotSet.h"

#include <algorithm>

namespace kelvo::simulation::cdma {

void PilotSet::follow(std::size_t sector) {
    _members.assign(1, member(sector));
    _reference = sector;
    _better.restart();
}

bool PilotSet::reselect(Time now, const Reception& air) {
    const std::size_t best = air.strongest();
    const double margin = air.pilots[best] - air.pilots[_reference];
    const bool lost = margin > 0 && air.pilots[_reference] < _rules.drop;
    if (!_better(margin > kIdleMargin, best, now) && !lost) return false;
    follow(best);
    return true;
}

void PilotSet::update(Time now, const Reception& air) {
    dropWeak(now, air);
    const auto strength = [&air](const Member& member) { return air.pilots[member.sector]; };
    const Member& best = *std::ranges::max_element(_members, {}, strength);
    if (!contains(_reference) || strength(best) > air.pilots[_reference] + kReferenceMargin) _reference = best.sector;
    for (std::size_t sector = 0; sector < air.pilots.size(); ++sector) {
        if (air.pilots[sector] > _rules.add && !contains(sector)) offer(sector, air);
    }
}

std::vector<PilotReading> PilotSet::readings(const Reception& air, const Network& network) const {
    std::vector<PilotReading> readings;
    readings.reserve(_members.size());
    for (const Member& member : _members) {
        readings.push_back({network.cells[member.sector].pn, air.pilots[member.sector]});
    }
    return readings;
}

std::vector<std::size_t> PilotSet::sectors() const {
    std::vector<std::size_t> sectors;
    for (const Member& member : _members) sectors.push_back(member.sector);
    return sectors;
}

bool PilotSet::contains(std::size_t sector) const {
    return std::ranges::find(_members, sector, &Member::sector) != _members.end();
}

void PilotSet::dropWeak(Time now, const Reception& air) {
    const auto lost = [this, &air, now](Member& member) {
        return member.weak(air.pilots[member.sector] < _rules.drop, member.sector, now);
    };
    const Member last = _members.front();
    std::erase_if(_members, lost);
    if (_members.empty()) _members.push_back(last);  // the last one is held on to: the call drops or recovers
}

void PilotSet::offer(std::size_t sector, const Reception& air) {
    if (_members.size() < kMost) {
        _members.push_back(member(sector));
        return;
    }
    const auto strength = [&air](const Member& member) { return air.pilots[member.sector]; };
    Member& weakest = *std::ranges::min_element(_members, {}, strength);
    if (weakest.sector == _reference) return;
    if (air.pilots[sector] > strength(weakest) + _rules.compare) weakest = member(sector);
}

}  // namespace kelvo::simulation::cdma
