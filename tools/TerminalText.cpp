#include "tools/TerminalText.h"

#include <wchar.h>

#include <algorithm>

#include "platform/encodings/Utf8.h"

namespace kelvo {

namespace {

constexpr std::string_view kEllipsis = "…";

/// Calls `see` with every character's bytes, the column it begins in and how many it takes up.
template <class See>
void forEachCharacter(std::string_view text, See see) {
    std::size_t column = 0;
    while (!text.empty()) {
        const Utf8Character character = firstUtf8Character(text);
        const int wide = ::wcwidth(static_cast<wchar_t>(character.code));
        const std::size_t width = wide < 0 ? 1 : static_cast<std::size_t>(wide);
        see(text.substr(0, character.length), column, width);
        column += width;
        text.remove_prefix(character.length);
    }
}

}  // namespace

std::size_t columnsOf(std::string_view text) {
    std::size_t columns = 0;
    forEachCharacter(text, [&](std::string_view, std::size_t column, std::size_t width) { columns = column + width; });
    return columns;
}

std::string clipped(std::string_view text, std::size_t from, std::size_t columns) {
    const bool goesOn = columnsOf(text) > from + columns;
    const bool beganBefore = columns > 1 && text.find_first_not_of(' ') < from;
    const std::size_t first = from + (beganBefore ? 1 : 0);
    const std::size_t end = from + columns - std::min<std::size_t>(columns, goesOn ? 1 : 0);
    std::string shown(beganBefore ? kEllipsis : std::string_view());
    forEachCharacter(text, [&](std::string_view character, std::size_t column, std::size_t width) {
        if (column >= first && column + width <= end) {
            shown += character;
        } else if (column < end && column + width > first) {  // half of a wide one
            shown += ' ';
        }
    });
    return goesOn && columns > 0 ? shown.append(kEllipsis) : shown;
}

}  // namespace kelvo
