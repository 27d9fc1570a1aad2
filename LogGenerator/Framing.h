#pragma once

#include "LogGenerator/LogCode.h"
#include "platform/values/Bytes.h"

/// How a diagnostic log packet is wrapped. All multi-byte fields are little-endian. A message is an optional prefix of
/// two bytes, the first of them 0x81, and the packet:
///
///     offset  width  field
///          0      1  log type: 1 ordinary, 255 extended
///          1      2  record length, counted from offset 1 to the packet's end; carried, not checked
///          3      2  log code
///          5      8  the baseband's timestamp; carried, not interpreted
///         13         payload
namespace kelvo {

inline constexpr std::size_t kMinimumMessageSize = 13;  ///< shorter messages are no packets
inline constexpr std::size_t kPayloadOffset = 13;

/// The packet of a message: the message itself, without its first two bytes when it begins with 0x81.
inline ByteView stripPrefix(ByteView message) {
    if (message.empty() || message.front() != 0x81) return message;
    return message.subspan(message.size() < 2 ? message.size() : 2);
}

/// The log code of a packet of at least 5 bytes, with 0xff0000 or'ed in for type 255.
inline LogCode logCode(const std::uint8_t* packet) {
    const LogCode code = packet[3] | static_cast<LogCode>(packet[4]) << 8;
    return packet[0] >= 255 ? code | kExtendedLogCodes : code;
}

/// What follows a packet's header.
inline ByteView payloadOf(ByteView packet) {
    return packet.size() > kPayloadOffset ? packet.subspan(kPayloadOffset) : ByteView();
}

}  // namespace kelvo
