#include "platform/host/PortDatagram.h"

#include <cstring>

namespace kelvo {

Result<PortDatagram> parsePortDatagram(ByteView datagram) {
    PortHeader header;
    if (datagram.size() < sizeof header) return Failure{"it is shorter than a header"};
    std::memcpy(&header, datagram.data(), sizeof header);
    if (header.magic != PortHeader::kMagic || header.reserved != 0) return Failure{"it has an unknown format"};
    if (header.kind != PortHeader::Message && header.kind != PortHeader::Reply) return Failure{"it is of unknown kind"};
    if ((header.flags & ~PortHeader::WantsReply) != 0) return Failure{"it has unknown flags"};
    if (header.length != datagram.size() - sizeof header) return Failure{"its length is wrong"};
    return PortDatagram{header, datagram.subspan(sizeof header)};
}

}  // namespace kelvo
