#include "telephony/AdaptedStream.h"

#include "LogGenerator/Framing.h"

namespace kelvo {

std::optional<CapturePacket> AdaptedStream::next() {
    using Outcome = adaptation::Adapted::Outcome;
    while (auto packet = _stream->next()) {
        const adaptation::Adapted adapted = _adapter.adapt(stripPrefix(packet->bytes));
        if (adapted.outcome == Outcome::Refused) continue;
        if (adapted.outcome == Outcome::Turned) packet->bytes = adapted.packet;
        return packet;
    }
    return std::nullopt;
}

}  // namespace kelvo
