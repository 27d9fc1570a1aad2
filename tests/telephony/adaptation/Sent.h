#pragma once

#include <cstdint>
#include <string>

#include "platform/values/Bytes.h"
#include "telephony/adaptation/RecordAdapter.h"
#include "tests/support/Record.h"

namespace kelvo::test {

/// A record as a modem sends it, built by offsets in its payload; everything that is not written is zero.
class Sent {
public:
    Sent(LogCode code, std::size_t payloadSize) : _record(code, kHeader + payloadSize) {
        _record.u32(5, 0x89ABCDEF).u32(9, 0x01234567);  // the timestamp
    }

    Sent& u8(std::size_t at, std::uint32_t value) { return _record.u8(kHeader + at, value), *this; }
    Sent& u16(std::size_t at, std::uint32_t value) { return _record.u16(kHeader + at, value), *this; }
    Sent& u32(std::size_t at, std::uint32_t value) { return _record.u32(kHeader + at, value), *this; }
    /// Bits `low` to `high` of the little-endian word at `at`.
    Sent& bits(std::size_t at, int low, int high, std::uint32_t value) {
        for (int bit = low; bit <= high; ++bit) {
            const std::size_t byte = at + static_cast<std::size_t>(bit) / 8;
            const std::uint32_t mask = 1U << (bit % 8);
            const std::uint32_t old = _record.bytes().at(kHeader + byte);
            u8(byte, (value >> (bit - low) & 1) != 0 ? old | mask : old & ~mask);
        }
        return *this;
    }
    const Bytes& bytes() const { return _record.bytes(); }

private:
    static constexpr std::size_t kHeader = 13;
    Record _record;
};

/// What an adapter makes of records, one after the other.
class Adapter {
public:
    /// The record made, in hexadecimal; "passed" when it is the one given, and why it is refused.
    std::string operator()(const Sent& sent) {
        last = _adapter.adapt(sent.bytes());
        switch (last.outcome) {
            case adaptation::Adapted::Outcome::Passed:
                return last.packet.data() == sent.bytes().data() && last.packet.size() == sent.bytes().size()
                           ? "passed"
                           : "passed, but not as it was";
            case adaptation::Adapted::Outcome::Turned: return hex(last.packet);
            case adaptation::Adapted::Outcome::Refused: break;
        }
        return adaptation::describe(last.kind) + ": " + adaptation::reasonOf(last.refusal);
    }
    static std::string hex(ByteView bytes) {
        std::string text;
        for (const std::uint8_t byte : bytes) {
            text += "0123456789abcdef"[byte >> 4];
            text += "0123456789abcdef"[byte & 15];
        }
        return text;
    }

    adaptation::Adapted last;

private:
    adaptation::RecordAdapter _adapter;
};

/// What a record that was turned should be.
inline std::string is(const Sent& sent) { return Adapter::hex(sent.bytes()); }

}  // namespace kelvo::test
