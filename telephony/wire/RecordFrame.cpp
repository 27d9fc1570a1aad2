#include "telephony/wire/RecordFrame.h"

#include "telephony/wire/LittleEndian.h"
#include "telephony/wire/Protocol.h"

namespace kelvo::wire {
namespace {

constexpr std::size_t kRecordAt = 4;
constexpr std::size_t kRecordHeader = 12;
constexpr std::uint8_t kOrdinary = 1;  // a packet's type

}  // namespace

std::optional<RecordFrame> parseRecord(ByteView body) {
    if (body.size() < kRecordAt + kRecordHeader) return std::nullopt;
    const std::size_t length = u16At(body, 2);
    if (length != u16At(body, 4) || length + kRecordAt != body.size()) return std::nullopt;
    return RecordFrame{body[1], u16At(body, 6), u64At(body, 8), body.subspan(kRecordAt)};
}

ByteView packetOf(MutableBytes body) {
    body[kRecordAt - 1] = kOrdinary;
    return body.subspan(kRecordAt - 1);
}

Bytes recordBody(std::uint8_t waiting, ByteView record) {
    Bytes body;
    body.reserve(kRecordAt + record.size());
    body.assign({static_cast<std::uint8_t>(Command::Record), waiting});
    append16(body, static_cast<std::uint16_t>(record.size()));
    body.insert(body.end(), record.begin(), record.end());
    return body;
}

}  // namespace kelvo::wire
