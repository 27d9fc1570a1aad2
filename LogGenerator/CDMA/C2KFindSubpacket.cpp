#include "LogGenerator/CDMA/C2KFindSubpacket.h"

#include "LogGenerator/RecordView.h"
#include "platform/system/Environment.h"

namespace kelvo {

std::optional<std::size_t> C2KFindSubpacket(ByteView packet, std::uint8_t wanted) {
    constexpr std::size_t kFirst = 17;
    const RecordView record(packet);
    const auto count = static_cast<int>(record.read(14, u8));
    const std::size_t limit = kFirst + packet.size();  // intended: counted from the first sub-packet
    std::size_t at = kFirst;
    // Sizes never lead backwards and a size of 0 stays in place, so the count alone bounds the walk.
    for (int index = 0; index < count; ++index) {
        const std::int64_t size = record.read(at + 2, u16);
        const std::size_t next = at + static_cast<std::size_t>(size);
        if (next >= limit) {
            logLine(Level::Error, "Log code error in subpkt#%d: bad size (%d).", index, static_cast<int>(size));
            return std::nullopt;
        }
        if (record.read(at, u8) == wanted) return at;
        at = next;
    }
    return std::nullopt;
}

}  // namespace kelvo
