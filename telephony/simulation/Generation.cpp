#include "telephony/simulation/Generation.h"

#include <fmt/format.h>

#include <algorithm>
#include <array>

namespace kelvo::simulation {
namespace {

constexpr std::array<std::string_view, 3> kYears = {"2010", "2014", "2018"};

}  // namespace

Result<Generation> generationOf(Technology technology, std::string_view year) {
    const auto found = std::ranges::find(kYears, year);
    if (found == kYears.end()) return Failure{fmt::format("{} is none of 2010, 2014, 2018", year)};
    if (technology != Technology::LTE && technology != Technology::GSM) {
        return Failure{fmt::format("{} records have one layout, whatever the year: only lte and gsm have generations",
                                   namesOf(technology).name)};
    }
    return static_cast<Generation>(found - kYears.begin());
}

std::string_view yearOf(Generation generation) { return kYears[static_cast<std::size_t>(generation)]; }

}  // namespace kelvo::simulation
