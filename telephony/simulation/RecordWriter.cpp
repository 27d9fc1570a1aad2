#include "telephony/simulation/RecordWriter.h"

#include <algorithm>

#include "platform/encodings/PropertyList.h"

namespace kelvo::simulation {
namespace {

constexpr std::uint8_t kPrefixMark = 0x81;
constexpr std::uint32_t kExtended = 0xff0000;
// The modem counts CDMA system time (3GPP2 C.S0005): units of 1.25 ms since 1980-01-06, here in the upper 48 bits.
constexpr std::chrono::sys_seconds kEpoch{std::chrono::seconds(315'964'800)};
using ModemUnits = std::chrono::duration<std::uint64_t, std::ratio<1, 800>>;

std::uint64_t modemTime(Time time) {
    return std::chrono::duration_cast<ModemUnits>(kDriveStart - kEpoch + time).count() << 16;
}

}  // namespace

RecordWriter::RecordWriter(Time time, std::uint32_t code, std::size_t length)
    : _bytes(kPrefix + std::max(length, kHeader)) {
    _bytes[0] = kPrefixMark;
    u8(0, code >= kExtended ? 255 : 1).u16(3, code).put(5, modemTime(time), 8);
}

RecordWriter& RecordWriter::bytes(std::size_t at, ByteView value) {
    if (_bytes.size() < kPrefix + at + value.size()) _bytes.resize(kPrefix + at + value.size());
    std::ranges::copy(value, _bytes.begin() + static_cast<std::ptrdiff_t>(kPrefix + at));
    return *this;
}

RecordWriter& RecordWriter::put(std::size_t at, std::uint64_t value, int width) {
    std::uint8_t little[8];
    for (int i = 0; i < width; ++i) little[i] = static_cast<std::uint8_t>(value >> (8 * i));
    return bytes(at, ByteView(little, static_cast<std::size_t>(width)));
}

Bytes RecordWriter::finish() const {
    RecordWriter whole = *this;
    whole.u16(1, size() - 1);  // counts from offset 1
    return std::move(whole._bytes);
}

Bytes propertyListRecord(Time time, std::uint32_t code, const Value& payload) {
    RecordWriter record(time, code);
    if (const auto encoded = writeXmlPropertyList(payload)) record.bytes(RecordWriter::kHeader, *encoded);
    return record.finish();
}

}  // namespace kelvo::simulation
