#pragma once

#include <bit>
#include <cstddef>
#include <string>
#include <string_view>

#include "platform/values/Bytes.h"

namespace kelvo {

/// U+FFFD, which stands for text that cannot be read.
inline constexpr char32_t kReplacementCharacter = 0xFFFD;

/// One code point and the bytes it takes up.
struct Utf8Character {
    char32_t code;
    std::size_t length;
};

/// Whether every byte of `text` is below 0x80.
bool isAscii(std::string_view text);

/// The first code point of `text`, which is not empty. A byte that is not UTF-8 (overlong forms, surrogates and cut
/// sequences included) gives U+FFFD with length 1.
Utf8Character firstUtf8Character(std::string_view text);

/// Appends `code` as UTF-8; a surrogate or a number beyond U+10FFFF as U+FFFD.
void appendUtf8(std::string& out, char32_t code);

/// Appends `text` with every byte that is not UTF-8 replaced by U+FFFD.
void appendCleanUtf8(std::string& out, std::string_view text);

/// UTF-16 in the given byte order as UTF-8. Lone surrogates, and half a unit at the end, become U+FFFD.
std::string utf8FromUtf16(ByteView text, std::endian order);

/// `text` made safe to print on one line of a terminal or a log: control characters, which a record could hold to take
/// the terminal over or to make up lines, and bytes that are not UTF-8 become U+FFFD.
std::string printable(std::string_view text);

}  // namespace kelvo
