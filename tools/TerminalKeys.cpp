#include "tools/TerminalKeys.h"

#include <algorithm>
#include <optional>
#include <utility>

namespace kelvo {

namespace {

constexpr char kEscape = '\x1b';

// clang-format off
constexpr std::pair<std::string_view, TerminalKey> kKeys[] = {
    {"\x1b[A",  TerminalKey::Up},       {"\x1bOA",  TerminalKey::Up},       {"k", TerminalKey::Up},
    {"\x1b[B",  TerminalKey::Down},     {"\x1bOB",  TerminalKey::Down},     {"j", TerminalKey::Down},
    {"\x1b[D",  TerminalKey::Left},     {"\x1bOD",  TerminalKey::Left},     {"h", TerminalKey::Left},
    {"\x1b[C",  TerminalKey::Right},    {"\x1bOC",  TerminalKey::Right},    {"l", TerminalKey::Right},
    {"\x1b[5~", TerminalKey::PageUp},   {"b",       TerminalKey::PageUp},
    {"\x1b[6~", TerminalKey::PageDown}, {" ",       TerminalKey::PageDown},
    {"\x1b[H",  TerminalKey::Home},     {"\x1bOH",  TerminalKey::Home},     {"\x1b[1~", TerminalKey::Home}, {"g", TerminalKey::Home},
    {"\x1b[F",  TerminalKey::End},      {"\x1bOF",  TerminalKey::End},      {"\x1b[4~", TerminalKey::End},  {"G", TerminalKey::End},
    {"p",       TerminalKey::Provenance},
    {"o",       TerminalKey::Overview},
    {"q",       TerminalKey::Quit},     {"Q",       TerminalKey::Quit},
};
// clang-format on

std::optional<TerminalKey> keyOf(std::string_view sequence) {
    for (const auto& [text, key] : kKeys) {
        if (text == sequence) return key;
    }
    return std::nullopt;
}

/// The length of the character or sequence at the front; 0 while it is not complete.
std::size_t firstLength(std::string_view bytes) {
    if (bytes[0] != kEscape) return 1;
    if (bytes.size() == 1) return 0;
    if (bytes[1] == 'O') return bytes.size() > 2 ? 3 : 0;
    if (bytes[1] != '[') return 1;  // an Escape of its own
    const auto* end = std::find_if(bytes.begin() + 2, bytes.end(), [](char c) { return c >= 0x40 && c <= 0x7e; });
    return end != bytes.end() ? static_cast<std::size_t>(end - bytes.begin()) + 1 : 0;
}

}  // namespace

std::vector<TerminalKey> TerminalKeys::feed(std::string_view bytes) {
    constexpr std::size_t kLongestSequence = 32;
    std::vector<TerminalKey> keys;
    _pending += bytes;
    while (!_pending.empty()) {
        const std::size_t length = firstLength(_pending);
        if (length == 0) break;
        if (const auto key = keyOf(std::string_view(_pending).substr(0, length))) keys.push_back(*key);
        _pending.erase(0, length);
    }
    if (_pending.size() > kLongestSequence) _pending.clear();
    return keys;
}

}  // namespace kelvo
