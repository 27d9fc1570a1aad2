#pragma once

namespace kelvo {

/// One, two or five times a power of ten, the smallest of which no more than `most` lie within `range`; both are
/// positive.
double axisStep(double range, int most);

/// An axis on which `least` and `most` have their place: it begins and ends on a step, and has two steps or more.
struct AxisRange {
    double low;
    double high;
    double step;
};
AxisRange axisFor(double least, double most, int mostSteps);

}  // namespace kelvo
