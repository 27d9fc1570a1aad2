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
    return static_cast<std::uint64_t>(
        std::ranges::count_if(events, [&](const DriveEvent& event) { return event.event.kind == kind; }));
}

}  // namespace kelvo::report
