#include "LogGenerator/IFX/NumberInText.h"

#include <algorithm>
#include <array>
#include <bit>
#include <charconv>
#include <cstdint>
#include <string>

#include "LogGenerator/Shown.h"

namespace kelvo {

namespace {

constexpr std::size_t kMostDigits = 15;  // a double keeps all of them

// clang-format off
constexpr std::array kUnits = {
    Unit{},
    Unit{"dBm",    " dBm"},    Unit{"dBm",    "dBm"},
    Unit{"dB",     " dB"},     Unit{"dB",     "dB"},
    Unit{"%",      " %"},      Unit{"%",      "%"},
    Unit{"kbit/s", " kbit/s"}, Unit{"Mbit/s", " Mbit/s"}, Unit{"kbps", " kbps"}, Unit{"Mbps", " Mbps"},
    Unit{"kHz",    " kHz"},    Unit{"MHz",    " MHz"},
    Unit{"s",      " s"},      Unit{"ms",     " ms"},     Unit{"m",    " m"},    Unit{"km",   " km"},
};
// clang-format on

/// The ways in which numbers of one unit are written.
struct Ways {
    Shown whole;
    Shown signedWhole;
    std::array<ShownReal, 3> real;  ///< with one, two and three decimals
    std::array<ShownReal, 3> signedReal;

    constexpr explicit Ways(Unit unit)
        : whole(kelvo::whole(1, 0, unit)),
          signedWhole(kelvo::whole(1, 0, unit, "%+d")),
          real{ShownReal("%.1f", unit), ShownReal("%.2f", unit), ShownReal("%.3f", unit)},
          signedReal{ShownReal("%+.1f", unit), ShownReal("%+.2f", unit), ShownReal("%+.3f", unit)} {}
};

template <std::size_t... unit>
constexpr std::array<Ways, sizeof...(unit)> waysOf(std::index_sequence<unit...>) {
    return {Ways(kUnits[unit])...};
}
constexpr auto kWays = waysOf(std::make_index_sequence<kUnits.size()>());

constexpr bool isDigit(char c) { return c >= '0' && c <= '9'; }

/// How many digits `text` begins with.
std::size_t digitsIn(std::string_view text) {
    return static_cast<std::size_t>(std::ranges::find_if_not(text, isDigit) - text.begin());
}

template <class NumberType>
NumberType parsed(std::string_view number) {
    NumberType value{};
    std::from_chars(number.data(), number.data() + number.size(), value);
    return value;
}

}  // namespace

std::optional<Reading> numberInText(std::string_view text) {
    const bool hasPlus = text.starts_with('+');
    const std::string_view signedText = text.substr(hasPlus ? 1 : 0);  // from_chars takes no plus
    const std::string_view unsignedText = signedText.substr(!hasPlus && signedText.starts_with('-') ? 1 : 0);
    const std::size_t digits = digitsIn(unsignedText);
    std::string_view rest = unsignedText.substr(digits);
    const std::size_t decimals = rest.starts_with('.') ? digitsIn(rest.substr(1)) : 0;
    if (digits == 0 || digits + decimals > kMostDigits || decimals > kWays[0].real.size()) return std::nullopt;
    if (decimals > 0) rest.remove_prefix(1 + decimals);
    const auto unit = std::ranges::find(kUnits, rest, &Unit::written);
    if (unit == kUnits.end()) return std::nullopt;

    const Ways& ways = kWays[static_cast<std::size_t>(unit - kUnits.begin())];
    const std::string_view number = signedText.substr(0, signedText.size() - rest.size());
    Reading reading{};
    if (decimals > 0) {
        reading.raw = std::bit_cast<std::int64_t>(parsed<double>(number));
        reading.quantity = &(hasPlus ? ways.signedReal : ways.real)[decimals - 1];
    } else {
        reading.raw = parsed<std::int64_t>(number);
        reading.quantity = &(hasPlus ? ways.signedWhole : ways.whole);
    }
    std::string printed;
    reading.quantity->print(printed, reading.raw);
    if (printed != text) return std::nullopt;  // "01" stays what it is
    return reading;
}

}  // namespace kelvo
