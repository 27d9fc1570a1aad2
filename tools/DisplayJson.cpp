#include "tools/DisplayJson.h"

#include <fmt/format.h>

#include "platform/encodings/Base64.h"
#include "platform/encodings/IsoDate.h"

namespace kelvo {

namespace {

using Json = nlohmann::ordered_json;

Json jsonFrom(const Number& number) { return number.isReal() ? Json(number.real()) : Json(number.integer()); }

Json jsonFrom(const Bytes& data) {
    std::string text;
    appendBase64(text, data);
    return {{"$data", std::move(text)}};
}

Json jsonFrom(Date date) { return {{"$date", hasIsoForm(date) ? Json(isoDate(date)) : Json()}}; }

Json jsonFrom(const Array& array) {
    Json json = Json::array();
    for (const Value& element : array) json.push_back(kelvo::jsonFrom(element));
    return json;
}

Json jsonFrom(const Dictionary& dictionary) {
    Json::object_t object;  // keys are unique already: no search for each of them
    object.reserve(dictionary.size());
    for (const Dictionary::Entry& entry : dictionary) {
        object.Container::emplace_back(entry.key, kelvo::jsonFrom(entry.value));
    }
    return object;
}

}  // namespace

nlohmann::ordered_json jsonFrom(const Value& value) {
    switch (value.kind()) {
        case Value::Kind::None: return nullptr;
        case Value::Kind::String: return *value.string();
        case Value::Kind::Number: return jsonFrom(*value.number());
        case Value::Kind::Boolean: return *value.boolean();
        case Value::Kind::Data: return jsonFrom(*value.data());
        case Value::Kind::Date: return jsonFrom(*value.date());
        case Value::Kind::Array: return jsonFrom(*value.array());
        case Value::Kind::Dictionary: return jsonFrom(*value.dictionary());
    }
    return nullptr;
}

namespace {

// JSON leaves DEL and the control characters from U+0080 to U+009F as they are, and terminals obey them.
std::string printed(const Json& json, int indent) {
    const std::string dumped = json.dump(indent, ' ', false, Json::error_handler_t::replace);
    std::string text;
    text.reserve(dumped.size() + 1);
    for (std::size_t i = 0; i < dumped.size(); ++i) {
        const unsigned char next = i + 1 < dumped.size() ? static_cast<unsigned char>(dumped[i + 1]) : 0;
        if (dumped[i] == '\x7f') {
            text += "\\u007f";
        } else if (dumped[i] == '\xc2' && next >= 0x80 && next < 0xa0) {
            text += fmt::format("\\u{:04x}", next);
            ++i;
        } else {
            text += dumped[i];
        }
    }
    return text;
}

}  // namespace

std::string printedJson(const nlohmann::ordered_json& json) { return printed(json, 2) + "\n"; }

std::string printedJsonLine(const nlohmann::ordered_json& json) { return printed(json, -1); }

}  // namespace kelvo
