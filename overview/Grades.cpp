#include "overview/Grades.h"

#include <array>

namespace kelvo::overview {
namespace {

constexpr std::array<std::string_view, 4> kNames = {"excellent", "good", "fair", "weak"};

struct Steps {
    Graded what;
    std::array<double, 4> from;  ///< the lowest number of each name, best first
};

// clang-format off
constexpr Steps kSteps[] = {
    //                 excellent  good  fair  weak
    { Graded::Rsrp,    {  -80,    -90,  -100, -110 } },
    { Graded::Rsrq,    {   -9,    -12,   -15,  -18 } },
    { Graded::Rscp,    {  -75,    -85,   -95, -105 } },
    { Graded::EcIo,    {   -6,     -9,   -12,  -15 } },
    { Graded::RxLevel, {  -70,    -80,   -90, -100 } },
};
// clang-format on

}  // namespace

std::string_view gradeOf(Graded what, double number) {
    for (const Steps& steps : kSteps) {
        if (steps.what != what) continue;
        for (std::size_t i = 0; i < kNames.size(); ++i) {
            if (number >= steps.from[i]) return kNames[i];
        }
    }
    return "very weak";
}

}  // namespace kelvo::overview
