#include "telephony/simulation/GSMUMTS/ActiveSet.h"

#include <algorithm>

namespace kelvo::simulation::gsm {

void ActiveSet::start(std::size_t sector) {
    _members.assign(1, sector);
    for (HeldFor* trigger : {&_add, &_drop, &_replace}) trigger->restart();
}

bool ActiveSet::contains(std::size_t sector) const { return std::ranges::find(_members, sector) != _members.end(); }

std::size_t ActiveSet::best(const Air& air) const {
    return *std::ranges::max_element(_members, {}, [&](std::size_t sector) { return air.ecNo(sector); });
}

std::size_t ActiveSet::worst(const Air& air) const {
    return *std::ranges::min_element(_members, {}, [&](std::size_t sector) { return air.ecNo(sector); });
}

std::size_t ActiveSet::bestOther(const Air& air) const {
    const auto& order = air.umtsByEcNo();
    return *std::ranges::find_if(order, [&](std::size_t sector) { return !contains(sector); });
}

void ActiveSet::update(const Air& air, Time now) {
    const double top = air.ecNo(best(air));
    const std::size_t weak = worst(air);
    if (_drop(_members.size() > 1 && air.ecNo(weak) < top - kDropWindow, weak, now)) std::erase(_members, weak);

    const std::size_t other = bestOther(air);
    const bool isFull = _members.size() == kLargest;
    const bool isClose = air.isFound(other) && air.ecNo(other) > top - kAddWindow;
    if (_add(!isFull && isClose, other, now)) _members.push_back(other);
    const bool isBetter = air.ecNo(other) > air.ecNo(worst(air)) + kReplaceBy;
    if (_replace(isFull && isBetter, other, now)) std::ranges::replace(_members, worst(air), other);
}

}  // namespace kelvo::simulation::gsm
