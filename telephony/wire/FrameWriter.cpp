#include "telephony/wire/FrameWriter.h"

#include "telephony/wire/Checksum.h"

namespace kelvo::wire {
namespace {

void appendEscaped(Bytes& to, std::uint8_t byte) {
    if (byte == kFrameEnd || byte == kEscape) {
        to.push_back(kEscape);
        byte ^= kEscapeBit;
    }
    to.push_back(byte);
}

}  // namespace

void appendFrame(Bytes& to, ByteView body) {
    const std::uint16_t crc = checksum(body);
    for (const std::uint8_t byte : body) appendEscaped(to, byte);
    appendEscaped(to, static_cast<std::uint8_t>(crc));
    appendEscaped(to, static_cast<std::uint8_t>(crc >> 8));
    to.push_back(kFrameEnd);
}

Bytes frameOf(ByteView body) {
    Bytes frame;
    frame.reserve(body.size() + body.size() / 16 + 8);
    appendFrame(frame, body);
    return frame;
}

}  // namespace kelvo::wire
