#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

namespace kelvo {

/// The unit of a shown number.
struct Unit {
    std::string_view symbol;   ///< for machines
    std::string_view written;  ///< directly behind the number on a screen
};

// clang-format off
inline constexpr Unit dBm      {"dBm",      " dBm"};
inline constexpr Unit dB       {"dB",       " dB"};
inline constexpr Unit kbps     {"kbps",     " kbps"};
inline constexpr Unit percent  {"%",        "%"};
inline constexpr Unit inSeconds{"s",        " sec"};
inline constexpr Unit pnOffset {"64 chips", " × 64chips"};  ///< in steps of 64 chips, 3GPP2 C.S0024
// clang-format on

/// How a number is written: a printf format with one conversion and text around it ("%d", "%+d", "%u", "%06x",
/// "%4.2f"), taken apart at compile time, and the unit behind the number.
struct NumberFormat {
    std::string_view before;
    std::string_view after;
    Unit unit{};
    char conversion = 0;  ///< 'd', 'u', 'x' or 'f'; 0 for a text without a number
    bool plus = false;    ///< the sign is always shown
    bool zeros = false;   ///< filled up to the width with zeros; hexadecimal only
    int width = 0;
    int precision = 6;

    constexpr NumberFormat(const char* format, Unit behind = {}) : unit(behind) {
        const std::string_view text(format);
        const std::size_t percentSign = text.find('%');
        before = text.substr(0, percentSign);
        if (percentSign == std::string_view::npos) return;
        const auto isDigit = [&](std::size_t i) { return i < text.size() && text[i] >= '0' && text[i] <= '9'; };
        std::size_t i = percentSign + 1;
        if (i < text.size() && text[i] == '+') plus = text[i++] == '+';
        if (i < text.size() && text[i] == '0') zeros = text[i++] == '0';
        for (; isDigit(i); ++i) width = width * 10 + (text[i] - '0');
        if (i < text.size() && text[i] == '.') {
            precision = 0;
            for (++i; isDigit(i); ++i) precision = precision * 10 + (text[i] - '0');
        }
        if (i < text.size() && text[i] == 'l') ++i;
        conversion = i < text.size() ? text[i] : '\0';
        if (conversion != 'd' && conversion != 'u' && conversion != 'x' && conversion != 'f') {
            throw "this conversion is not supported";
        }
        if (zeros && conversion != 'x') throw "leading zeros are supported for %x only";
        after = text.substr(i + 1);
        if (after.find('%') != std::string_view::npos) throw "a format has one conversion";
    }

    /// Makes `text` a whole number; 'u' and 'x' are for numbers that are not negative.
    void print(std::string& text, std::int64_t number) const;
    /// Makes `text` a real number; infinities and not-a-number as printf writes them.
    void print(std::string& text, double number) const;
    /// Makes `text` a real number that is given in eighths; with two decimals or more.
    void printEighths(std::string& text, std::int64_t eighths) const;
};

}  // namespace kelvo
