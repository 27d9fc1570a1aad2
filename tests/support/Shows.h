#pragma once

#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "tests/support/Fed.h"

namespace kelvo::test {

/// Expects that a record of `size` zeros shows, under `key`, the text that belongs to the byte at `at`.
template <class SectionClass>
void expectNames(LogCode code, std::size_t size, std::size_t at, const std::string& key,
                 const std::vector<std::pair<std::uint32_t, std::string>>& names) {
    Fed<SectionClass> section;
    for (const auto& [raw, name] : names) {
        section.feed(Record(code, size).u8(at, raw));
        EXPECT_EQ(section[key], name) << key << " of " << raw;
    }
}

/// The keys of a dictionary in their order.
inline std::vector<std::string> keysOf(const Value& dictionary) {
    std::vector<std::string> keys;
    for (const auto& [key, value] : *dictionary.dictionary()) keys.push_back(key);
    return keys;
}

}  // namespace kelvo::test
