#include "platform/encodings/Utf8.h"

#include <algorithm>

namespace kelvo {

namespace {

bool isAsciiByte(char c) { return static_cast<unsigned char>(c) < 0x80; }
bool isControl(char32_t code) {
    return code < 0x20 || (code >= 0x7f && code < 0xa0) || code == 0x2028 || code == 0x2029;
}
bool isHighSurrogate(char32_t unit) { return unit >= 0xD800 && unit < 0xDC00; }
bool isLowSurrogate(char32_t unit) { return unit >= 0xDC00 && unit < 0xE000; }

}  // namespace

bool isAscii(std::string_view text) {
    unsigned bits = 0;  // a loop without a way out, which compilers turn into wide steps
    for (const char c : text) bits |= static_cast<unsigned char>(c);
    return bits < 0x80;
}

Utf8Character firstUtf8Character(std::string_view text) {
    constexpr Utf8Character kMalformed{kReplacementCharacter, 1};
    const auto byte = [&](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    const unsigned char lead = byte(0);
    if (lead < 0x80) return {lead, 1};
    const std::size_t length = lead >= 0xF0 ? 4 : lead >= 0xE0 ? 3 : 2;
    if (lead < 0xC2 || lead > 0xF4 || text.size() < length) return kMalformed;
    char32_t code = lead & (0x7FU >> length);
    for (std::size_t i = 1; i < length; ++i) {
        if ((byte(i) & 0xC0U) != 0x80) return kMalformed;
        code = code << 6 | (byte(i) & 0x3FU);
    }
    const bool overlong = code < (length == 3 ? 0x800U : length == 4 ? 0x10000U : 0x80U);
    if (overlong || code > 0x10FFFF || isHighSurrogate(code) || isLowSurrogate(code)) return kMalformed;
    return {code, length};
}

void appendUtf8(std::string& out, char32_t code) {
    if (code > 0x10FFFF || isHighSurrogate(code) || isLowSurrogate(code)) code = kReplacementCharacter;
    const auto put = [&](char32_t byte) { out.push_back(static_cast<char>(byte)); };
    if (code < 0x80) return put(code);
    if (code < 0x800) {
        put(0xC0 | code >> 6);
    } else if (code < 0x10000) {
        put(0xE0 | code >> 12);
        put(0x80 | (code >> 6 & 0x3F));
    } else {
        put(0xF0 | code >> 18);
        put(0x80 | (code >> 12 & 0x3F));
        put(0x80 | (code >> 6 & 0x3F));
    }
    put(0x80 | (code & 0x3F));
}

void appendCleanUtf8(std::string& out, std::string_view text) {
    while (!text.empty()) {
        const auto run =
            static_cast<std::size_t>(std::find_if_not(text.begin(), text.end(), isAsciiByte) - text.begin());
        out.append(text, 0, run);
        text.remove_prefix(run);
        if (text.empty()) return;
        const Utf8Character character = firstUtf8Character(text);
        appendUtf8(out, character.code);
        text.remove_prefix(character.length);
    }
}

std::string printable(std::string_view text) {
    std::string clean;
    clean.reserve(text.size());
    while (!text.empty()) {
        const Utf8Character character = firstUtf8Character(text);
        appendUtf8(clean, isControl(character.code) ? kReplacementCharacter : character.code);
        text.remove_prefix(character.length);
    }
    return clean;
}

std::string utf8FromUtf16(ByteView text, std::endian order) {
    const std::size_t units = text.size() / 2;
    const std::size_t high = order == std::endian::big ? 0 : 1;
    const auto unit = [&](std::size_t i) -> char32_t { return text[2 * i + high] << 8U | text[2 * i + 1 - high]; };
    std::string out;
    out.reserve(units);
    for (std::size_t i = 0; i < units; ++i) {
        const char32_t first = unit(i);
        if (isHighSurrogate(first) && i + 1 < units && isLowSurrogate(unit(i + 1))) {
            appendUtf8(out, 0x10000 + ((first - 0xD800) << 10) + (unit(++i) - 0xDC00));
        } else {
            appendUtf8(out, first);
        }
    }
    if (text.size() % 2 != 0) appendUtf8(out, kReplacementCharacter);
    return out;
}

}  // namespace kelvo
