#pragma once

#include <cstdint>

#include "platform/values/Bytes.h"
#include "platform/values/Value.h"
#include "telephony/simulation/Time.h"

namespace kelvo::simulation {

/// Builds one log record as the modem's log service writes it: the 2-byte prefix that begins with 0x81, the 13-byte
/// header and the payload, little-endian. Offsets count from the log type byte, which follows the prefix. A record
/// grows to what is written to it; bytes in between are zero. Values are cut to their width.
class RecordWriter {
public:
    /// A record of `length` bytes, header included, taken at `time`. `code` is 16 bits wide, or 0xff0000 and more for
    /// an extended record (log type 255).
    RecordWriter(Time time, std::uint32_t code, std::size_t length = kHeader);

    static constexpr std::size_t kHeader = 13;

    RecordWriter& u8(std::size_t at, std::uint64_t value) { return put(at, value, 1); }
    RecordWriter& u16(std::size_t at, std::uint64_t value) { return put(at, value, 2); }
    RecordWriter& u32(std::size_t at, std::uint64_t value) { return put(at, value, 4); }
    RecordWriter& i8(std::size_t at, std::int64_t value) { return put(at, static_cast<std::uint64_t>(value), 1); }
    RecordWriter& i16(std::size_t at, std::int64_t value) { return put(at, static_cast<std::uint64_t>(value), 2); }
    RecordWriter& i32(std::size_t at, std::int64_t value) { return put(at, static_cast<std::uint64_t>(value), 4); }
    RecordWriter& bytes(std::size_t at, ByteView value);

    std::size_t size() const { return _bytes.size() - kPrefix; }
    /// The whole message, with its length filled in.
    Bytes finish() const;

private:
    static constexpr std::size_t kPrefix = 2;
    RecordWriter& put(std::size_t at, std::uint64_t value, int width);

    Bytes _bytes;
};

/// An extended record whose payload is `payload` as a property list.
Bytes propertyListRecord(Time time, std::uint32_t code, const Value& payload);

}  // namespace kelvo::simulation
