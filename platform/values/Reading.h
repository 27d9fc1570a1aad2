#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace kelvo {

/// A number in its unit.
struct Measurement {
    double number = 0;
    std::string_view unit;  ///< its symbol: "dBm"; empty for a plain number
};

/// What the raw number of a record stands for. Quantities are static data; they outlive every value.
class Quantity {
public:
    /// Makes `text` what the screens show for `raw`.
    virtual void print(std::string& text, std::int64_t raw) const = 0;
    /// The number in its unit; none for a name, and for a raw value that stands for no number.
    virtual std::optional<Measurement> measure(std::int64_t raw) const = 0;

protected:
    ~Quantity() = default;
};

/// What a record reported.
struct Reading {
    std::int64_t raw;
    const Quantity* quantity;  ///< never null
    std::uint64_t record = 0;  ///< the number of the record that reported it last; 0 while nobody counts them
};

}  // namespace kelvo
