#pragma once

#include <cstddef>
#include <string_view>

namespace kelvo {

/// A printf format with one conversion, taken apart at compile time: "%d", "%+d", "%u", "%06x", "%4.2f" and so on, with
/// text around it; a percent sign may follow the number directly.
struct NumberFormat {
    std::string_view before;
    std::string_view after;
    char conversion = 0;  ///< 'd', 'u', 'x' or 'f'; 0 for a text without a number
    bool plus = false;    ///< the sign is always shown
    bool zeros = false;   ///< filled up to the width with zeros; hexadecimal only
    int width = 0;
    int precision = 6;

    constexpr NumberFormat() = default;
    constexpr NumberFormat(const char* format) {
        const std::string_view text(format);
        const std::size_t percent = text.find('%');
        before = text.substr(0, percent);
        if (percent == std::string_view::npos) return;
        const auto isDigit = [&](std::size_t i) { return i < text.size() && text[i] >= '0' && text[i] <= '9'; };
        std::size_t i = percent + 1;
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
            throw "a format that is not printed here";
        }
        if (zeros && conversion != 'x') throw "zeros before a sign are not printed here";
        after = text.substr(i + 1);
        const bool isPercent = after.starts_with("%%");  // stands for one
        if (isPercent) after.remove_prefix(1);
        if (after.find('%', isPercent ? 1 : 0) != std::string_view::npos) throw "one conversion a format";
    }
};

}  // namespace kelvo
