#include "platform/values/Value.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace kelvo {

std::int64_t Number::integer() const {
    if (const auto* integer = std::get_if<std::int64_t>(&_value)) return *integer;
    const double value = std::get<double>(_value);
    if (std::isnan(value)) return 0;
    // 2^63 is the first double past the range; every smaller one converts.
    if (value >= 9223372036854775808.0) return std::numeric_limits<std::int64_t>::max();
    if (value < -9223372036854775808.0) return std::numeric_limits<std::int64_t>::min();
    return static_cast<std::int64_t>(value);
}

double Number::real() const {
    if (const auto* integer = std::get_if<std::int64_t>(&_value)) return static_cast<double>(*integer);
    return std::get<double>(_value);
}

std::optional<std::int32_t> Number::int32() const {
    const std::int64_t value = integer();
    if (isReal() && static_cast<double>(value) != real()) return std::nullopt;
    if (value < std::numeric_limits<std::int32_t>::min() || value > std::numeric_limits<std::int32_t>::max()) {
        return std::nullopt;
    }
    return static_cast<std::int32_t>(value);
}

constinit const ArrayRef Value::kNoArray;
constinit const DictionaryRef Value::kNoDictionary;

Value::Value(ArrayRef array) {
    if (array) _content = std::move(array);
}

Value::Value(DictionaryRef dictionary) {
    if (dictionary) _content = std::move(dictionary);
}

const Bytes* Value::data() const {
    const auto* shared = std::get_if<std::shared_ptr<const Bytes>>(&_content);
    return shared != nullptr ? shared->get() : nullptr;
}

std::optional<Measurement> Value::measurement() const {
    const Reading* shown = reading();
    return shown != nullptr ? shown->quantity->measure(shown->raw) : std::nullopt;
}

std::string& Value::text() {
    if (const auto* shown = std::get_if<ShownReading>(&_content)) _content = std::string(shown->printed());
    if (auto* text = std::get_if<std::string>(&_content)) return *text;
    return _content.emplace<std::string>();
}

Value Value::copy() const {
    if (array()) return array()->copy();
    if (dictionary()) return dictionary()->copy();
    return *this;
}

bool operator==(const Value& a, const Value& b) {
    if (a.kind() != b.kind()) return false;
    switch (a.kind()) {
        case Value::Kind::None: return true;
        case Value::Kind::String: return *a.string() == *b.string();
        case Value::Kind::Data: return *a.data() == *b.data();
        case Value::Kind::Array: return *a.array() == *b.array();
        case Value::Kind::Dictionary: return *a.dictionary() == *b.dictionary();
        case Value::Kind::Number: return *a.number() == *b.number();
        case Value::Kind::Boolean: return *a.boolean() == *b.boolean();
        case Value::Kind::Date: return *a.date() == *b.date();
    }
    return false;
}

std::string_view kindName(Value::Kind kind) {
    switch (kind) {
        case Value::Kind::None: return "none";
        case Value::Kind::String: return "string";
        case Value::Kind::Number: return "number";
        case Value::Kind::Boolean: return "boolean";
        case Value::Kind::Data: return "data";
        case Value::Kind::Date: return "date";
        case Value::Kind::Array: return "array";
        case Value::Kind::Dictionary: return "dictionary";
    }
    return "none";
}

}  // namespace kelvo
