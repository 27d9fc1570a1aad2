#include "LogGenerator/NumberFormat.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstring>

namespace kelvo {

namespace {

/// A text under construction on the stack; longer than any number with the texts around it.
class Line {
public:
    void append(std::string_view text) {
        const std::size_t length = std::min(text.size(), room());
        _end = std::copy_n(text.data(), length, _end);
    }
    void append(char c) { append(std::string_view(&c, 1)); }
    template <class... How>
    void appendNumber(How... how) {
        _end = std::to_chars(_end, _text.data() + _text.size(), how...).ptr;
    }
    /// Pads what was written since `from` on its left.
    void padSince(std::size_t from, int width, char filler) {
        const std::size_t length = size() - from;
        if (length >= static_cast<std::size_t>(width)) return;
        const std::size_t missing = std::min(static_cast<std::size_t>(width) - length, room());
        std::memmove(_text.data() + from + missing, _text.data() + from, length);
        std::memset(_text.data() + from, filler, missing);
        _end += missing;
    }
    std::size_t size() const { return static_cast<std::size_t>(_end - _text.data()); }
    std::string_view text() const { return {_text.data(), size()}; }

private:
    std::size_t room() const { return _text.size() - size(); }

    std::array<char, 512> _text;  // a double without an exponent takes at most 309 digits before its point
    char* _end = _text.data();
};

template <class Digits>
void printBetween(std::string& text, const NumberFormat& format, bool negative, Digits digits) {
    Line line;
    line.append(format.before);
    const std::size_t from = line.size();
    if (format.plus && !negative) line.append('+');
    digits(line);
    line.padSince(from, format.width, format.zeros ? '0' : ' ');
    line.append(format.unit.written);
    line.append(format.after);
    text.assign(line.text());
}

/// The decimals of 0 to 7 eighths. With two of them 1/8 is 12.5 hundredths; the half goes to the even neighbor, as
/// printf rounds, and never past the next whole number.
constexpr std::string_view kHundredths[] = {"00", "12", "25", "38", "50", "62", "75", "88"};
constexpr std::string_view kThousandths[] = {"000", "125", "250", "375", "500", "625", "750", "875"};

}  // namespace

void NumberFormat::print(std::string& text, std::int64_t number) const {
    if (conversion == 0) {
        text.assign(before);
    } else if (conversion == 'x') {
        printBetween(text, *this, false,
                     [number](Line& line) { line.appendNumber(static_cast<std::uint64_t>(number), 16); });
    } else {
        printBetween(text, *this, number < 0, [number](Line& line) { line.appendNumber(number); });
    }
}

void NumberFormat::print(std::string& text, double number) const {
    printBetween(text, *this, std::signbit(number),
                 [&](Line& line) { line.appendNumber(number, std::chars_format::fixed, precision); });
}

void NumberFormat::printEighths(std::string& text, std::int64_t eighths) const {
    const auto magnitude = static_cast<std::uint64_t>(eighths < 0 ? -eighths : eighths);
    printBetween(text, *this, eighths < 0, [&](Line& line) {
        if (eighths < 0) line.append('-');
        line.appendNumber(magnitude / 8);
        line.append('.');
        line.append(precision == 2 ? kHundredths[magnitude % 8] : kThousandths[magnitude % 8]);
        for (int i = 3; i < precision; ++i) line.append('0');
    });
}

}  // namespace kelvo
