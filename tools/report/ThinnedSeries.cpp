#include "tools/report/ThinnedSeries.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace kelvo::report {

void ThinnedSeries::add(Elapsed at, double value) {
    if (!std::isfinite(value)) return;
    const Step step{at / _width, at, at, value, value, value, 1, std::exchange(_begins, false)};
    if (step.begins) {
        _steps.push_back(step);
    } else {
        merge(_steps, step);
    }
    while (_steps.size() > kMostSteps) widen();
}

/// Appends a step, or adds it to the last one when it is the same.
void ThinnedSeries::merge(std::vector<Step>& steps, const Step& step) {
    if (steps.empty() || steps.back().index != step.index) {
        steps.push_back(step);
        return;
    }
    Step& last = steps.back();
    last.last = step.last;
    last.low = std::min(last.low, step.low);
    last.high = std::max(last.high, step.high);
    last.count += step.count;
    last.mean += (step.mean - last.mean) * (step.count / last.count);
}

void ThinnedSeries::widen() {
    _width *= 2;
    std::vector<Step> wider;
    for (Step step : _steps) {
        step.index /= 2;
        merge(wider, step);
    }
    _steps = std::move(wider);
}

std::vector<Point> ThinnedSeries::points(Elapsed width) const {
    if (width <= _width) return points();
    std::vector<Step> wider;
    for (Step step : _steps) {
        step.index = step.first / width;
        merge(wider, step);
    }
    return pointsOf(wider);
}

std::vector<Point> ThinnedSeries::pointsOf(const std::vector<Step>& steps) {
    std::vector<Point> points;
    points.reserve(steps.size());
    for (const Step& step : steps) {
        points.push_back({step.first + (step.last - step.first) / 2, step.low, step.mean, step.high, step.begins});
    }
    return points;
}

}  // namespace kelvo::report
