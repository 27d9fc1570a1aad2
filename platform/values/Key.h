#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace kelvo {

/// A dictionary key together with its hash, borrowed for the call. A key made from a literal in a constant expression
/// costs nothing at run time, so a table of keys is looked up without touching their characters' hashes again.
class Key {
public:
    constexpr Key(std::string_view text) : _text(text), _hash(hashOf(text)) {}
    constexpr Key(const char* text) : Key(std::string_view(text)) {}
    Key(const std::string& text) : Key(std::string_view(text)) {}

    constexpr std::string_view text() const { return _text; }
    constexpr std::uint32_t hash() const { return _hash; }
    friend constexpr bool operator==(const Key& a, const Key& b) { return a._text == b._text; }

private:
    static constexpr std::uint32_t hashOf(std::string_view text) {  // FNV-1a
        std::uint32_t hash = 2166136261U;
        for (char c : text) hash = (hash ^ static_cast<std::uint8_t>(c)) * 16777619U;
        return hash;
    }

    std::string_view _text;
    std::uint32_t _hash;
};

}  // namespace kelvo
