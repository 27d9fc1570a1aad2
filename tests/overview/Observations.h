#pragma once

#include <string>
#include <vector>

#include "overview/Tracker.h"

// What a tracker is told in its tests: observations made by hand.
namespace kelvo::overview {

inline constexpr Time kStart{std::chrono::sys_days(std::chrono::year(2026) / 11 / 22)};

inline Measure rsrp(const char* text, double number, std::uint64_t record) {
    return {"RSRP", {text, number, "dBm", record}, ""};
}

inline Observation servedBy(const char* cell, std::uint64_t record, const char* level = "-90.00 dBm") {
    Observation seen;
    seen.access = "LTE";
    seen.cell = cell;
    seen.cellRecord = record;
    seen.level = rsrp(level, -90, record);
    return seen;
}

inline HeardCell heard(const char* identity, double level, std::uint64_t record) {
    HeardCell cell;
    cell.identity = identity;
    cell.level = rsrp("", level, record);
    cell.record = record;
    return cell;
}

inline std::vector<std::string> identities(const Tracker& tracker) {
    std::vector<std::string> all;
    for (const TrackedCell& cell : tracker.cells()) all.push_back(cell.heard.identity);
    return all;
}

}  // namespace kelvo::overview
