#pragma once

#include <cstdint>

#include "platform/values/Bytes.h"
#include "platform/values/Result.h"

namespace kelvo {

/// What stands before the data of every datagram between two ports, in the machine's byte order: both ends run on it.
struct PortHeader {
    static constexpr std::uint32_t kMagic = 0x314B'4C56;  ///< the format and its version
    enum Kind : std::uint8_t { Message = 1, Reply = 2 };
    enum Flags : std::uint8_t { NoFlags = 0, WantsReply = 1 };

    std::uint32_t magic = kMagic;
    std::uint8_t kind = Message;
    std::uint8_t flags = NoFlags;
    std::uint16_t reserved = 0;
    std::int32_t id = 0;
    std::uint32_t sequence = 0;  ///< the sender counts its requests; a reply carries the number of its request
    std::uint32_t length = 0;    ///< bytes of data that follow: the rest of the datagram
};
static_assert(sizeof(PortHeader) == 20);

/// One datagram, taken apart.
struct PortDatagram {
    PortHeader header;
    ByteView data;  ///< the rest of the datagram
};

/// Reads a whole datagram, which may hold anything; says in a few words what is wrong with one that is no message
/// between ports. The data stay the caller's.
Result<PortDatagram> parsePortDatagram(ByteView datagram);

}  // namespace kelvo
