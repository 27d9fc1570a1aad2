#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "platform/values/Reading.h"

namespace kelvo {

/// The readings of one value at the refreshes of the last while, packed: each refresh has a number that grows by one,
/// and a reading that a record has written since the refresh before is kept as its raw number's difference from the one
/// before, mostly one byte. Refreshes at which no record had written the value cost next to nothing.
class TrendSeries {
public:
    struct Sample {
        std::uint32_t refresh;
        std::int64_t raw;
        const Quantity* quantity;  ///< never null
    };

    /// What record `record` reported, as seen at `refresh`, which is not before one noted already. A reading of a
    /// record that was noted before is no new reading; while nobody counts records, and they are 0, every one is.
    void note(std::uint32_t refresh, const Reading& reading, std::uint64_t record);
    /// Samples before `refresh` are not wanted any more; a few of them may stay.
    void forgetBefore(std::uint32_t refresh);

    /// Oldest first.
    std::vector<Sample> samples() const;
    bool isEmpty() const { return _begin == _end; }
    /// The refresh behind the last sample.
    std::uint32_t end() const { return _end; }
    std::uint32_t begin() const { return _begin; }
    /// What it holds, itself included.
    std::size_t bytes() const;

private:
    enum class Step : std::uint8_t {
        Same,       ///< for so many refreshes a record wrote the same number again
        Changed,    ///< a record wrote a number; the difference follows, with its sign in the lowest bit
        Silent,     ///< for so many refreshes no record wrote the value
        Quantified  ///< from here on the numbers stand for the quantity of this index
    };
    struct State {
        std::int64_t raw = 0;
        std::size_t quantity = 0;
    };

    void put(Step step, std::uint64_t number);
    void append(std::uint64_t byte);
    void endRun();
    void useQuantity(const Quantity* quantity);
    /// Reads the step at `at`, which moves behind it.
    Step take(std::size_t& at, std::uint64_t& number) const;
    static std::int64_t stepped(std::int64_t raw, std::uint64_t difference);

    std::vector<std::uint8_t> _steps;          // of the refreshes from _begin on; a run that has not ended is missing
    std::vector<const Quantity*> _quantities;  // most have one
    State _first;                              // before the first step
    State _last;                               // at the last sample
    std::uint64_t _record = 0;                 // which wrote the last sample
    std::uint32_t _begin = 0;
    std::uint32_t _end = 0;
    std::uint32_t _run = 0;  // so many refreshes of Same are not among the steps yet
};

}  // namespace kelvo
