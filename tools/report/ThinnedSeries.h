#pragma once

#include <vector>

#include "tools/report/RecordedTime.h"

namespace kelvo::report {

/// One step of a series: a reading, or several put together.
struct Point {
    Elapsed at;  ///< in the middle between the first and the last of them
    double low;
    double mean;
    double high;
    bool begins = false;  ///< no line leads here: what was measured was interrupted
};

/// A value over time in bounded memory: of each step the smallest and the largest reading and their mean. The steps are
/// as narrow as two thousand of them allow.
class ThinnedSeries {
public:
    static constexpr std::size_t kMostSteps = 2048;

    /// `at` does not go back. What is no finite number is left out.
    void add(Elapsed at, double value);
    /// No line leads from the last reading to the next one.
    void interrupt() { _begins = true; }

    bool isEmpty() const { return _steps.empty(); }
    /// Ordered by time.
    std::vector<Point> points() const { return pointsOf(_steps); }
    /// The same in steps at least that wide.
    std::vector<Point> points(Elapsed width) const;
    /// How wide a step is; readings of the same microsecond are one step from the start.
    Elapsed width() const { return _width; }

private:
    struct Step {
        std::int64_t index;
        Elapsed first;
        Elapsed last;
        double low;
        double high;
        double mean;
        double count;
        bool begins;
    };
    static void merge(std::vector<Step>& steps, const Step& step);
    static std::vector<Point> pointsOf(const std::vector<Step>& steps);
    void widen();

    std::vector<Step> _steps;
    Elapsed _width{1};
    bool _begins = false;
};

}  // namespace kelvo::report
