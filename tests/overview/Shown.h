#pragma once

#include <string_view>

#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"

/// Displays made by hand, as a modem's records would have left them.
namespace kelvo::overview {

using Entries = std::initializer_list<std::pair<std::string_view, std::string_view>>;

/// A text that the record `number` wrote.
inline Value shown(std::string_view text, std::uint64_t number = 1) {
    Value value(text);
    value.setRecord(number);
    return value;
}

/// A group or row of texts that one record wrote.
inline Value shown(Entries entries, std::uint64_t number = 1) {
    const DictionaryRef dictionary = Dictionary::make();
    for (const auto& [key, text] : entries) dictionary->set(key, shown(text, number));
    return dictionary;
}

inline Value group(std::initializer_list<std::pair<std::string_view, Value>> entries) {
    return Dictionary::make(entries);
}

inline Value list(std::initializer_list<Value> rows) { return Array::make(rows); }

}  // namespace kelvo::overview
