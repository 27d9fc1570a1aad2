#pragma once

#include "tests/support/Record.h"

namespace kelvo::test {

/// Builds a packet of sub-packets: `add` begins the next one, `u8` and `u16` write into it by its own offsets.
class Subpackets {
public:
    explicit Subpackets(LogCode code) : _record(code, 17) {}

    Subpackets& add(std::uint32_t id, std::uint32_t size) {
        _begin = _record.bytes().size();
        _record.u8(14, ++_count).u8(_begin, id).u16(_begin + 2, size).u8(_begin + size - 1, 0);
        return *this;
    }
    Subpackets& u8(std::size_t at, std::uint32_t value) {
        _record.u8(_begin + at, value);
        return *this;
    }
    Subpackets& u16(std::size_t at, std::uint32_t value) {
        _record.u16(_begin + at, value);
        return *this;
    }
    operator const Record&() const { return _record; }
    const Bytes& bytes() const { return _record.bytes(); }

private:
    Record _record;
    std::uint32_t _count = 0;
    std::size_t _begin = 17;
};

}  // namespace kelvo::test
