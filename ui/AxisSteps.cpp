#include "ui/AxisSteps.h"

#include <algorithm>
#include <cmath>

namespace kelvo {

double axisStep(double range, int most) {
    const double finest = range / most;
    const double ten = std::pow(10, std::floor(std::log10(finest)));
    for (const double times : {1.0, 2.0, 5.0}) {
        if (times * ten >= finest * (1 - 1e-9)) return times * ten;
    }
    return 10 * ten;
}

AxisRange axisFor(double least, double most, int mostSteps) {
    // A level that stands still keeps its place in the middle of an axis that is not all noise; of parts of a whole,
    // such as the 256ths of UTRAN's RSCP, a tenth is much.
    const bool arePartsOfOne = std::max(std::abs(least), std::abs(most)) < 1 && (least != 0 || most != 0);
    const double shortest = arePartsOfOne ? 0.1 : std::max(1.0, std::abs(most) * 1e-6);
    const double range = std::max(most - least, shortest);
    const double step = axisStep(range, std::max(2, mostSteps - 1));
    double low = std::floor(least / step) * step;
    double high = std::ceil(most / step) * step;
    while (high - low < 1.5 * step) {
        high += step;
        if (high - low < 1.5 * step) low -= step;
    }
    return {low, high, step};
}

}  // namespace kelvo
