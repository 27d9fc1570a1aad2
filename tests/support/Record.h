#pragma once

#include <cstdint>
#include <string_view>

#include "LogGenerator/LogCode.h"
#include "platform/values/Bytes.h"

namespace kelvo::test {

/// Builds one packet by offsets from the log type byte. Everything that is not written is zero; writing past the end
/// makes the packet longer.
class Record {
public:
    /// A packet of `size` bytes; the header's type, record length and code follow from `code` and `size`.
    Record(LogCode code, std::size_t size) : _bytes(size), _code(code) {
        put(0, code >= kExtendedLogCodes ? 255 : 1, 1);
        put(1, static_cast<std::uint32_t>(size - 1), 2);
        put(3, code & 0xffff, 2);
    }

    Record& u8(std::size_t at, std::uint32_t value) { return grow(at, value, 1); }
    Record& u16(std::size_t at, std::uint32_t value) { return grow(at, value, 2); }
    Record& u32(std::size_t at, std::uint32_t value) { return grow(at, value, 4); }
    Record& text(std::size_t at, std::string_view text) {
        for (char c : text) grow(at++, static_cast<std::uint8_t>(c), 1);
        return *this;
    }

    const Bytes& bytes() const { return _bytes; }
    LogCode code() const { return _code; }
    /// The first `size` bytes alone, the header's record length as it was.
    Bytes cut(std::size_t size) const { return {_bytes.begin(), _bytes.begin() + static_cast<std::ptrdiff_t>(size)}; }

private:
    Record& grow(std::size_t at, std::uint32_t value, std::size_t width) {
        if (_bytes.size() < at + width) _bytes.resize(at + width);
        put(at, value, width);
        return *this;
    }
    void put(std::size_t at, std::uint32_t value, std::size_t width) {
        for (std::size_t i = 0; i < width && at + i < _bytes.size(); ++i) {
            _bytes[at + i] = static_cast<std::uint8_t>(value >> (8 * i));
        }
    }

    Bytes _bytes;
    LogCode _code;
};

}  // namespace kelvo::test
