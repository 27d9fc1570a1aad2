#pragma once

#include <array>
#include <cstdint>
#include <limits>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <type_traits>
#include <variant>

#include "LogGenerator/NumberFormat.h"
#include "platform/values/Reading.h"

namespace kelvo {

/// One row of a value table.
struct ValueRow {
    std::uint32_t raw;
    std::string_view text;
};

/// Names for raw values; any other value shows the fallback, which may hold a "%d" for the value.
template <std::size_t N>
struct ValueTable {
    std::array<ValueRow, N> rows;
    NumberFormat fallback;

    consteval ValueTable(const ValueRow (&list)[N], const char* fallbackFormat)
        : rows(std::to_array(list)), fallback(fallbackFormat) {}
};

/// How the raw value of a field becomes the text on the screen, and which number it stands for: one of these ways, with
/// at most one raw value that is an exception.
class Shown final : public Quantity {
public:
    enum class Sign { NotSaid, Signed, Unsigned };

    /// raw x factor + summand, in whole numbers.
    struct Whole {
        NumberFormat format;
        Sign sign = Sign::NotSaid;  ///< of 32 bits
        std::int64_t factor = 1;
        std::int64_t summand = 0;
    };
    /// raw x scale + offset, in double precision.
    struct Linear {
        NumberFormat format;
        double scale;
        double offset;
    };
    /// (raw x factor + summand) / 8: a Linear in steps of an eighth, the common case, prints exactly from whole
    /// numbers.
    struct Eighths {
        NumberFormat format;
        std::int64_t factor;
        std::int64_t summand;
    };
    /// The name in a value table.
    struct Name {
        std::span<const ValueRow> rows;
        NumberFormat fallback;
    };
    /// One text for zero and another for everything else.
    struct Flag {
        std::string_view nonZero;
        std::string_view zero;
    };
    using Way = std::variant<Whole, Linear, Eighths, Name, Flag>;

    template <class OneWay>
    requires std::is_constructible_v<Way, OneWay>
    constexpr Shown(OneWay way) : _way(way) {}

    /// Shows `text` when the raw value equals `raw`.
    constexpr Shown unless(std::int64_t raw, std::string_view text) const { return {_way, raw, text}; }
    /// Leaves the key out when the raw value equals `raw`.
    constexpr Shown absentAt(std::int64_t raw) const { return {_way, raw, std::nullopt}; }

    constexpr bool leavesOut(std::int64_t raw) const { return raw == _exception && !_exceptionText; }
    constexpr bool saysNoSign() const {
        const auto* whole = std::get_if<Whole>(&_way);
        return whole != nullptr && whole->sign == Sign::NotSaid;
    }

    void print(std::string& text, std::int64_t raw) const override;
    std::optional<Measurement> measure(std::int64_t raw) const override;

private:
    constexpr Shown(Way way, std::int64_t exception, std::optional<std::string_view> text)
        : _way(way), _exception(exception), _exceptionText(text) {}

    Way _way;
    std::int64_t _exception = std::numeric_limits<std::int64_t>::min();  // no raw value is that
    std::optional<std::string_view> _exceptionText{};
};

/// "%d"; for 32 unsigned bits say `asSigned` or `asUnsigned`.
inline constexpr Shown decimal = Shown::Whole{"%d"};
/// Unsigned 32 bits printed as a signed number.
inline constexpr Shown asSigned = Shown::Whole{"%d", Shown::Sign::Signed};
/// Printed as an unsigned number.
inline constexpr Shown asUnsigned = Shown::Whole{"%u", Shown::Sign::Unsigned};

/// Printed in base 16, as the format's "%x" says.
constexpr Shown hexadecimal(const char* format) { return Shown::Whole{format, Shown::Sign::Unsigned}; }

/// The value's name.
template <std::size_t N>
constexpr Shown label(const ValueTable<N>& table) {
    return Shown::Name{table.rows, table.fallback};
}

/// One text for zero and another for everything else.
constexpr Shown flag(std::string_view nonZero, std::string_view zero) { return Shown::Flag{nonZero, zero}; }

/// raw x factor + summand, in whole numbers.
constexpr Shown whole(std::int64_t factor, std::int64_t summand, Unit unit, const char* format = "%d") {
    return Shown::Whole{{format, unit}, Shown::Sign::NotSaid, factor, summand};
}

/// raw x scale + offset, in double precision.
constexpr Shown linear(double scale, double offset, const char* format, Unit unit = {}) {
    const NumberFormat number(format, unit);
    const auto factor = static_cast<int>(scale * 8);
    const auto summand = static_cast<int>(offset * 8);
    const bool inEighths = factor == scale * 8 && summand == offset * 8 && number.precision >= 2;
    return inEighths ? Shown(Shown::Eighths{number, factor, summand}) : Shown(Shown::Linear{number, scale, offset});
}

/// A real number that a decoder has worked out; the raw value is the double's bits.
class ShownReal final : public Quantity {
public:
    constexpr ShownReal(const char* format, Unit unit) : _format(format, unit) {}

    void print(std::string& text, std::int64_t raw) const override;
    /// None for an infinity and for not-a-number.
    std::optional<Measurement> measure(std::int64_t raw) const override;

private:
    NumberFormat _format;
};

}  // namespace kelvo
