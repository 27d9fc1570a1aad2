#include <arpa/inet.h>

#include <algorithm>
#include <array>
#include <cctype>
#include <charconv>

#include "tools/share/Replacer.h"

/// Identities as texts.
namespace kelvo {

namespace {

bool isDigit(char c) { return c >= '0' && c <= '9'; }
bool isHexadecimal(char c) { return isDigit(c) || (c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F'); }

std::string digitsOf(std::string_view text) {
    std::string digits;
    std::ranges::copy_if(text, std::back_inserter(digits), isDigit);
    return digits;
}

/// Other digits in the places of a text's own.
std::string withDigits(std::string text, std::string_view digits) {
    std::size_t next = 0;
    for (char& c : text) {
        if (isDigit(c)) c = digits[next++];
    }
    return text;
}

std::optional<Bytes> bytesFrom(std::string_view hexadecimal) {
    if (hexadecimal.size() % 2 != 0 || !std::ranges::all_of(hexadecimal, isHexadecimal)) return std::nullopt;
    Bytes bytes;
    for (std::size_t at = 0; at < hexadecimal.size(); at += 2) {
        std::uint8_t byte = 0;
        std::from_chars(hexadecimal.data() + at, hexadecimal.data() + at + 2, byte, 16);
        bytes.push_back(byte);
    }
    return bytes;
}

/// In the case of `like`.
std::string hexadecimalOf(ByteView bytes, std::string_view like) {
    const bool lower = std::ranges::any_of(like, [](char c) { return c >= 'a' && c <= 'f'; });
    const char* const digits = lower ? "0123456789abcdef" : "0123456789ABCDEF";
    std::string text;
    for (const std::uint8_t byte : bytes) {
        text += digits[byte >> 4];
        text += digits[byte & 15];
    }
    return text;
}

/// What screens write of a number that is none.
bool isNoNumber(const std::string& text) {
    static constexpr std::array<std::string_view, 6> kWords = {"", "\u2013", "-", "N/A", "Invalid Value", "(none)"};
    if (std::ranges::find(kWords, text) != kWords.end()) return true;
    constexpr std::string_view kUnknown = "(unknown system type ";
    if (!text.starts_with(kUnknown) || !text.ends_with(")") || text.size() > kUnknown.size() + 12) return false;
    return std::all_of(text.begin() + kUnknown.size(), text.end() - 1, [](char c) { return isDigit(c) || c == '-'; });
}

/// What may stand behind a number: the unit of pilot offsets, or the blank of a missing third digit.
bool mayFollow(std::string_view rest) {
    return rest == " \u00D7 64chips" || rest.find_first_not_of(' ') == std::string_view::npos;
}

}  // namespace

std::optional<std::string> Replacer::textOf(Identity identity, const std::string& text) {
    if (isNumber(identity)) return numberText(identity, text);
    const bool isDashed = text == "\u2013" || text == "-";
    if (isDashed) return text;
    switch (identity) {
        case Identity::SimNumber:
        case Identity::Subscriber:
        case Identity::Equipment: return codeText(nameOf(identity), text);
        case Identity::Phone: return phoneText(text);
        case Identity::Address: return addressText(text);
        case Identity::Apn: return apnText(text);
        case Identity::NetworkName: return _pseudonyms.letters(nameOf(identity), text);
        default: return hexText(identity, text);
    }
}

/// "17", "-2" (of 32 bits), "01 ", "12 x 64chips".
std::optional<std::string> Replacer::numberText(Identity identity, const std::string& text) {
    if (isNoNumber(text)) return text;
    const bool isNegative = text.front() == '-';
    const char* const begin = text.data() + (isNegative ? 1 : 0);
    std::uint64_t magnitude = 0;
    const auto [end, error] = std::from_chars(begin, text.data() + text.size(), magnitude);
    const std::string_view rest(end, static_cast<std::size_t>(text.data() + text.size() - end));
    if (error != std::errc() || magnitude > 0xFFFFFFFF || !mayFollow(rest)) return std::nullopt;
    const auto value = static_cast<std::uint32_t>(isNegative ? 0 - magnitude : magnitude);
    const std::uint32_t other = pseudonym(identity, value);
    std::string digits = std::to_string(isNegative ? std::uint32_t{0} - other : other);
    const auto width = static_cast<std::size_t>(end - begin);
    if (digits.size() < width) digits.insert(0, width - digits.size(), '0');
    return (isNegative ? "-" : "") + digits + std::string(rest);
}

/// What lies in a SIM's file, and temporary identities.
std::optional<std::string> Replacer::hexText(Identity identity, const std::string& text) {
    const std::size_t prefix = text.starts_with("0x") || text.starts_with("0X") ? 2 : 0;
    const std::string_view digits = std::string_view(text).substr(prefix);
    if (identity == Identity::Temporary && prefix == 0 && std::ranges::all_of(text, isDigit)) {
        return _pseudonyms.digits(nameOf(identity), text);
    }
    const auto bytes = bytesFrom(digits);
    const auto other = bytes ? bytesOf(identity, *bytes) : std::nullopt;
    if (other) return text.substr(0, prefix) + hexadecimalOf(*other, digits);
    return codeText(nameOf(identity), text);
}

/// All digits are one identity; fillers and what stands between stay. A single letter may be a hexadecimal digit.
std::string Replacer::codeText(std::string_view purpose, const std::string& text) {
    std::string made = withDigits(text, _pseudonyms.digits(purpose, digitsOf(text)));
    const std::string letters = _pseudonyms.letters(purpose, text);
    const bool isCode = std::ranges::all_of(text, [](char c) { return isHexadecimal(c) || c == ' ' || c == '-'; });
    for (std::size_t i = 0; i < made.size(); ++i) {
        if (isDigit(made[i])) continue;
        if (!isCode) made[i] = letters[i];
        if (!isCode || !isHexadecimal(made[i]) || std::tolower(made[i]) == 'f') continue;
        const char first = made[i] >= 'a' ? 'a' : 'A';
        made[i] = static_cast<char>(first + (made[i] - first + 1 + (letters[i] - first) % 4) % 5);
    }
    return made;
}

/// One number, or several between commas; a file's whole content when it looks like one.
std::string Replacer::phoneText(const std::string& text) {
    constexpr std::size_t kShortestFile = 28;
    if (text.size() >= kShortestFile) {
        if (const auto bytes = bytesFrom(text)) return hexadecimalOf(phoneFile(*bytes), text);
    }
    std::string made;
    std::size_t at = 0;
    while (at <= text.size()) {
        const std::size_t end = std::min(text.find_first_of(",;/", at), text.size());
        const std::string part = text.substr(at, end - at);
        const std::string digits = _pseudonyms.digits(nameOf(Identity::Phone), digitsOf(part));
        made += withDigits(_pseudonyms.letters("name", part), digits);
        if (end < text.size()) made += text[end];
        at = end + 1;
    }
    return made;
}

/// Addresses wherever they stand in the text; of what is none, the digits.
std::string Replacer::addressText(const std::string& text) {
    std::string made;
    std::size_t at = 0;
    while (at < text.size()) {
        const auto ofAddress = [&](char c) { return isHexadecimal(c) || c == '.' || c == ':'; };
        std::size_t end = at;
        while (end < text.size() && ofAddress(text[end]) == ofAddress(text[at])) ++end;
        const std::string token = text.substr(at, end - at);
        const auto other = ofAddress(text[at]) ? addressToken(token) : std::nullopt;
        made += other ? *other : codeText("address", token);
        at = end;
    }
    return made;
}

std::optional<std::string> Replacer::addressToken(const std::string& token) {
    std::array<std::uint8_t, 16> binary{};
    std::array<char, INET6_ADDRSTRLEN> printed{};
    for (const auto& [family, size] : {std::pair(AF_INET, 4), std::pair(AF_INET6, 16)}) {
        if (inet_pton(family, token.c_str(), binary.data()) != 1) continue;
        const Bytes other = address(ByteView(binary.data(), static_cast<std::size_t>(size)));
        inet_ntop(family, other.data(), printed.data(), printed.size());
        return printed.data();
    }
    return std::nullopt;
}

/// Labels stay labels. Of a name that is kept, the network that stands in it goes with the cells (3GPP TS 23.003, 9.1).
std::string Replacer::apnText(const std::string& text) {
    if (hides(Identity::Apn)) return _pseudonyms.letters(nameOf(Identity::Apn), text);
    if (!hides(Identity::Country)) return text;
    std::string lower = text;
    std::ranges::transform(lower, lower.begin(), [](unsigned char c) { return std::tolower(c); });
    std::string made = text;
    for (const auto& [label, identity] : {std::pair("mnc", Identity::Network), std::pair("mcc", Identity::Country)}) {
        for (std::size_t at = lower.find(label); at != lower.npos; at = lower.find(label, at + 1)) {
            std::size_t end = at + 3;
            while (end < lower.size() && end < at + 6 && isDigit(lower[end])) ++end;
            const auto other = numberText(identity, lower.substr(at + 3, end - at - 3));
            if (other) made.replace(at + 3, other->size(), *other);
        }
    }
    return made;
}

}  // namespace kelvo
