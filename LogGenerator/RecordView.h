#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>

#include "LogGenerator/ArrayOutOfBoundsException.h"
#include "platform/values/Bytes.h"
#include "platform/values/Reading.h"

namespace kelvo {

/// How a number lies in a record: 1 to 4 bytes, little-endian unless it says otherwise, or a range of their bits.
struct Raw {
    std::uint8_t bytes;
    bool isSigned = false;
    bool isBigEndian = false;
    std::uint8_t lowBit = 0;
    std::uint8_t width = static_cast<std::uint8_t>(bytes * 8);  ///< in bits

    /// Bits `low` to `high`, both included; bit 0 is the lowest of the (little-endian) number.
    constexpr Raw bits(int low, int high) const {
        return {bytes, isSigned, isBigEndian, static_cast<std::uint8_t>(low),
                static_cast<std::uint8_t>(high - low + 1)};
    }
    constexpr Raw bit(int at) const { return bits(at, at); }
    constexpr Raw bigEndian() const { return {bytes, isSigned, true, lowBit, width}; }
    constexpr int bitWidth() const { return width; }
    /// Where the number stands when its bytes begin at offset `at`.
    constexpr Place placeAt(std::size_t at) const { return {at, bytes, lowBit, width, isBigEndian}; }
};

inline constexpr Raw u8{1};
inline constexpr Raw u16{2};
inline constexpr Raw u32{4};
inline constexpr Raw i8{1, true};
inline constexpr Raw i16{2, true};
inline constexpr Raw i32{4, true};

/// Reads numbers from a record. Bytes past the record's end read as 0, so that no count or offset in it, however wrong,
/// leads outside the buffer. Borrows the bytes.
class RecordView {
public:
    constexpr explicit RecordView(ByteView record) : _record(record) {}

    std::size_t size() const { return _record.size(); }

    /// The number at offset `at`; a value of 32 unsigned bits is never negative.
    std::int64_t read(std::size_t at, Raw raw) const {
        std::uint32_t word = wordAt(at);
        if (raw.isBigEndian) word = swapped(word) >> (32 - 8 * raw.bytes);
        const int unused = 32 - raw.width;
        word = word >> raw.lowBit << unused;  // the number's bits alone, at the upper end
        return raw.isSigned ? std::int64_t{static_cast<std::int32_t>(word) >> unused} : std::int64_t{word >> unused};
    }
    /// How many entries the record says that it has.
    std::size_t count(std::size_t at, Raw raw) const { return static_cast<std::size_t>(read(at, raw)); }

private:
    std::uint32_t wordAt(std::size_t at) const {
        if (_record.size() < 4 || at > _record.size() - 4) return lastWordAt(at);
        const std::uint8_t* bytes = _record.data() + at;
        return bytes[0] | std::uint32_t{bytes[1]} << 8 | std::uint32_t{bytes[2]} << 16 | std::uint32_t{bytes[3]} << 24;
    }
    std::uint32_t lastWordAt(std::size_t at) const {
        std::uint32_t word = 0;
        for (std::size_t i = 0; i < 4; ++i) {
            // `at` may be so large that the sum wraps.
            if (at < _record.size() && i < _record.size() - at) word |= std::uint32_t{_record[at + i]} << (8 * i);
        }
        return word;
    }
    static constexpr std::uint32_t swapped(std::uint32_t word) {
        return word >> 24 | (word >> 8 & 0xFF00) | (word & 0xFF00) << 8 | word << 24;
    }

    ByteView _record;
};

/// The entries of a record's counted array, by index. The count is the record's own and trusted as such; entries may
/// lie beyond the record's end, where they read as 0.
class RecordEntries {
public:
    /// `count` entries, the first at offset `start` and each `stride` bytes after the one before.
    constexpr RecordEntries(std::size_t start, std::size_t stride, std::size_t count)
        : _start(start), _stride(stride), _count(count) {}

    std::size_t count() const { return _count; }
    /// The entries that begin inside a record of `size` bytes.
    RecordEntries within(std::size_t size) const {
        const std::size_t room = size > _start ? (size - _start + _stride - 1) / _stride : 0;
        return {_start, _stride, std::min(_count, room)};
    }
    /// The offset of entry `index`; throws ArrayOutOfBoundsException when the count does not cover it.
    std::size_t offsetOf(std::size_t index) const {
        if (index >= _count) throw ArrayOutOfBoundsException();
        return _start + _stride * index;
    }

private:
    std::size_t _start;
    std::size_t _stride;
    std::size_t _count;
};

}  // namespace kelvo
