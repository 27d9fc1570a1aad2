#include "ui/TrendCandidates.h"

#include <algorithm>
#include <array>
#include <tuple>

namespace kelvo {

namespace {

/// The quantity that a key tells of, whatever else it says ("Serving Filtered RSRP").
std::string_view quantityOf(std::string_view key) {
    constexpr std::array<std::string_view, 6> kQuantities = {"RSRP", "RSRQ", "RSCP", "RSSI", "Energy Per Chip", "SIR"};
    for (const std::string_view quantity : kQuantities) {
        if (key.find(quantity) != key.npos) return quantity;
    }
    return {};
}

struct Candidate {
    std::string name;
    int rank;
    bool isOld;
    double level;  ///< the last reading; of neighbors the best comes first
};

bool isOfRow(const Trends& trends, const std::string& name) { return trends.pathOf(name) != name; }

}  // namespace

std::string_view keyOfTrend(std::string_view name) { return name.substr(name.rfind('/') + 1); }

std::string placeOfTrend(std::string_view name) {
    std::string place;
    std::string_view rest = name.substr(0, name.rfind('/'));
    while (!rest.empty()) {
        rest.remove_prefix(1);
        const std::size_t slash = std::min(rest.find('/'), rest.size());
        if (!place.empty()) place += " › ";
        place += rest.substr(0, slash);
        rest.remove_prefix(slash);
    }
    return place;
}

std::vector<std::string> trendCandidates(const Trends& trends, std::string_view name) {
    const std::string self(name);
    const std::string_view quantity = quantityOf(keyOfTrend(name));
    const Trend trend = trends.trend(name);
    const bool ofRow = isOfRow(trends, self);
    const Trend::Time recent = trend.points.empty() ? Trend::Time{0} : trend.points.back().at - 3 * Trend::kGap;

    std::vector<Candidate> candidates;
    for (std::string& other : trends.names()) {
        const Trend its = trends.trend(other);
        if (other == self || its.points.empty()) continue;
        const bool sameQuantity = !quantity.empty() && quantityOf(keyOfTrend(other)) == quantity;
        const bool sameUnit = its.unit == trend.unit;
        const bool opposite = isOfRow(trends, other) != ofRow;
        const int rank = sameQuantity && sameUnit ? (opposite ? 0 : 1) : sameUnit ? 2 : 3;
        candidates.push_back({std::move(other), rank, its.points.back().at < recent, its.points.back().number});
    }
    std::ranges::stable_sort(candidates, [](const Candidate& a, const Candidate& b) {
        const double aLevel = a.rank == 0 ? -a.level : 0;
        const double bLevel = b.rank == 0 ? -b.level : 0;
        return std::tie(a.rank, a.isOld, aLevel) < std::tie(b.rank, b.isOld, bLevel);
    });
    std::vector<std::string> names;
    names.reserve(candidates.size());
    for (Candidate& candidate : candidates) names.push_back(std::move(candidate.name));
    return names;
}

}  // namespace kelvo
