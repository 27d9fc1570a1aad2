#pragma once

#include <algorithm>
#include <charconv>
#include <string_view>

#include "platform/values/Array.h"
#include "platform/values/Dictionary.h"

namespace kelvo::test {

/// What stands at a path of a display, such as "Neighbors/0/Cell ID": keys as they are shown (without what a sorted key
/// has before its ";"), rows by number. None when there is nothing. Points into the display.
inline const Value* shownAt(const Value& display, std::string_view path) {
    const auto below = [](const Value& value, std::string_view name) -> const Value* {
        if (value.array()) {
            std::size_t index = 0;
            std::from_chars(name.data(), name.data() + name.size(), index);
            return index < value.array()->size() ? &(*value.array())[index] : nullptr;
        }
        if (!value.dictionary()) return nullptr;
        for (const auto& [key, entry] : *value.dictionary()) {
            const std::string_view shown = std::string_view(key).substr(std::string_view(key).find(';') + 1);
            if (shown == name) return &entry;
        }
        return nullptr;
    };
    const Value* here = &display;
    while (here != nullptr && !path.empty()) {
        const std::size_t end = std::min(path.find('/'), path.size());
        here = below(*here, path.substr(0, end));
        path.remove_prefix(std::min(end + 1, path.size()));
    }
    return here;
}

}  // namespace kelvo::test
