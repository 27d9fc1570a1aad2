#pragma once

#include <nlohmann/json.hpp>
#include <string>

#include "platform/values/Value.h"

namespace kelvo {

/// A property-list value as JSON: dictionaries in their order, data as {"$data": "<base64>"}, dates as
/// {"$date": "<ISO 8601>"}, none as null. A date outside the years 0 to 9999 is null in its "$date".
nlohmann::ordered_json jsonFrom(const Value& value);

/// The printed form, indented, with a line end. Bytes that are not UTF-8 become U+FFFD.
std::string printedJson(const nlohmann::ordered_json& json);
/// The same on one line, without a line end.
std::string printedJsonLine(const nlohmann::ordered_json& json);

}  // namespace kelvo
