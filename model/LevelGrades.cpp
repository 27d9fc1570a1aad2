#include "model/LevelGrades.h"

#include <algorithm>
#include <array>

namespace kelvo {

namespace {

using Grades = std::array<LevelGrade, 4>;

// clang-format off
constexpr Grades kRsrp       = {{ {"excellent", -80}, {"good",  -90}, {"fair", -100}, {"poor"} }};  // dBm
constexpr Grades kRsrq       = {{ {"excellent", -10}, {"good",  -15}, {"fair",  -20}, {"poor"} }};  // dB
constexpr Grades kEcIo       = {{ {"excellent",  -6}, {"good",  -10}, {"fair",  -14}, {"poor"} }};  // dB
constexpr Grades kRxLev      = {{ {"excellent", -70}, {"good",  -85}, {"fair", -100}, {"poor"} }};  // dBm
constexpr Grades kRxLevIndex = {{ {"excellent",  40}, {"good",   25}, {"fair",   10}, {"poor"} }};  // 0 is -110 dBm, 3GPP TS 45.008
// clang-format on

/// The last component of a path; `path` keeps the rest.
std::string_view takeLast(std::string_view& path) {
    const std::size_t slash = path.rfind('/');
    const std::string_view last = path.substr(slash + 1);
    path = path.substr(0, slash == path.npos ? 0 : slash);
    return last;
}

bool has(std::string_view text, std::string_view part) { return text.find(part) != text.npos; }

bool isNumber(std::string_view text) {
    return !text.empty() && std::ranges::all_of(text, [](char c) { return c >= '0' && c <= '9'; });
}

}  // namespace

std::span<const LevelGrade> gradesOf(Graded what) {
    switch (what) {
        case Graded::Rsrp: return kRsrp;
        case Graded::Rsrq: return kRsrq;
        case Graded::EcIo: return kEcIo;
        case Graded::RxLev: break;
    }
    return kRxLev;
}

std::span<const LevelGrade> gradesOf(std::string_view trendName, std::string_view unit) {
    std::string_view path = trendName;
    const std::string_view key = takeLast(path);
    if (unit == "dBm" && has(key, "RSRP")) return kRsrp;
    if (unit == "dB" && has(key, "RSRQ")) return kRsrq;
    if (unit == "dB" && (key == "Energy Per Chip" || key == "ECN0")) return kEcIo;
    if (unit == "dB" && isNumber(key) && path.ends_with("/Active Set")) return kEcIo;  // a pilot by its PN offset
    // The serving cell's record has the index, whatever the screen calls it; so have its neighbors'.
    if (key == "Serving Rx Level") return kRxLevIndex;
    if (key != "RSSI") return {};
    if (path.ends_with("/GSM Serving Cell") || has(path, "/Neighboring Cells/")) return kRxLevIndex;
    const bool isCellMonitors = path == "/Serving" || has(path, "/Neighbours/GSM/");
    if (unit == "dBm" && (isCellMonitors || has(path, "GSM Set/"))) return kRxLev;
    return {};
}

std::string_view gradeOf(std::span<const LevelGrade> grades, double number) {
    for (const LevelGrade& grade : grades) {
        if (number >= grade.floor) return grade.name;
    }
    return {};
}

}  // namespace kelvo
