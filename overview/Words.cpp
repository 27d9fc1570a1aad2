#include "overview/Words.h"

#include <fmt/format.h>

#include <algorithm>
#include <cmath>

namespace kelvo::overview {

std::string ageText(Time then, Time now) {
    const auto age = std::max(now - then, Time::duration::zero());
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(age).count();
    if (seconds < 120) return fmt::format("{} s ago", seconds);
    if (seconds < 7200) return fmt::format("{} min ago", seconds / 60);
    return seconds < 172800 ? fmt::format("{} h ago", seconds / 3600) : fmt::format("{} days ago", seconds / 86400);
}

std::string differenceText(const std::optional<Measure>& level, const std::optional<Measure>& serving) {
    if (!level || !serving || level->name != serving->name) return {};
    const double difference = level->figure.number - serving->figure.number;
    const bool isNothing = std::abs(difference) < 0.005;  // which would print as "-0.00" half of the time
    return fmt::format("{:+.2f}{}", isNothing ? 0.0 : difference, level->figure.unit.empty() ? "" : " dB");
}

std::string changeText(const std::string& from, const std::string& to, std::string_view arrow) {
    return from.empty() || to.empty() ? from + to : fmt::format("{} {} {}", from, arrow, to);
}

}  // namespace kelvo::overview
