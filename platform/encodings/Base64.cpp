#include "platform/encodings/Base64.h"

#include <array>
#include <cstddef>

namespace kelvo {

namespace {

constexpr std::string_view kAlphabet = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
constexpr std::uint8_t kPadding = 64;
constexpr std::uint8_t kSpace = 65;
constexpr std::uint8_t kForeign = 66;

constexpr std::array<std::uint8_t, 256> kMeaning = [] {
    std::array<std::uint8_t, 256> meaning{};
    meaning.fill(kForeign);
    for (std::size_t i = 0; i < kAlphabet.size(); ++i) {
        meaning[static_cast<unsigned char>(kAlphabet[i])] = static_cast<std::uint8_t>(i);
    }
    for (unsigned char c : {' ', '\t', '\n', '\v', '\f', '\r'}) meaning[c] = kSpace;
    meaning['='] = kPadding;
    return meaning;
}();

}  // namespace

std::optional<Bytes> bytesFromBase64(std::string_view text) {
    Bytes bytes;
    bytes.reserve(text.size() / 4 * 3);
    std::uint32_t group = 0;
    std::size_t digits = 0;  // in the group so far, padding included
    std::size_t padding = 0;
    bool finished = false;  // a group with padding is the last one
    for (const char c : text) {
        const std::uint8_t meaning = kMeaning[static_cast<unsigned char>(c)];
        if (meaning == kSpace) continue;
        const bool misplaced = meaning == kPadding ? digits < 2 : padding > 0;
        if (meaning == kForeign || finished || misplaced) return std::nullopt;
        if (meaning == kPadding) ++padding;
        group = group << 6 | (meaning & 0x3FU);
        if (++digits < 4) continue;
        for (std::size_t i = 0; i < 3 - padding; ++i) bytes.push_back(static_cast<std::uint8_t>(group >> (16 - 8 * i)));
        finished = padding > 0;
        digits = 0;
    }
    if (digits != 0) return std::nullopt;
    return bytes;
}

void appendBase64(std::string& out, ByteView data) {
    for (std::size_t i = 0; i < data.size(); i += 3) {
        const std::size_t rest = data.size() - i;
        const std::uint32_t group =
            data[i] << 16U | (rest > 1 ? data[i + 1] << 8U : 0U) | (rest > 2 ? data[i + 2] : 0U);
        out.push_back(kAlphabet[group >> 18]);
        out.push_back(kAlphabet[group >> 12 & 0x3F]);
        out.push_back(rest > 1 ? kAlphabet[group >> 6 & 0x3F] : '=');
        out.push_back(rest > 2 ? kAlphabet[group & 0x3F] : '=');
    }
}

}  // namespace kelvo
