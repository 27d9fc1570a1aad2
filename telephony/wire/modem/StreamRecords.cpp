#include "telephony/wire/modem/StreamRecords.h"

#include "LogGenerator/Framing.h"

namespace kelvo::modem {
namespace {

constexpr std::uint8_t kOrdinary = 1;     // the log type
constexpr std::size_t kLongest = 0xFFFF;  // a record says its length in 16 bits

}  // namespace

std::optional<ModemRecord> StreamRecords::next() {
    while (const auto packet = _stream->next()) {
        if (!_first) _first = packet->time;
        const ByteView stripped = stripPrefix(packet->bytes);
        if (stripped.size() < kPayloadOffset || stripped[0] != kOrdinary || stripped.size() - 1 > kLongest) continue;
        _record.assign(stripped.begin() + 1, stripped.end());
        _record[0] = static_cast<std::uint8_t>(_record.size());
        _record[1] = static_cast<std::uint8_t>(_record.size() >> 8);
        return ModemRecord{packet->time - *_first, _record};
    }
    return std::nullopt;
}

}  // namespace kelvo::modem
