#pragma once

#include <nlohmann/json.hpp>
#include <string>

#include "tools/import/RecordSurvey.h"

namespace kelvo {

/// What "kelvoctl import --list" prints: a line for every code, version and length, and the screens that can be filled.
std::string listingText(const RecordSurvey& survey);
nlohmann::ordered_json listingJson(const RecordSurvey& survey);

}  // namespace kelvo
