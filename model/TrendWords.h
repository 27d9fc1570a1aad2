#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "model/Trend.h"

namespace kelvo {

/// What a stretch of a trend comes to.
struct TrendStatistics {
    double least = 0;
    double mean = 0;  ///< of the readings
    double most = 0;
    double change = 0;  ///< from the mean of the first third of the readings to that of the last
};

/// Of the readings from `from` to `to`, both included; none when there are none.
std::optional<TrendStatistics> statisticsOf(const Trend& trend, Trend::Time from, Trend::Time to);

/// "-95.25", "23", "0.13": at most two decimals, and none that says nothing.
std::string numberText(double number);

/// "30 seconds", "a minute", "five minutes", "90 seconds", "23 minutes".
std::string spanText(Trend::Time span);

/// "40 seconds", "2 minutes", "3 hours": how long ago something was.
std::string agoText(Trend::Time age);
/// "40 seconds old".
std::string ageText(Trend::Time age);

/// What a chart of the trend shows from `from` to `to`, for those who do not see it: "-95 dBm, between -101 and -88 in
/// the last five minutes, falling". `now` is the time of the moment; a stretch that ends earlier is said to.
std::string trendSummary(const Trend& trend, Trend::Time from, Trend::Time to, Trend::Time now);

}  // namespace kelvo
