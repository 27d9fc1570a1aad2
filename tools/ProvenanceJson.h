#pragma once

#include <chrono>
#include <nlohmann/json.hpp>

#include "LogGenerator/RecordLedger.h"
#include "platform/values/Value.h"

namespace kelvo {

/// As `jsonFrom`, but every text with what is known of it: {"text": "-95.25 dBm", "number": -95.25, "unit": "dBm",
/// "code": "0xb17f", "record": 4711, "age": 3.2}; the age in seconds, in the stream's time. What does not apply is left
/// out: a text that is no number has neither number nor unit, one that no record has written the text alone. "_sorted"
/// entries, which are no values, stay texts.
nlohmann::ordered_json jsonWithProvenance(const Value& value, const RecordLedger& records,
                                          std::chrono::nanoseconds now);

}  // namespace kelvo
