#include "tools/share/RecordSharer.h"

#include <fmt/format.h>

#include <algorithm>

#include "LogGenerator/Framing.h"
#include "platform/encodings/PropertyList.h"
#include "telephony/wire/LittleEndian.h"
#include "tools/share/SharedPayloads.h"
#include "tools/share/SharedRecords.h"

namespace kelvo {

namespace {

using adaptation::Adapted;

constexpr std::size_t kLengthAt = 1;
constexpr std::size_t kTimestampAt = 5;
constexpr std::size_t kLongestRecord = 65'535;

/// A record that the adaptation refuses and screens show all the same: one that was cut, or an older version, or a
/// newer one's number on what has exactly the fixed layout's length.
bool isInFixedLayout(ByteView packet, adaptation::Refusal refusal) {
    const RecordView record(packet);
    const std::size_t size = packet.size() - kPayloadOffset;
    const std::int64_t version = record.read(kPayloadOffset, u8);
    switch (logCode(packet.data())) {
        case 0xB0C1: return version < 2 || size == 9;
        case 0xB0C2: return version < 3 || size == 25;
        case 0xB179: return version < 3;
        case 0xB17F: return version < 3 || size == 20;
        case 0xB180: return version < 4;
        default: return refusal == adaptation::Refusal::TooShort;
    }
}

void put(Bytes& bytes, std::size_t at, std::size_t count, std::uint64_t value) {
    for (std::size_t i = 0; i < count; ++i) bytes[at + i] = static_cast<std::uint8_t>(value >> 8 * i);
}

}  // namespace

std::optional<ByteView> RecordSharer::leftOut(std::string_view why) {
    _replacer.tally().removed(why);
    return std::nullopt;
}

std::optional<ByteView> RecordSharer::share(ByteView message, Technology technology) {
    return hasCodes(technology) ? shareRecord(message) : shareTree(message);
}

std::optional<ByteView> RecordSharer::shareRecord(ByteView message) {
    const ByteView packet = stripPrefix(message);
    if (packet.size() < kMinimumMessageSize || packet.size() > kLongestRecord + 1) {
        return leftOut("message that is no record");
    }
    const Adapted adapted = _adapter->adapt(packet);
    if (adapted.outcome == Adapted::Outcome::Refused && !isInFixedLayout(packet, adapted.refusal)) {
        if (adapted.refusal == adaptation::Refusal::NotOurs)
            return leftOut("record of a code that Kelvo does not know");
        return leftOut("record in a layout that Kelvo cannot read");
    }
    if (logCode(packet.data()) >= kExtendedLogCodes) {
        if (!sharePhoneRecord(packet)) return leftOut("record of the phone that Kelvo cannot read");
    } else {
        const SharedRecord* layout = sharedRecord(logCode(adapted.packet.data()));
        if (layout == nullptr) return leftOut("record of a code that Kelvo does not know");
        RecordCopy copy(adapted.packet, _made, _replacer);
        copy.take(layout->fields);
        if (layout->lists != nullptr) layout->lists(copy);
    }
    put(_made, kLengthAt, 2, _made.size() - 1);
    put(_made, kTimestampAt, 8, _times.modem(wire::u64At(packet, kTimestampAt)));
    if (message.size() == packet.size()) return _made;
    // Of the prefix it is known only that it is there.
    _message.assign({0x81, 0});
    _message.insert(_message.end(), _made.begin(), _made.end());
    return _message;
}

bool RecordSharer::sharePhoneRecord(ByteView packet) {
    const auto payload = sharedPayload(_replacer, logCode(packet.data()), payloadOf(packet));
    if (!payload || payload->size() > kLongestRecord - (kPayloadOffset - 1)) return false;
    _made.assign(packet.begin(), packet.begin() + kPayloadOffset);
    _made.insert(_made.end(), payload->begin(), payload->end());
    return true;
}

std::optional<ByteView> RecordSharer::shareTree(ByteView message) {
    const Result<Value> tree = readPropertyList(message);
    const Value shared = tree ? sharedTree(_replacer, *tree) : Value();
    const Result<Bytes> bytes = shared ? writeXmlPropertyList(shared) : Result<Bytes>(Failure{"no tree"});
    if (!bytes) return leftOut("message that is no cell monitor's tree");
    _message = *bytes;
    return _message;
}

}  // namespace kelvo
