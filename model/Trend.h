#pragma once

#include <chrono>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "platform/values/Reading.h"

namespace kelvo {

/// How one number has gone, refresh by refresh: the readings that records wrote, and nothing for refreshes at which
/// none did.
struct Trend {
    using Time = std::chrono::milliseconds;  ///< as the caller of `Trends::note` counts it

    /// From one reading to the next longer than this, no record wrote the value, and the line breaks.
    static constexpr Time kGap = std::chrono::seconds(10);

    struct Point {
        Time at{0};
        double number = 0;  ///< in the trend's unit
        std::int64_t raw = 0;
        const Quantity* quantity = nullptr;

        /// As the screen showed it.
        std::string text() const {
            std::string shown;
            quantity->print(shown, raw);
            return shown;
        }
    };

    std::vector<Point> points = {};  ///< oldest first
    std::string_view unit = {};      ///< "dBm"; empty for plain numbers
};

/// A text, or a cell, that took another's place.
struct TrendChange {
    Trend::Time at{0};
    std::string text = {};
    friend bool operator==(const TrendChange&, const TrendChange&) = default;
};

}  // namespace kelvo
