#pragma once

#include <cstddef>
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

/// Where in its record a number stands: `bytes` bytes from offset `at` on, and of the number that they make, bits
/// `lowBit` to `lowBit + bits - 1`; bit 0 is the lowest. Eight bytes, since every value has one.
class Place {
public:
    constexpr Place() = default;
    constexpr Place(std::size_t at, int bytes, int lowBit, int bits, bool isBigEndian)
        : _packed(static_cast<std::uint32_t>(at) | static_cast<std::uint64_t>(bytes) << 32 |
                  static_cast<std::uint64_t>(lowBit) << 40 | static_cast<std::uint64_t>(bits) << 48 |
                  static_cast<std::uint64_t>(isBigEndian) << 56) {}

    /// False for a number that no single field holds.
    explicit constexpr operator bool() const { return _packed != 0; }
    /// Counted from the record's log type byte; may lie past the record's end.
    constexpr std::uint32_t at() const { return static_cast<std::uint32_t>(_packed); }
    constexpr int bytes() const { return _packed >> 32 & 0xFF; }
    constexpr int lowBit() const { return _packed >> 40 & 0xFF; }
    constexpr int bits() const { return _packed >> 48 & 0xFF; }
    constexpr bool isBigEndian() const { return _packed >> 56 != 0; }

    /// The same place in an entry that begins at offset `base`.
    constexpr Place from(std::size_t base) const {
        Place place = *this;
        place._packed += base;
        return place;
    }
    friend constexpr bool operator==(const Place&, const Place&) = default;

private:
    std::uint64_t _packed = 0;
};

/// What a record reported.
struct Reading {
    std::int64_t raw;
    const Quantity* quantity;  ///< never null
    Place place = {};
};

}  // namespace kelvo
