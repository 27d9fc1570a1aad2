#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>

namespace kelvo {

/// Whether two texts are the same. Keys are short: comparing them eight bytes at a time costs a record half of what a
/// call of the library's comparison would.
inline bool isSameText(std::string_view a, std::string_view b) {
    const auto wordOf = [](std::string_view text, std::size_t at) {
        std::uint64_t word = 0;
        std::memcpy(&word, text.data() + at, sizeof word);
        return word;
    };
    constexpr std::size_t kWord = sizeof(std::uint64_t);
    if (a.size() != b.size()) return false;
    if (a.size() < kWord) return a == b;
    for (std::size_t at = 0; at + kWord < a.size(); at += kWord) {
        if (wordOf(a, at) != wordOf(b, at)) return false;
    }
    const std::size_t last = a.size() - kWord;
    return wordOf(a, last) == wordOf(b, last);
}

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
