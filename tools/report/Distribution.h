#pragma once

#include <cstdint>
#include <map>

namespace kelvo::report {

/// Every reading of a value, counted: exact however many there are, for modems report in steps.
class Distribution {
public:
    /// What is no finite number is left out.
    void add(double value);

    std::uint64_t count() const { return _count; }
    bool isEmpty() const { return _count == 0; }
    /// Where `share`, 0 to 1, of the readings lie below; between two readings on the straight line that joins them, as
    /// spreadsheets count it. 0 of no readings.
    double percentile(double share) const;
    double minimum() const { return percentile(0); }
    double median() const { return percentile(0.5); }
    double maximum() const { return percentile(1); }
    /// How many readings are at least that.
    std::uint64_t countFrom(double floor) const;

private:
    std::map<double, std::uint64_t> _counts;
    std::uint64_t _count = 0;
};

}  // namespace kelvo::report
