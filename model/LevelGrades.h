#pragma once

#include <limits>
#include <span>
#include <string_view>

namespace kelvo {

/// One grade of a level, from `floor` up to the floor of the grade before it.
struct LevelGrade {
    std::string_view name;
    double floor = -std::numeric_limits<double>::infinity();
};

/// What is graded.
enum class Graded {
    Rsrp,   ///< dBm
    Rsrq,   ///< dB
    EcIo,   ///< dB
    RxLev,  ///< dBm
};

/// The grades, best first, that are widely accepted; no standard sets them.
std::span<const LevelGrade> gradesOf(Graded what);

/// The same for the level whose trend has that name and unit; none for every other value.
std::span<const LevelGrade> gradesOf(std::string_view trendName, std::string_view unit);

/// The grade of `number`; empty without grades.
std::string_view gradeOf(std::span<const LevelGrade> grades, double number);

}  // namespace kelvo
