#include "tools/report/Distribution.h"

#include <cmath>

namespace kelvo::report {

void Distribution::add(double value) {
    if (!std::isfinite(value)) return;
    ++_counts[value];
    ++_count;
}

double Distribution::percentile(double share) const {
    if (_count == 0) return 0;
    const double place = share * static_cast<double>(_count - 1);
    const auto below = static_cast<std::uint64_t>(place);
    std::uint64_t passed = 0;
    for (auto it = _counts.begin(); it != _counts.end(); ++it) {
        passed += it->second;
        if (passed <= below) continue;
        const auto next = std::next(it);
        if (passed > below + 1 || next == _counts.end()) return it->first;
        return it->first + (next->first - it->first) * (place - static_cast<double>(below));
    }
    return _counts.rbegin()->first;
}

std::uint64_t Distribution::countFrom(double floor) const {
    std::uint64_t count = 0;
    for (auto it = _counts.lower_bound(floor); it != _counts.end(); ++it) count += it->second;
    return count;
}

}  // namespace kelvo::report
