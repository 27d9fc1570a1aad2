#include "tools/report/Drive.h"

#include <algorithm>

namespace kelvo::report {

CellFigures* CellTable::at(const std::string& identity) {
    if (const auto known = cells.find(identity); known != cells.end()) return &known->second;
    if (cells.size() < kMost) return &cells[identity];
    ++beyond;
    return nullptr;
}

const Lane* Drive::lane(std::string_view name) const {
    const auto found = std::ranges::find(lanes, name, &NamedLane::name);
    return found == lanes.end() ? nullptr : &found->lane;
}

std::uint64_t Drive::count(overview::Event::Kind kind) const {
    const auto known = counts.find(kind);
    return known == counts.end() ? 0 : known->second;
}

std::uint64_t Drive::eventCount() const {
    std::uint64_t all = 0;
    for (const auto& [kind, count] : counts) all += count;
    return all;
}

}  // namespace kelvo::report
