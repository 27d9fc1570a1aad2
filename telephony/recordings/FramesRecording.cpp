#include "telephony/recordings/FramesRecording.h"

#include "telephony/wire/Protocol.h"
#include "telephony/wire/RecordFrame.h"
#include "telephony/wire/Wrapper.h"

namespace kelvo {

namespace {

bool isCommand(wire::MutableBytes body, wire::Command command) {
    return !body.empty() && body.front() == static_cast<std::uint8_t>(command);
}

/// What lies in a wrapper, or the body itself.
wire::Wrapped opened(wire::MutableBytes body, std::optional<std::int32_t>& subscription) {
    const auto wrapped = wire::unwrap(body);
    if (!wrapped) return {.body = body};
    subscription = wrapped->subscription;
    return *wrapped;
}

}  // namespace

std::optional<FramedRecord> framedRecord(wire::MutableBytes body) {
    FramedRecord record;
    const wire::MutableBytes inner = opened(body, record.subscription).body;
    if (!isCommand(inner, wire::Command::Record)) return std::nullopt;
    const auto parsed = wire::parseRecord(inner);
    if (!parsed) return std::nullopt;
    record.timestamp = parsed->timestamp;
    record.packet = wire::packetOf(inner);
    return record;
}

FramesRecording::FramesRecording(RecordingFile file) : _file(std::move(file)) {}

Result<std::optional<RecordedMessage>> FramesRecording::next() {
    for (;;) {
        while (const auto body = _frames.next(_input)) {
            if (const auto record = recordOf(*body)) return record;
        }
        const auto got = _file.read(*_piece);
        if (!got) return got.error();
        if (*got == 0) return std::optional<RecordedMessage>();
        _input = wire::MutableBytes(_piece->data(), *got);
    }
}

std::optional<RecordedMessage> FramesRecording::recordOf(wire::MutableBytes body) {
    if (const auto record = framedRecord(body)) {
        return RecordedMessage{record->packet, wire::timeOf(record->timestamp), record->subscription};
    }
    std::optional<std::int32_t> subscription;
    const wire::MutableBytes inner = opened(body, subscription).body;
    if (isCommand(inner, wire::Command::Record)) ++_lyingLengths;
    if (isCommand(inner, wire::Command::EncryptedRecord)) ++_encrypted;
    return std::nullopt;
}

RecordingDamage FramesRecording::damage() const {
    return {.damagedFrames = _frames.counts().damaged() + _lyingLengths,
            .encryptedRecords = _encrypted,
            .isCut = _file.isCut()};
}

}  // namespace kelvo
