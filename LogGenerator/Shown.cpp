#include "LogGenerator/Shown.h"

#include <algorithm>
#include <bit>
#include <cmath>

namespace kelvo {

namespace {

std::int64_t numberOf(const Shown::Whole& way, std::int64_t raw) {
    return (way.sign == Shown::Sign::Signed ? static_cast<std::int32_t>(raw) : raw) * way.factor + way.summand;
}
double numberOf(const Shown::Linear& way, std::int64_t raw) {
    return static_cast<double>(raw) * way.scale + way.offset;
}
std::int64_t eighthsOf(const Shown::Eighths& way, std::int64_t raw) { return raw * way.factor + way.summand; }

/// Prints a raw value in each of the ways.
struct Print {
    std::string& text;
    const std::int64_t raw;

    void operator()(const Shown::Whole& way) const { way.format.print(text, numberOf(way, raw)); }
    void operator()(const Shown::Linear& way) const { way.format.print(text, numberOf(way, raw)); }
    void operator()(const Shown::Eighths& way) const { way.format.printEighths(text, eighthsOf(way, raw)); }
    void operator()(const Shown::Flag& way) const { text.assign(raw != 0 ? way.nonZero : way.zero); }
    void operator()(const Shown::Name& way) const {
        const auto value = static_cast<std::uint32_t>(raw);
        const bool isInPlace = value < way.rows.size() && way.rows[value].raw == value;  // a table without gaps
        const auto row = isInPlace ? way.rows.begin() + value : std::ranges::find(way.rows, value, &ValueRow::raw);
        if (row == way.rows.end()) return way.fallback.print(text, raw);
        text.assign(row->text);
    }
};

struct Measure {
    const std::int64_t raw;

    using Result = std::optional<Measurement>;
    static Result in(const Unit& unit, double number) { return Measurement{number, unit.symbol}; }

    Result operator()(const Shown::Whole& way) const {
        return in(way.format.unit, static_cast<double>(numberOf(way, raw)));
    }
    Result operator()(const Shown::Linear& way) const { return in(way.format.unit, numberOf(way, raw)); }
    Result operator()(const Shown::Eighths& way) const {
        return in(way.format.unit, static_cast<double>(eighthsOf(way, raw)) / 8);
    }
    Result operator()(const Shown::Name&) const { return std::nullopt; }
    Result operator()(const Shown::Flag&) const { return std::nullopt; }
};

}  // namespace

void Shown::print(std::string& text, std::int64_t raw) const {
    if (raw == _exception) {
        text.assign(_exceptionText.value_or(""));
    } else {
        std::visit(Print{text, raw}, _way);
    }
}

std::optional<Measurement> Shown::measure(std::int64_t raw) const {
    return raw != _exception ? std::visit(Measure{raw}, _way) : std::nullopt;
}

void ShownReal::print(std::string& text, std::int64_t raw) const { _format.print(text, std::bit_cast<double>(raw)); }

std::optional<Measurement> ShownReal::measure(std::int64_t raw) const {
    const auto number = std::bit_cast<double>(raw);
    return std::isfinite(number) ? Measure::in(_format.unit, number) : std::nullopt;
}

}  // namespace kelvo
