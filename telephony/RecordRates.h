#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <unordered_map>
#include <vector>

#include "LogGenerator/Framing.h"
#include "platform/system/SteadyTime.h"

namespace kelvo {

/// Counts records by log code, with their rates over the last ten seconds.
class RecordRates {
public:
    static constexpr int kWindow = 10;              ///< seconds
    static constexpr std::size_t kMostCodes = 256;  ///< counted one by one; records of further codes are counted as one

    explicit RecordRates(SteadyTime now) : _now(std::move(now)), _start(_now()) {}

    /// `code` is none for a record without one.
    void count(std::optional<LogCode> code);

    struct Rate {
        std::optional<LogCode> code;  ///< none: records without a code, and those of codes beyond the limit
        std::uint64_t records = 0;    ///< in all
        double perSecond = 0;         ///< over the last ten seconds, or since the start when that is shorter
    };
    /// In the order of codes, records without one first.
    std::vector<Rate> rates() const;

private:
    struct Counts {
        std::uint64_t all = 0;
        std::array<std::uint32_t, kWindow> bySecond{};  // in second s: at s modulo the window
        std::int64_t second = 0;                        // of the last record
    };
    std::int64_t secondNow() const;
    static void forget(Counts& counts, std::int64_t second);

    const SteadyTime _now;
    const std::chrono::nanoseconds _start;
    std::unordered_map<std::int64_t, Counts> _counts;  // by code; -1 for none
};

}  // namespace kelvo
