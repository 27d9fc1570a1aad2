#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>

namespace kelvo {

/// Whether the same `Word` stands at two places.
template <class Word>
bool isSameWord(const char* a, const char* b) {
    Word ofA = 0;
    Word ofB = 0;
    std::memcpy(&ofA, a, sizeof(Word));
    std::memcpy(&ofB, b, sizeof(Word));
    return ofA == ofB;
}

/// Whether two texts are the same. Keys are short: comparing them word by word costs a record half of what a call of
/// the library's comparison would. The last word reaches back into the one before it.
inline bool isSameText(std::string_view a, std::string_view b) {
    using Long = std::uint64_t;
    using Short = std::uint32_t;
    const std::size_t size = a.size();
    if (size != b.size()) return false;
    const char* const endOfA = a.data() + size;
    const char* const endOfB = b.data() + size;
    if (size >= sizeof(Long)) {
        for (std::size_t at = 0; at + sizeof(Long) < size; at += sizeof(Long)) {
            if (!isSameWord<Long>(a.data() + at, b.data() + at)) return false;
        }
        return isSameWord<Long>(endOfA - sizeof(Long), endOfB - sizeof(Long));
    }
    if (size < sizeof(Short)) return a == b;
    return isSameWord<Short>(a.data(), b.data()) && isSameWord<Short>(endOfA - sizeof(Short), endOfB - sizeof(Short));
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
