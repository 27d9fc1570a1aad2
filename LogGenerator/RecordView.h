#pragma once

#include <cstddef>
#include <cstdint>

#include "LogGenerator/ArrayOutOfBoundsException.h"
#include "platform/Bytes.h"

namespace kelvo {

/// How a number lies in a record: 1 to 4 bytes, little-endian unless it says otherwise, or a range of their bits.
struct Raw {
    std::uint8_t bytes;
    bool isSigned = false;
    bool isBigEndian = false;
    std::uint8_t lowBit = 0;
    std::uint8_t width = 0;  ///< in bits; 0 stands for all of them

    /// Bits `low` to `high`, both included; bit 0 is the lowest of the (little-endian) number.
    constexpr Raw bits(int low, int high) const {
        return {bytes, isSigned, isBigEndian, static_cast<std::uint8_t>(low),
                static_cast<std::uint8_t>(high - low + 1)};
    }
    constexpr Raw bit(int at) const { return bits(at, at); }
    constexpr Raw bigEndian() const { return {bytes, isSigned, true, lowBit, width}; }
    constexpr int bitWidth() const { return width != 0 ? width : bytes * 8; }
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
        std::uint32_t word = 0;
        if (at <= _record.size() && _record.size() - at >= raw.bytes) {
            for (std::size_t i = 0; i < raw.bytes; ++i) word |= byteOf(_record[at + i], i, raw);
        } else {
            for (std::size_t i = 0; i < raw.bytes; ++i) {
                if (at + i < _record.size()) word |= byteOf(_record[at + i], i, raw);
            }
        }
        const int width = raw.bitWidth();
        word >>= raw.lowBit;
        if (width < 32) word &= (std::uint32_t{1} << width) - 1;
        if (!raw.isSigned) return word;
        const int unused = 32 - width;
        return static_cast<std::int32_t>(word << unused) >> unused;
    }

private:
    static std::uint32_t byteOf(std::uint8_t byte, std::size_t index, Raw raw) {
        const std::size_t place = raw.isBigEndian ? raw.bytes - 1U - index : index;
        return std::uint32_t{byte} << (8 * place);
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
