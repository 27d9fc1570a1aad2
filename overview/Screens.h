#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "platform/values/Value.h"

namespace kelvo::overview {

/// A value of the screens that measures something.
struct Figure {
    std::string text;          ///< as the screens show it: "-95.25 dBm"
    double number = 0;         ///< in the unit
    std::string unit;          ///< its symbol; empty for a plain number
    std::uint64_t record = 0;  ///< which wrote it last
};

/// The values of one display by the names under which the screens show them, parts separated by "/":
/// "Serving Cell Info/Physical Cell ID". What no record has written yet is not there.
/// The display outlives the reader.
class Screens {
public:
    explicit Screens(const Value& display) : _display(display) {}

    /// The list or the group of that name; a none value when there is none.
    const Value& at(std::string_view path) const;
    /// Empty when it is not there.
    std::string text(std::string_view path) const;
    /// A text that is a whole number as well.
    std::optional<std::int64_t> whole(std::string_view path) const;
    std::optional<Figure> figure(std::string_view path) const;
    /// The number of the record that wrote the value, or the newest value of the group; 0 for none.
    std::uint64_t record(std::string_view path) const;

private:
    const Value& _display;
};

/// As `Screens::figure`, of a value in hand.
std::optional<Figure> figureOf(const Value& value);

}  // namespace kelvo::overview
