#include "tools/ProvenanceJson.h"

#include <fmt/format.h>

#include <cmath>

#include "model/Provenance.h"
#include "tools/DisplayJson.h"

namespace kelvo {

namespace {

using Json = nlohmann::ordered_json;

/// Whole numbers without a point.
Json jsonOf(double number) {
    constexpr double kExact = 9007199254740992;  // up to here every whole number is a double
    const bool isWhole = std::floor(number) == number && std::abs(number) <= kExact;
    return isWhole ? Json(static_cast<std::int64_t>(number)) : Json(number);
}

Json textWithProvenance(const Value& text, const RecordLedger& records, std::chrono::nanoseconds now) {
    Json json = {{"text", *text.string()}};
    if (const auto measurement = text.measurement()) {
        json["number"] = jsonOf(measurement->number);
        if (!measurement->unit.empty()) json["unit"] = measurement->unit;
    }
    if (const auto provenance = provenanceOf(text.record(), records, now)) {
        if (provenance->code) json["code"] = fmt::format("0x{:04x}", *provenance->code);
        json["record"] = provenance->record;
        json["age"] = std::round(std::chrono::duration<double>(provenance->age).count() * 10) / 10;
    }
    return json;
}

}  // namespace

Json jsonWithProvenance(const Value& value, const RecordLedger& records, std::chrono::nanoseconds now) {
    if (value.string() != nullptr) return textWithProvenance(value, records, now);
    if (value.array()) {
        Json json = Json::array();
        for (const Value& element : *value.array()) json.push_back(jsonWithProvenance(element, records, now));
        return json;
    }
    if (value.dictionary()) {
        Json::object_t object;  // keys are unique already: no search for each of them
        for (const auto& [key, child] : *value.dictionary()) {
            object.Container::emplace_back(
                key, key == "_sorted" ? jsonFrom(child) : jsonWithProvenance(child, records, now));
        }
        return object;
    }
    return jsonFrom(value);
}

}  // namespace kelvo
