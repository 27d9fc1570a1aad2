#pragma once

#include <nlohmann/json.hpp>

#include "overview/Tracker.h"

namespace kelvo {

/// The overview at `now` for programs: objects of those names and orders that `overviewText` shows. What the modem does
/// not tell is left out.
nlohmann::ordered_json overviewJson(const overview::Tracker& tracker, overview::Time now);

/// One event: "time" in ISO 8601, "event", and of "from", "to", "levelBefore", "levelAfter", "record" and "values" (an
/// object of objects with "before" and "after") those there are.
nlohmann::ordered_json eventJson(const overview::Event& event);

}  // namespace kelvo
